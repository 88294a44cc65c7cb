#include "app/dialogs/options/RulesPage.h"

#include <QCheckBox>
#include <QFormLayout>
#include <QRadioButton>
#include <algorithm>

#include "MusicManagment/database/commands/DatabaseSettings.h"
#include "MusicManagment/playback/PlayerSettings.h"
#include "MusicManagment/playlist/PlayListSettings.h"
#include "app/desktop/Icons.h"

using namespace Qt::StringLiterals;

RulesPage::RulesPage(const TMusicDatabase& database)
    : OptionsPage(u"Regeln"_s, ThemeIcon(u"view-list-details"_s, QStyle::SP_FileDialogInfoView)),
      modern_(new QRadioButton(u"&Modern"_s)),
      classic_(new QRadioButton(u"&Klassisch"_s)),
      single_(new QRadioButton(u"&Einzeln gewählt"_s)) {
    AddChoice();
    QFormLayout& reading = AddGroup(u"Dateien lesen"_s);
    fields_.Bind(AddRule(reading, DatabaseSettings::kModernTags.Row.Name, u"&Tags nach ihren Standards"_s,
                         u"Versteht ID3v2.2 bis 2.4 mit allen Zeichensätzen und misst die Länge genauer. "
                         "Klassisch wird gelesen wie in den früheren Versionen."_s),
                 DatabaseSettings::kModernTags);
    fields_.Bind(
        AddRule(reading, DatabaseSettings::kKeepLostSongs.Row.Name,
                u"Songs &alter Datenbanken behalten, deren Dateien fehlen"_s,
                u"Beim Öffnen einer Datenbank der Versionen 1.0 bis 1.2 bleiben auch Songs erhalten, "
                "deren Datenträger nicht angeschlossen ist. Klassisch gehen sie verloren."_s),
        DatabaseSettings::kKeepLostSongs);
    fields_.Bind(
        AddRule(reading, DatabaseSettings::kDerivedGenres.Row.Name,
                u"&Hauptgenre aus dem Genre des Tags ableiten"_s,
                u"Neue Songs kommen gleich in die Gruppe, zu der ihr Genre gehört. Klassisch ist das "
                "Hauptgenre unbekannt, bis Sie es wählen."_s),
        DatabaseSettings::kDerivedGenres);
    fields_.Bind(
        AddRule(
            reading, DatabaseSettings::kModernMedia.Row.Name, u"&Datenträger überall suchen"_s,
            u"Songs auf CDs und Wechseldatenträgern werden auf jedem eingelegten Datenträger gefunden, und "
            "beim Aufnehmen von einem neuen fragt das Programm, ob er katalogisiert werden soll. Klassisch "
            "wird nur in einem Laufwerk nachgesehen."_s),
        DatabaseSettings::kModernMedia);
    AddText(reading,
            u"Gilt für Dateien, die von nun an gelesen werden. Songs, die schon in der Datenbank sind, "
            "liest „Datenbank updaten (Auch ID3-Tags auf Änderungen prüfen)...“ neu."_s);
    QFormLayout& naming = AddGroup(u"Dateien umbenennen"_s);
    fields_.Bind(
        AddRule(naming, DatabaseSettings::kRenameInPlace.Row.Name,
                u"Dateien beim Umbenennen in ihrem &Ordner lassen"_s,
                u"Nur der Name ändert sich. Klassisch kommt die Datei mit ihrem ganzen alten Pfad unter den "
                "Stammordner. Ein Beispiel zeigt die Seite „Dateien und Ordner“."_s),
        DatabaseSettings::kRenameInPlace);
    QFormLayout& searching = AddGroup(u"Doppelte Einträge"_s);
    fields_.Bind(AddRule(searching, DatabaseSettings::kUnlimitedSearch.Row.Name,
                         u"In Sammlungen &jeder Größe suchen"_s,
                         u"Wenn es lange dauert, wird vorher gefragt. Klassisch werden höchstens 65536 Songs "
                         "miteinander verglichen."_s),
                 DatabaseSettings::kUnlimitedSearch);
    QFormLayout& lists = AddGroup(u"PlayLists lesen"_s);
    fields_.Bind(
        AddRule(lists, PlayListSettings::kModernLists.Row.Name, u"&PlayLists anderer Programme"_s,
                u"Versteht M3U, PLS und einfache Listen, wie sie heute geschrieben werden. Klassisch "
                "wird erkannt, was die früheren Versionen erkannten."_s),
        PlayListSettings::kModernLists.Row);
    SetAvailable(lists, database.PlayList() != nullptr, u"Wird mit der PlayList wirksam."_s);
    QFormLayout& playing = AddGroup(u"Abspielen"_s);
    fields_.Bind(AddRule(playing, PlayerSettings::kKeepAlbums.Row.Name,
                         u"Kein Ü&berblenden zwischen Songs eines Albums"_s,
                         u"Songs, die auf einem Album aufeinander folgen, gehen am Ende ohne Überblendung "
                         "ineinander über. Klassisch wird auch zwischen ihnen übergeblendet."_s),
                 PlayerSettings::kKeepAlbums.Row);
    fields_.Bind(AddRule(playing, PlayerSettings::kQuietFailures.Row.Name,
                         u"Nicht &spielbare Songs in der Statuszeile melden"_s,
                         u"Eine Meldung erscheint nur für den Song, den Sie selbst gewählt haben. Klassisch "
                         "erscheint für jeden Versuch eine."_s),
                 PlayerSettings::kQuietFailures.Row);
    SetAvailable(playing, database.PlaySound() != nullptr, u"Wird mit dem Player wirksam."_s);
}

