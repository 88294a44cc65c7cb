#pragma once

#include <QDockWidget>

#include "ReadMPEGHeader/ID3Tag.h"

class QFormLayout;
class QLineEdit;
class QPlainTextEdit;

// The tool window that shows the tag of the focused song; its texts can be selected but not changed.
class TID3TagForm : public QDockWidget {
 public:
    explicit TID3TagForm(QWidget* parent = nullptr);

    // Shows a song's tag, or empty fields.
    void ShowSong(const TID3Tag* song);

 private:
    QLineEdit* AddField(QFormLayout& form, const QString& caption, const QString& name);
    QPlainTextEdit* AddComment(QFormLayout& form, const QString& caption);

    QLineEdit* title_;
    QLineEdit* artist_;
    QLineEdit* album_;
    QLineEdit* year_;
    QLineEdit* track_;
    QLineEdit* genre_;
    QLineEdit* mainGenre_;
    QPlainTextEdit* comment_;
};
