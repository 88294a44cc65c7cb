#include "app/dialogs/options/PlaybackPage.h"

#include <QCheckBox>
#include <QComboBox>
#include <QFormLayout>
#include <QLineEdit>
#include <QSpinBox>
#include <algorithm>

#include "MusicManagment/database/MusicManagment.h"
#include "app/desktop/Icons.h"
#include "app/dialogs/options/DurationBox.h"
#include "app/models/SoundOutputs.h"

using namespace Qt::StringLiterals;

namespace {

struct Engine {
    const char16_t* Name;  // of the setting
    const char16_t* Caption;
};

constexpr Engine kEngines[] = {
    {u"UseFMOD", u"&FMOD"},
    {u"UseMCI", u"&MCI (Player des Systems)"},
    {u"UseEldoS", u"&EldoS"},
    {u"UseWinamp", u"Win&amp (anderes Programm)"},
};

// In the order of the stored numbers.
QStringList Crossovers() {
    return {u"nie"_s, u"am Ende eines Songs"_s, u"bei jedem Wechsel"_s,
            u"bei jedem Wechsel und beim Anhalten"_s};
}

constexpr int kCrossoverAtEnd = 1;
constexpr int kDirectSound = 2;

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

QSpinBox* PlaybackPage::AddNumber(QFormLayout& group, const QString& name, const QString& caption, int least,
                                  int most, int standard, const QString& unit) {
    auto* field = AddField(group, name, caption, new QSpinBox);
    field->setRange(least, most);
    field->setGroupSeparatorShown(true);
    field->setSuffix(unit);
    fields_.BindInteger(field, name, standard);
    return field;
}

QLineEdit* PlaybackPage::AddLine(QFormLayout& group, const QString& name, const QString& caption,
                                 const QString& standard) {
    auto* field = AddField(group, name, caption, new QLineEdit);
    fields_.BindText(field, name, standard);
    return field;
}

void PlaybackPage::AddPlayer() {
    QFormLayout& player = AddGroup(u"Player"_s);
    playerGroups_.push_back(&player);
    auto* autoPlay = AddCheck(player, u"PSAutoPlay"_s, u"&Gleich abspielen, wenn ein Song geladen wird"_s);
    fields_.BindBool(autoPlay, u"PSAutoPlay"_s, false);
    AddNumber(player, u"PSTimerInterval"_s, u"Anzeige erne&uern alle"_s, 20, 5000, 250, u" ms"_s);
}

void PlaybackPage::AddPlayList() {
    QFormLayout& list = AddGroup(u"PlayList"_s);
    playListGroup_ = &list;
    auto* repeat = AddCheck(list, u"RepeatAll"_s, u"Am Ende von &vorn beginnen"_s);
    fields_.BindBool(repeat, u"RepeatAll"_s, false);
    auto* copy =
        AddCheck(list, u"CopyMp3sBeforePlay"_s, u"Songs vor dem Abspielen &zwischenspeichern"_s,
                 u"Kopiert jeden Song vorher in den Ordner für temporäre Dateien, etwa von einer CD."_s);
    fields_.BindBool(copy, u"CopyMp3sBeforePlay"_s, false);
    auto* scan = AddField(list, u"ScanTime"_s, u"Spielzeit beim Ans&pielen"_s,
                          new DurationBox(DurationBox::Unit::Seconds, 1000, 600'000));
    fields_.BindInteger(scan, u"ScanTime"_s, 10'000);
}

void PlaybackPage::AddEngines() {
    QFormLayout& group = AddGroup(u"Abspielen mit"_s);
    playerGroups_.push_back(&group);
    for (const Engine& engine : kEngines) {
        const QString name = QString::fromUtf16(engine.Name);
        auto* box = AddCheck(group, name, QString::fromUtf16(engine.Caption));
        fields_.BindBool(box, name, true);
        engines_.push_back(box);
    }
    auto* apart = AddCheck(group, u"PSPlayExtern"_s, u"In einem eigenen Programm (TSPla&yer)"_s,
                           u"Die Songs spielt dann ein zweites Programm, das dieses hier steuert."_s);
    fields_.BindBool(apart, u"PSPlayExtern"_s, false);
}

void PlaybackPage::AddFmod() {
    QFormLayout& fmod = AddGroup(u"FMOD"_s);
    playerGroups_.push_back(&fmod);
    auto* crossover = AddField(fmod, u"Crossover"_s, u"Ü&berblenden"_s, new QComboBox);
    crossover->addItems(Crossovers());
    fields_.BindChoice(crossover, u"Crossover"_s, kCrossoverAtEnd);
    auto* time = AddField(fmod, u"CrossoverTime"_s, u"&Dauer der Überblendung"_s,
                          new DurationBox(DurationBox::Unit::Seconds, 0, 60'000),
                          u"Unter 3 Sekunden wird nicht übergeblendet."_s);
    fields_.BindInteger(time, u"CrossoverTime"_s, 10'000);
    auto* output = AddField(fmod, u"FMODSoundOutput"_s, u"Au&sgabe"_s, new QComboBox);
    output->addItems(SoundOutputNames());
    fields_.BindChoice(output, u"FMODSoundOutput"_s, kDirectSound);
    AddNumber(fmod, u"FMODMixRate"_s, u"M&ischrate"_s, 4000, 192'000, 44'100, u" Hz"_s);
    AddNumber(fmod, u"FMODSoftChannels"_s, u"Software-&Kanäle"_s, 1, 1024, 32);
}

void PlaybackPage::AddEldoS() {
    QFormLayout& eldos = AddGroup(u"EldoS"_s);
    playerGroups_.push_back(&eldos);
    AddNumber(eldos, u"EldoSBufferCount"_s, u"Za&hl der Puffer"_s, 1, 64, 4);
    AddNumber(eldos, u"EldoSBufferSize"_s, u"G&röße eines Puffers"_s, 1024, 1'048'576, 32'768, u" Byte"_s);
}

void PlaybackPage::AddWinamp() {
    QFormLayout& winamp = AddGroup(u"Winamp"_s);
    playerGroups_.push_back(&winamp);
    winampClass_ = AddLine(winamp, u"WinAmpClassName"_s, u"Fensterk&lasse"_s, u"WinAmp v1.x"_s);
    winampFile_ = AddLine(winamp, u"WinAmpFileName"_s, u"Pr&ogrammdatei"_s, u"WinAmp.exe"_s);
    winampLength_ = AddCheck(winamp, u"UseWinAmpForLenCheck"_s, u"Länge von Songs mi&t Winamp prüfen"_s);
}

void PlaybackPage::Load(const TMusicDatabase& database, const TRWReg& settings) {
    fields_.Load(settings);
    winampLength_->setChecked(database.UseWinAmpForLenCheck());
}

std::optional<OptionsFault> PlaybackPage::Check() {
    const bool noEngine =
        std::none_of(engines_.begin(), engines_.end(), [](const QCheckBox* box) { return box->isChecked(); });
    if (engines_.front()->isEnabled() && noEngine)
        return OptionsFault{u"Mindestens ein System zum Abspielen muss eingeschaltet sein."_s,
                            engines_.front()};
    if (!winampClass_->isEnabled()) return std::nullopt;
    if (winampClass_->text().trimmed().isEmpty())
        return OptionsFault{u"Die Fensterklasse von Winamp fehlt."_s, winampClass_};
    if (winampFile_->text().trimmed().isEmpty())
        return OptionsFault{u"Die Programmdatei von Winamp fehlt."_s, winampFile_};
    return std::nullopt;
}

void PlaybackPage::Apply(TMusicDatabase& database, TRWReg& settings) {
    fields_.Store(settings);
    database.SetUseWinAmpForLenCheck(winampLength_->isChecked());
}
