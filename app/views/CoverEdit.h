#pragma once

#include <QWidget>
#include <functional>
#include <optional>

class CoverView;
class QLabel;
class QMimeData;
class QPushButton;
class TagEdits;
struct FileTags;

// The cover of the tag editor's songs: shown, chosen from a file, dropped, pasted, saved and removed.
class CoverEdit : public QWidget {
 public:
    explicit CoverEdit(TagEdits& edits, QWidget* parent = nullptr);

    // What the songs' files hold; nullptr while that is not known, for the reason given.
    void ShowFiles(const FileTags* tags, const QString& reason = QString());
    // Shows what the edits hold now.
    void Refresh();
    void SetEditable(bool editable);

    // Told after each edit.
    std::function<void()> OnEdited;

 protected:
    void dragEnterEvent(QDragEnterEvent* event) override;
    void dropEvent(QDropEvent* event) override;

 private:
    QPushButton* AddButton(const QString& name, const QString& caption, void (CoverEdit::*command)());
    void Add();
    static bool CanPaste();
    void Paste();
    void Save();
    void Remove();
    void Take(const QMimeData& given);
    void Tell();
    // Of the picture that the songs have or are to have; empty for none.
    QByteArray Picture() const;
    QString State() const;

    TagEdits& edits_;
    CoverView* view_;
    QLabel* state_;
    QPushButton* add_;
    QPushButton* paste_;
    QPushButton* save_;
    QPushButton* remove_;
    std::optional<QByteArray> cover_;  // of the files
    bool differ_ = false;
    QString reason_;  // why nothing is known of the files
    bool editable_ = false;
};
