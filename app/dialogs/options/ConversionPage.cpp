#include "app/dialogs/options/ConversionPage.h"

#include <QFileInfo>
#include <QFormLayout>
#include <QLineEdit>

#include "MusicManagment/conversion/EncoderScript.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/commands/DatabaseSettings.h"
#include "app/desktop/Icons.h"

using namespace Qt::StringLiterals;

namespace {

// A value of the conversion as a property of the database.
auto PropertyOf(const Setting<QString>& row, QString ConversionSettings::*member) {
    return PropertySetting(
        row, [member](const TMusicDatabase& database) { return database.Conversion().*member; },
        [member](TMusicDatabase& database, const QString& value) {
            database.Conversion().*member = value.trimmed();
        });
}

}  // namespace

ConversionPage::ConversionPage()
    : OptionsPage(u"Konvertierung"_s, ThemeIcon(u"document-export"_s, QStyle::SP_MediaVolume)) {
    QFormLayout& group = AddGroup(u"Windows Media (WMA)"_s);
    script_ = AddField(group, u"WMAEncoderScript"_s, u"&Encoder-Skript"_s, new QLineEdit,
                       u"Das Programm, das WMA-Dateien macht, mit vollständigem Pfad"_s);
    script_->setPlaceholderText(u"das mitgelieferte (braucht ffmpeg)"_s);
    auto* arguments = AddField(group, u"WMAEncoderArguments"_s, u"A&rgumente"_s, new QLineEdit,
                               u"Leerzeichen trennen; was zusammengehört, steht in Anführungszeichen."_s);
    arguments->setPlaceholderText(kUsualScriptArguments);
    AddExplanation(group,
                   u"Das Skript wird ohne Shell gestartet. %SOURCE% steht für eine WAV-Datei, %TARGET% für "
                   "die Datei, die es schreiben soll, und %RATE% für die Bitrate in kbit/s."_s);
    fields_.Bind(script_, PropertyOf(DatabaseSettings::kWmaScript.Row, &ConversionSettings::WmaScript));
    fields_.Bind(arguments,
                 PropertyOf(DatabaseSettings::kWmaArguments.Row, &ConversionSettings::WmaArguments));
}

std::optional<OptionsFault> ConversionPage::Check() {
    const QString script = script_->text().trimmed();
    const QFileInfo file(script);
    if (script.isEmpty() || (file.isAbsolute() && file.isFile() && file.isExecutable())) return std::nullopt;
    return OptionsFault{u"Das Encoder-Skript ist kein ausführbares Programm: "_s + script, script_};
}