void RulesPage::AddChoice() {
    QFormLayout& group = AddGroup(u"Regeln"_s);
    modern_->setObjectName(u"ModernRules"_s);
    classic_->setObjectName(u"ClassicRules"_s);
    single_->setObjectName(u"SingleRules"_s);
    group.addRow(modern_);
    AddExplanation(group, u"Für fast alle Sammlungen richtig."_s);
    group.addRow(classic_);
    AddExplanation(group,
                   u"Wie die früheren Versionen, damit eine ältere Sammlung dieselben Angaben behält."_s);
    group.addRow(single_);
    connect(modern_, &QRadioButton::clicked, this, [this] { SetAll(true); });
    connect(classic_, &QRadioButton::clicked, this, [this] { SetAll(false); });
    connect(single_, &QRadioButton::toggled, this, [this] { EnableRules(); });
}

QCheckBox* RulesPage::AddRule(QFormLayout& group, QStringView name, const QString& caption,
                              const QString& explanation) {
    auto* rule = AddCheck(group, name.toString(), caption, explanation);
    AddExplanation(group, explanation);
    rules_.push_back(rule);
    return rule;
}

void RulesPage::Load(const TMusicDatabase& database, const TRWReg& settings) {
    OptionsPage::Load(database, settings);
    ShowChoice();
}

void RulesPage::LoadDefaults() {
    OptionsPage::LoadDefaults();
    ShowChoice();
}

// A rule may have been changed on the page of what it is about.
void RulesPage::showEvent(QShowEvent* event) {
    OptionsPage::showEvent(event);
    if (!single_->isChecked()) ShowChoice();
}

void RulesPage::SetAll(bool modern) {
    for (QCheckBox* rule : rules_)
        rule->setChecked(modern);
}

void RulesPage::ShowChoice() {
    // A rule of a component that is not there says nothing.
    const auto counts = [](const QCheckBox* rule) { return rule->parentWidget()->isEnabled(); };
    const auto isModern = [&](const QCheckBox* rule) { return !counts(rule) || rule->isChecked(); };
    const auto isClassic = [&](const QCheckBox* rule) { return !counts(rule) || !rule->isChecked(); };
    QRadioButton* choice = single_;
    if (std::ranges::all_of(rules_, isModern)) choice = modern_;
    if (std::ranges::all_of(rules_, isClassic)) choice = classic_;
    choice->setChecked(true);
    EnableRules();
}

void RulesPage::EnableRules() {
    for (QCheckBox* rule : rules_)
        rule->setEnabled(single_->isChecked());
}
