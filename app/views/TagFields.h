#pragma once

#include <QWidget>
#include <functional>
#include <vector>

#include "MusicManagment/database/SongFields.h"

class QAbstractButton;
class QCheckBox;
class QComboBox;
class QFormLayout;
class QLabel;
class QLineEdit;
class QPlainTextEdit;
class QPushButton;
class QStringListModel;
class TagEdits;
class TMusicDatabase;

// The fields of the tag editor. Each shows what all songs have in common, and takes the user's edits at once;
// Escape in a field takes its edit back.
class TagFields : public QWidget {
 public:
    TagFields(TagEdits& edits, const TMusicDatabase& database, QWidget* parent = nullptr);

    // Shows what the edits hold now.
    void Refresh();
    // Without it texts can be selected, and nothing be changed.
    void SetEditable(bool editable);
    void FocusFirst();
    // Goes to a field that cannot hold what was entered.
    void FocusFault();

    // Told after each edit.
    std::function<void()> OnEdited;
    // Has the songs numbered; may throw.
    std::function<void()> OnNumber;

 protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

 private:
    // A field and what the edits know of it.
    struct Field {
        QWidget* Widget = nullptr;
        QLabel* Label = nullptr;            // or, where there is none,
        QAbstractButton* Button = nullptr;  // the field's own caption
        QString Caption{};
        std::function<void()> Show{};
        std::function<bool()> Touched{};
        std::function<void()> Restore{};
        std::function<bool()> Faulty = [] { return false; };
    };

    QLabel* AddRow(const QString& caption, QWidget* widget);
    QLineEdit* MakeLine(SongFieldId id);
    void AddLine(SongFieldId id, int width = 0);
    void AddComment();
    void AddTracks();
    void AddGenre();
    void AddMainGenre();
    void AddRemix();
    void AddFlags();
    void AddSuggestions(const QString& field, const std::function<QStringList()>& texts);
    void Follow(SongFieldId id, QWidget* widget, QLabel* label, std::function<void()> show);
    void FollowCheck(QCheckBox* box, const std::function<std::optional<bool>()>& shown,
                     const std::function<void(bool)>& edit, std::function<bool()> touched,
                     std::function<void()> restore);
    void Edited(SongFieldId id, const QString& text, bool asAtFirst);
    void Tell();
    void Mark(Field& field) const;
    void RestoreFocused();

    TagEdits& edits_;
    const TMusicDatabase& database_;
    QFormLayout* form_;
    QPushButton* number_ = nullptr;
    std::vector<Field> fields_;
    // Texts that are offered while typing, fetched when their field gets the focus.
    std::vector<std::pair<QStringListModel*, std::function<QStringList()>>> suggestions_;
};
