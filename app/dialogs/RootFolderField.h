#pragma once

#include <QString>
#include <QWidget>
#include <optional>

class QLineEdit;
class QPushButton;

// A line for the path of the folder that songs are moved to, with a button that lets the user choose one.
class RootFolderField : public QWidget {
 public:
    // `caption` is the title of the choice.
    explicit RootFolderField(const QString& caption, QWidget* parent = nullptr);

    // Absolute when what was entered is; empty when nothing was.
    QString Folder() const;
    void SetFolder(const QString& folder);
    QLineEdit& Edit() const { return *edit_; }

    // What is wrong with the folder, for the user; nothing when it can be used. A folder that does not exist
    // is offered to be made; an empty text says that the user did not want that.
    std::optional<QString> Fault() const;

 private:
    QLineEdit* edit_;
    QPushButton* choose_;
};
