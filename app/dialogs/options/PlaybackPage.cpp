#include "app/dialogs/options/PlaybackPage.h"

#include <QCheckBox>
#include <QComboBox>
#include <QFormLayout>
#include <QLineEdit>
#include <QSpinBox>
#include <algorithm>

#include "MusicManagment/database/commands/DatabaseSettings.h"
#include "MusicManagment/playback/PlayerSettings.h"
#include "MusicManagment/playlist/PlayListSettings.h"
#include "app/desktop/Icons.h"
#include "app/dialogs/options/DurationBox.h"
#include "app/models/SoundOutputs.h"
#include "app/views/WindowSettings.h"

using namespace Qt::StringLiterals;

namespace {

struct Engine {
    Setting<bool> Row;
    const char16_t* Caption;
};

constexpr Engine kEngines[] = {
    {PlayerSettings::kUseFMOD, u"&FMOD"},
    {PlayerSettings::kUseMCI, u"&MCI (Player des Systems)"},
    {PlayerSettings::kUseEldoS, u"&EldoS"},
    {PlayerSettings::kUseWinAmp, u"Win&amp (anderes Programm)"},
};

// In the order of the stored numbers.
QStringList Crossovers() {
    return {u"nie"_s, u"am Ende eines Songs"_s, u"bei jedem Wechsel"_s,
            u"bei jedem Wechsel und beim Anhalten"_s};
}

}  // namespace

PlaybackPage::PlaybackPage(const TMusicDatabase& database)
    : OptionsPage(u"Wiedergabe"_s, ThemeIcon(u"media-playback-start"_s, QStyle::SP_MediaPlay)) {
    AddPlayer();
    AddPlayList();
    AddEngines();
    AddFmod();
    AddEldoS();
    AddWinamp();
    for (QFormLayout* group : playerGroups_)
        SetAvailable(*group, database.PlaySound() != nullptr, u"Wird mit dem Player wirksam."_s);
    SetAvailable(*playListGroup_, database.PlayList() != nullptr, u"Wird mit der PlayList wirksam."_s);
}

void PlaybackPage::AddNumber(QFormLayout& group, const Setting<int>& setting, const QString& caption,
                             const QString& unit) {
    auto* field = AddField(group, setting.Name.toString(), caption, new QSpinBox);
    field->setGroupSeparatorShown(true);
    field->setSuffix(unit);
    fields_.Bind(field, setting);
}

void PlaybackPage::AddTime(QFormLayout& group, const Setting<int>& setting, const QString& caption,
                           const QString& toolTip) {
    auto* field = new DurationBox(DurationBox::Unit::Seconds);
    fields_.Bind(AddField(group, setting.Name.toString(), caption, field, toolTip), setting);
}

QLineEdit* PlaybackPage::AddLine(QFormLayout& group, const Setting<QString>& setting,
                                 const QString& caption) {
    auto* field = AddField(group, setting.Name.toString(), caption, new QLineEdit);
    fields_.Bind(field, setting);
    return field;
}

void PlaybackPage::AddPlayer() {
    QFormLayout& player = AddGroup(u"Player"_s);
    playerGroups_.push_back(&player);
    fields_.Bind(AddCheck(player, u"PSAutoPlay"_s, u"&Gleich abspielen, wenn ein Song geladen wird"_s),
                 PlayerSettings::kAutoPlay.Row);
    AddNumber(player, PlayerSettings::kTimerInterval.Row, u"Anzeige erne&uern alle"_s, u" ms"_s);
}

void PlaybackPage::AddPlayList() {
    QFormLayout& list = AddGroup(u"PlayList"_s);
    playListGroup_ = &list;
    fields_.Bind(AddCheck(list, u"RepeatAll"_s, u"Am Ende von &vorn beginnen"_s),
                 PlayListSettings::kRepeatAll.Row);
    fields_.Bind(
        AddCheck(list, u"PlayOnlyThisSong"_s, u"Doppelkli&ck spielt nur diesen Song"_s,
                 u"Sonst werden danach die Songs gespielt, die ihm in der gezeigten Liste folgen."_s),
        WindowSettings::kPlayOnlyThisSong);
    auto* copy =
        AddCheck(list, u"CopyMp3sBeforePlay"_s, u"Songs vor dem Abspielen &zwischenspeichern"_s,
                 u"Kopiert jeden Song vorher in den Ordner für temporäre Dateien, etwa von einer CD."_s);
    fields_.Bind(copy, PlayListSettings::kCopyMp3sBeforePlay.Row);
    AddTime(list, PlayListSettings::kScanTime.Row, u"Spielzeit beim Ans&pielen"_s);
    auto* onlyThis = AddCheck(list, u"PlayOnlyThisSong"_s, u"Doppelklick spielt &nur diesen Song"_s,
                              u"Sonst folgt, was in der gezeigten Liste unter ihm steht."_s);
    fields_.Bind(onlyThis, WindowSettings::kPlayOnlyThisSong);
}

