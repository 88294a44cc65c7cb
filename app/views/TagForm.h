#pragma once

#include <QDockWidget>
#include <vector>

#include "MusicManagment/database/SongFields.h"

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
    struct ShownField {
        SongFieldId Id;
        QLineEdit* Field;
    };

    QLineEdit* AddField(QFormLayout& form, const SongField& shown);
    QPlainTextEdit* AddComment(QFormLayout& form, const SongField& shown);

    std::vector<ShownField> fields_;
    QPlainTextEdit* comment_ = nullptr;
};
