#pragma once

#include <QStringList>
#include <QWidget>

class QListWidget;
class QPushButton;

// A list of folders that the user adds to and removes from. No folder in it lies below another.
class FolderList : public QWidget {
 public:
    explicit FolderList(QWidget* parent = nullptr);

    QStringList Folders() const;
    void SetFolders(const QStringList& folders);

 private:
    void Add();
    void RemoveMarked();
    void EnableRemove();

    QListWidget* list_;
    QPushButton* add_;
    QPushButton* remove_;
};
