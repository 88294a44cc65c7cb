#include "app/dialogs/options/DatabasePage.h"

#include <QCheckBox>
#include <QComboBox>
#include <QFormLayout>

#include "MusicManagment/database/commands/DatabaseSettings.h"
#include "app/desktop/Icons.h"
#include "app/dialogs/options/DurationBox.h"

using namespace Qt::StringLiterals;

namespace {

enum AutoSaveChoice { acNever, acAfterCommand, acTimed };

constexpr int kProposedInterval = 10 * 60 * 1000;  // milliseconds

AutoSaveChoice ChoiceOf(int autoSave) {
    if (autoSave < 0) return acAfterCommand;
    return autoSave == 0 ? acNever : acTimed;
}

}  // namespace

DatabasePage::DatabasePage()
    : OptionsPage(u"Datenbank"_s, ThemeIcon(u"server-database"_s, QStyle::SP_DriveHDIcon)) {
    QFormLayout& saving = AddGroup(u"Speichern"_s);
    autoSave_ = AddField(saving, u"AutoSave"_s, u"&Von selbst speichern"_s, new QComboBox,
                         u"Die Standard-Datenbank wird außerdem immer beim Beenden gespeichert."_s);
    autoSave_->addItems({u"nur beim Beenden"_s, u"nach jeder Änderung"_s, u"in festen Abständen"_s});
    interval_ =
        AddField(saving, u"AutoSaveInterval"_s, u"Ab&stand"_s, new DurationBox(DurationBox::Unit::Minutes));
    interval_->setRange(1, DatabaseSettings::kAutoSave.Row.Most);
    connect(autoSave_, &QComboBox::currentIndexChanged, this,
            [this](int choice) { interval_->setEnabled(choice == acTimed); });
    fields_.Bind(FieldValue<int>{[this] { return ChosenAutoSave(); },
                                 [this](int autoSave) { ShowAutoSave(autoSave); }},
                 DatabaseSettings::kAutoSave);
    auto* compression =
        AddField(saving, u"Compression"_s, u"&Kompression"_s, new QComboBox,
                 u"Eine stärkere Kompression gibt kleinere Dateien, das Speichern dauert länger."_s);
    compression->addItems({u"keine"_s, u"schnell"_s, u"normal"_s, u"stark"_s});
    fields_.Bind(compression, DatabaseSettings::kCompression);
    QFormLayout& banned = AddGroup(u"Bannlist"_s);
    auto* deleteBanned = AddCheck(
        banned, u"AutoDelBannedFiles"_s, u"&Gebannte Songs beim Aufnehmen in den Papierkorb verschieben"_s,
        u"Betrifft Dateien, die beim Durchsuchen eines Ordners gefunden werden und in der Bannlist "
        "stehen. Ohne diese Option werden sie nur nicht aufgenommen."_s);
    fields_.Bind(deleteBanned, DatabaseSettings::kAutoDelBannedFiles);
}

void DatabasePage::ShowAutoSave(int autoSave) {
    const AutoSaveChoice choice = ChoiceOf(autoSave);
    autoSave_->setCurrentIndex(choice);
    interval_->setEnabled(choice == acTimed);
    interval_->setValue(choice == acTimed ? autoSave : kProposedInterval);
}

int DatabasePage::ChosenAutoSave() const {
    const int values[] = {0, -1, interval_->value()};  // in the order of AutoSaveChoice
    return values[autoSave_->currentIndex()];
}
