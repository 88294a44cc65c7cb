#include "MusicManagment/database/commands/Settings.h"

#include "CommonRUKTools/RWReg.h"
#include "MusicManagment/database/commands/DatabaseSettings.h"

namespace {

using namespace DatabaseSettings;

QString Numbered(QStringView name, qsizetype index) {
    return name.toString() + QString::number(index);
}

// NAME0, NAME1, ... up to the first that is missing.
QStringList ReadNumbered(const TRWReg& settings, QStringView name) {
    QStringList texts;
    while (const auto text = settings.ReadString(Numbered(name, texts.size())))
        texts << *text;
    return texts;
}

void LoadGenreFolders(TMusicDatabase& database, const TRWReg& settings) {
    const QStringList stored = ReadNumbered(settings, kGenreFolder);
    database.SetMP3MoveSubDirs(stored.isEmpty() ? DefaultGenreFolderNames() : stored);
}

void SaveGenreFolders(const TMusicDatabase& database, TRWReg& settings) {
    const QStringList& names = database.MP3MoveSubDirs();
    for (qsizetype i = 0; i < names.size(); ++i)
        settings.WriteString(Numbered(kGenreFolder, i), names[i]);
    settings.DeleteNumbered(kGenreFolder.toString(), static_cast<int>(names.size()));
}

void LoadCdNames(TMusicDatabase& database, const TRWReg& settings) {
    const QStringList names = ReadNumbered(settings, kCdName);
    if (names.isEmpty()) return;
    std::vector<CdName> cds;
    for (qsizetype i = 0; i < names.size(); ++i) {
        const auto serial = settings.ReadInteger(Numbered(kCdSerial, i));
        cds.push_back({names[i], static_cast<quint32>(serial.value_or(0))});
    }
    database.SetCDNames(std::move(cds));
}

void SaveCdNames(const TMusicDatabase& database, TRWReg& settings) {
    int count = 0;
    for (const CdName& cd : database.CDNames()) {
        settings.WriteString(Numbered(kCdName, count), cd.Name);
        settings.WriteInteger(Numbered(kCdSerial, count), static_cast<int>(cd.Serial));
        ++count;
    }
    settings.DeleteNumbered(kCdName.toString(), count);
    settings.DeleteNumbered(kCdSerial.toString(), count);
}

}  // namespace

void LoadDatabaseSettings(TMusicDatabase& database, const TRWReg& settings) {
    LoadSettingsOf(database, kAll, settings);
    if (!ReadSetting(settings, kAutoSave.Row)) database.SetAutoSave(kAutoSave.Row.Default);
    LoadGenreFolders(database, settings);
    LoadCdNames(database, settings);
    LoadSettingsOf(database.Conversion(), kConversion, settings);
    for (SettingsClient* client : database.SettingsClients())
        client->LoadSettings(settings);
}

void SaveDatabaseSettings(const TMusicDatabase& database, TRWReg& settings) {
    SaveSettingsOf(database, kAll, settings);
    SaveGenreFolders(database, settings);
    SaveCdNames(database, settings);
    SaveSettingsOf(database.Conversion(), kConversion, settings);
    for (const SettingsClient* client : database.SettingsClients())
        client->SaveSettings(settings);
}
