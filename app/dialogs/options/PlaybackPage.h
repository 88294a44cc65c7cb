#pragma once

#include <vector>

#include "app/dialogs/options/OptionsPage.h"
#include "app/dialogs/options/StoredFields.h"

class QLineEdit;
class QSpinBox;

// "Wiedergabe": settings of the player and the playlist, which these components read from the store.
class PlaybackPage : public OptionsPage {
 public:
    // Groups of components that `database` is not linked to are shown greyed out.
    explicit PlaybackPage(const TMusicDatabase& database);

    void Load(const TMusicDatabase& database, const TRWReg& settings) override;
    std::optional<OptionsFault> Check() override;
    void Apply(TMusicDatabase& database, TRWReg& settings) override;

 private:
    void AddPlayer();
    void AddPlayList();
    void AddEngines();
    void AddFmod();
    void AddEldoS();
    void AddWinamp();
    QSpinBox* AddNumber(QFormLayout& group, const QString& name, const QString& caption, int least, int most,
                        int standard, const QString& unit = QString());
    QLineEdit* AddLine(QFormLayout& group, const QString& name, const QString& caption,
                       const QString& standard);

    StoredFields fields_;
    std::vector<QFormLayout*> playerGroups_;  // those that only a player makes use of
    QFormLayout* playListGroup_ = nullptr;
    std::vector<QCheckBox*> engines_;
    QLineEdit* winampClass_ = nullptr;
    QLineEdit* winampFile_ = nullptr;
    QCheckBox* winampLength_ = nullptr;
};
