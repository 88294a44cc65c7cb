#include "app/dialogs/options/TagsPage.h"

#include <QFormLayout>
#include <QRadioButton>

#include "MusicManagment/database/MusicManagment.h"
#include "app/desktop/Icons.h"

using namespace Qt::StringLiterals;

TagsPage::TagsPage()
    : OptionsPage(u"Tags"_s, ThemeIcon(u"tag"_s, QStyle::SP_FileDialogInfoView)),
      modern_(new QRadioButton(u"&Modern"_s)),
      classic_(new QRadioButton(u"&Klassisch"_s)) {
    QFormLayout& reading = AddGroup(u"Dateien lesen"_s);
    modern_->setObjectName(u"ModernTags"_s);
    classic_->setObjectName(u"ClassicTags"_s);
    reading.addRow(modern_);
    AddExplanation(
        reading,
        u"Versteht die Tags ID3v2.2 bis 2.4 mit allen Zeichensätzen und misst die Länge genauer. Für fast "
        "alle Sammlungen richtig."_s);
    reading.addRow(classic_);
    AddExplanation(
        reading,
        u"Liest wie die früheren Versionen, damit eine ältere Datenbank beim Updaten dieselben Angaben "
        "behält."_s);
    AddText(reading,
            u"Gilt für Dateien, die von nun an gelesen werden. Songs, die schon in der Datenbank sind, "
            "liest „Datenbank updaten (Auch ID3-Tags auf Änderungen prüfen)...“ neu."_s);
}

void TagsPage::Load(const TMusicDatabase& database, const TRWReg&) {
    (database.ModernTags() ? modern_ : classic_)->setChecked(true);
}

void TagsPage::Apply(TMusicDatabase& database, TRWReg&) {
    database.SetModernTags(modern_->isChecked());
}
