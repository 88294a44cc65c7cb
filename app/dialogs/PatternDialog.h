#pragma once

#include <QDialog>
#include <QTimer>
#include <optional>
#include <vector>

#include "app/dialogs/NamePatternEdit.h"

class QLabel;
class QPushButton;
class QTableView;

struct PatternColumn {
    QString Heading;
    bool Narrow = false;  // as wide as its texts; the others share the rest
};

// What the songs of a PatternDialog come to by a pattern.
struct PatternOutcome {
    std::optional<QString> Fault{};  // what is wrong with the pattern; then nothing else counts
    std::vector<PatternColumn> Columns{};
    std::size_t Rows = 0;
    std::size_t Possible = 0;  // songs that something happens with
    std::size_t Blocked = 0;   // songs that something is in the way of
};

// Asks for a pattern of file names and shows all the while what it comes to for each song, a short while
// after each change. Nothing happens here: accepting it is what the user agrees to, for the last look.
class PatternDialog : public QDialog {
 public:
    QString Pattern() const { return pattern_->Pattern(); }

 protected:
    struct Texts {
        QString Name;    // of the object
        QString Title;   // of the window
        QString Table;   // what the table shows, for those who do not see it
        QString Button;  // that agrees, with its letter
        QString Done;    // what is done with the songs: "umbenannt"
    };
    PatternDialog(Texts texts, std::size_t songs, QWidget* parent);

    // The first look, when the constructor has everything that Plan and Cell need.
    void Begin(const QString& pattern);
    // The line below the pattern; it tells what is wrong with it, too.
    void Describe(NamePatternEdit::Description description);

    // Looks at the songs. Cells are asked for when they are seen.
    virtual PatternOutcome Plan(const QString& pattern) = 0;
    virtual QVariant Cell(std::size_t row, int column, int role) const = 0;

 private:
    class Rows;

    void SetUpLayout();
    void Show();
    QString Summary(const PatternOutcome& outcome) const;

    const Texts texts_;
    const std::size_t songs_;
    NamePatternEdit* pattern_;
    Rows* rows_;
    QTableView* table_;
    QLabel* summary_;
    QPushButton* agree_;
    QTimer pause_;  // until the user has stopped typing
};