void PlaybackPage::AddEngines() {
    QFormLayout& group = AddGroup(u"Abspielen mit"_s);
    playerGroups_.push_back(&group);
    for (const Engine& engine : kEngines) {
        auto* box = AddCheck(group, engine.Row.Name.toString(), QString::fromUtf16(engine.Caption));
        fields_.Bind(box, engine.Row);
        engines_.push_back(box);
    }
    auto* apart = AddCheck(group, u"PSPlayExtern"_s, u"In einem eigenen Programm (TSPla&yer)"_s,
                           u"Die Songs spielt dann ein zweites Programm, das dieses hier steuert."_s);
    fields_.Bind(apart, PlayerSettings::kPlayExtern.Row);
}

void PlaybackPage::AddFmod() {
    QFormLayout& fmod = AddGroup(u"FMOD"_s);
    playerGroups_.push_back(&fmod);
    auto* crossover = AddField(fmod, u"Crossover"_s, u"Ü&berblenden"_s, new QComboBox);
    crossover->addItems(Crossovers());
    fields_.Bind(crossover, PlayerSettings::kCrossover);
    AddTime(fmod, PlayerSettings::kCrossoverTime, u"&Dauer der Überblendung"_s,
            u"Unter 3 Sekunden wird nicht übergeblendet."_s);
    auto* output = AddField(fmod, u"FMODSoundOutput"_s, u"Au&sgabe"_s, new QComboBox);
    output->addItems(SoundOutputNames());
    fields_.Bind(output, PlayerSettings::kSoundOutput);
    AddNumber(fmod, PlayerSettings::kMixRate, u"M&ischrate"_s, u" Hz"_s);
    AddNumber(fmod, PlayerSettings::kSoftChannels, u"Software-&Kanäle"_s);
}

void PlaybackPage::AddEldoS() {
    QFormLayout& eldos = AddGroup(u"EldoS"_s);
    playerGroups_.push_back(&eldos);
    AddNumber(eldos, PlayerSettings::kEldoSBufferCount, u"Za&hl der Puffer"_s);
    AddNumber(eldos, PlayerSettings::kEldoSBufferSize, u"G&röße eines Puffers"_s, u" Byte"_s);
}

void PlaybackPage::AddWinamp() {
    QFormLayout& winamp = AddGroup(u"Winamp"_s);
    playerGroups_.push_back(&winamp);
    winampClass_ = AddLine(winamp, PlayerSettings::kWinAmpClassName, u"Fensterk&lasse"_s);
    winampFile_ = AddLine(winamp, PlayerSettings::kWinAmpFile, u"Pr&ogrammdatei"_s);
    fields_.Bind(AddCheck(winamp, u"UseWinAmpForLenCheck"_s, u"Länge von Songs mi&t Winamp prüfen"_s),
                 DatabaseSettings::kUseWinAmpForLenCheck);
}

bool PlaybackPage::EngineChosen() const {
    return std::ranges::any_of(engines_, &QCheckBox::isChecked);
}

void PlaybackPage::Load(const TMusicDatabase& database, const TRWReg& settings) {
    OptionsPage::Load(database, settings);
    loadedEngine_ = EngineChosen();
    loadedClass_ = winampClass_->text();
    loadedFile_ = winampFile_->text();
}

// What cannot be used is refused where it was chosen here, and not where it was found.
std::optional<OptionsFault> PlaybackPage::Check() {
    if (loadedEngine_ && !EngineChosen())
        return OptionsFault{u"Mindestens ein System zum Abspielen muss eingeschaltet sein."_s,
                            engines_.front()};
    if (winampClass_->text() != loadedClass_ && winampClass_->text().trimmed().isEmpty())
        return OptionsFault{u"Die Fensterklasse von Winamp fehlt."_s, winampClass_};
    if (winampFile_->text() != loadedFile_ && winampFile_->text().trimmed().isEmpty())
        return OptionsFault{u"Die Programmdatei von Winamp fehlt."_s, winampFile_};
    return std::nullopt;
}
