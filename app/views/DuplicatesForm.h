#pragma once

#include <QWidget>
#include <functional>
#include <vector>

#include "MusicManagment/database/commands/Settings.h"
#include "MusicManagment/database/duplicates/SearchDuplicates.h"
#include "app/models/DuplicateListModel.h"
#include "app/views/SrchDblsListView.h"

class QCheckBox;
class QHBoxLayout;
class QLabel;
class QLineEdit;
class QSlider;
class QSplitter;
class TCompFilesForm;

// The window "Doppelte Einträge": the pairs of a search, the two songs of the chosen one side by side, and
// what the user decides about them. It does nothing with songs but ask for it.
class DuplicatesForm : public QWidget, public DuplicateView, public SettingsClient {
 public:
    DuplicatesForm(TMusicDatabase& database, QWidget* parent);

    // What was decided about which shown pairs.
    std::function<void(PairDecision, const std::vector<DuplicatePair>&)> OnDecision;
    std::function<void(const std::vector<DuplicatePair>&)> OnSuggest;
    // To play a song, from where `instead` is if that plays.
    std::function<void(SongHandle song, SongHandle instead)> OnListen;
    std::function<void()> OnSearchAgain;
    std::function<void()> OnUndo;
    std::function<void()> OnRedo;

    DuplicateListModel& Pairs() { return pairs_; }
    // From which similarity on a search looks.
    int LeastPercent() const;
    // A sentence about what was done.
    void Tell(const QString& sentence);

    DuplicateRows& Begin(const DuplicateQuery& query) override;
    void ShowNewRows() override { pairs_.TakeNewRows(); }
    void End(DuplicateEnd end) override;

    void LoadSettings(const TRWReg& settings) override;
    void SaveSettings(TRWReg& settings) const override;

 private:
    void SetUpChoice();
    void SetUpButtons();
    void SetUpKeys();
    void SetUpLayout();
    void ChoiceChanged();
    void ShowCount();
    void ShowRow(int row);
    void Decide(PairDecision decision);
    void Listen(int song);

    TMusicDatabase& database_;
    DuplicateListModel pairs_;
    QLineEdit* filter_;
    QLabel* percentText_;
    QSlider* percent_;
    QCheckBox* groups_;
    QCheckBox* keptToo_;
    QLabel* count_;
    TSrchDblsListView* list_;
    TCompFilesForm* comparison_;
    QSplitter* splitter_;
    QHBoxLayout* buttons_;
    QLabel* told_;
    QTimer pause_;
    int listened_ = 1;  // song of the pair
    bool searching_ = false;
};
