#pragma once

#include <vector>

#include "app/dialogs/options/OptionsPage.h"

class QLineEdit;

// "Wiedergabe": settings of the player and the playlist, which these components read from the store.
class PlaybackPage : public OptionsPage {
 public:
    // Groups of components that `database` is not linked to are shown greyed out.
    explicit PlaybackPage(const TMusicDatabase& database);

    void Load(const TMusicDatabase& database, const TRWReg& settings) override;
    std::optional<OptionsFault> Check() override;

 private:
    void AddPlayer();
    void AddPlayList();
    void AddEngines();
    void AddFmod();
    void AddEldoS();
    void AddWinamp();
    void AddNumber(QFormLayout& group, const Setting<int>& setting, const QString& caption,
                   const QString& unit = QString());
    void AddTime(QFormLayout& group, const Setting<int>& setting, const QString& caption,
                 const QString& toolTip = QString());
    QLineEdit* AddLine(QFormLayout& group, const Setting<QString>& setting, const QString& caption);
    bool EngineChosen() const;

    std::vector<QFormLayout*> playerGroups_;  // those that only a player makes use of
    QFormLayout* playListGroup_ = nullptr;
    std::vector<QCheckBox*> engines_;
    QLineEdit* winampClass_ = nullptr;
    QLineEdit* winampFile_ = nullptr;
    // What was shown at first.
    bool loadedEngine_ = true;
    QString loadedClass_;
    QString loadedFile_;
};
