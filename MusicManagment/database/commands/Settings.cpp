#include "MusicManagment/database/commands/Settings.h"

#include <optional>

#include "CommonRUKTools/RWReg.h"
#include "MusicManagment/database/MusicManagment.h"

using namespace Qt::StringLiterals;

namespace {

using Database = TMusicDatabase;

struct BoolSetting {
    QStringView Name;
    bool (Database::*Get)() const;
    void (Database::*Set)(bool);
};

constexpr BoolSetting kBools[] = {
    {u"Asynchronous", &Database::Asynchronous, &Database::SetAsynchronous},
    {u"AutoDelBannedFiles", &Database::AutoDelBannedFiles, &Database::SetAutoDelBannedFiles},
    {u"SortBackwards", &Database::SortBackwards, &Database::SetSortBackwards},
    {u"MoveMP3sAfterGenreChange", &Database::MoveMP3sAfterGenreChange,
     &Database::SetMoveMP3sAfterGenreChange},
    {u"UseWinAmpForLenCheck", &Database::UseWinAmpForLenCheck, &Database::SetUseWinAmpForLenCheck},
    {u"FollowFocus", &Database::FollowFocus, &Database::SetFollowFocus},
    {u"RenameAndMoveMP3s", &Database::RenameAndMoveMP3s, &Database::SetRenameAndMoveMP3s},
    {u"ModernTags", &Database::ModernTags, &Database::SetModernTags},
};

// The value when it is there and one of the `count` values of an enumeration.
template <typename Enum>
std::optional<Enum> ReadEnum(const TRWReg& settings, const QString& name, int count) {
    const auto value = settings.ReadInteger(name);
    return value && *value >= 0 && *value < count ? std::optional(static_cast<Enum>(*value)) : std::nullopt;
}

// NAME0, NAME1, ... up to the first that is missing.
QStringList ReadNumbered(const TRWReg& settings, const QString& name) {
    QStringList texts;
    while (const auto text = settings.ReadString(name + QString::number(texts.size())))
        texts << *text;
    return texts;
}

void LoadGenreFolders(Database& database, const TRWReg& settings) {
    const QStringList stored = ReadNumbered(settings, u"MP3MoveSubDirs"_s);
    database.SetMP3MoveSubDirs(stored.isEmpty() ? DefaultGenreFolderNames() : stored);
}

void SaveGenreFolders(const Database& database, TRWReg& settings) {
    const QStringList& names = database.MP3MoveSubDirs();
    for (qsizetype i = 0; i < names.size(); ++i)
        settings.WriteString(u"MP3MoveSubDirs"_s + QString::number(i), names[i]);
    settings.DeleteNumbered(u"MP3MoveSubDirs"_s, static_cast<int>(names.size()));
}

void LoadCdNames(Database& database, const TRWReg& settings) {
    const QStringList names = ReadNumbered(settings, u"CDName"_s);
    if (names.isEmpty()) return;
    std::vector<CdName> cds;
    for (qsizetype i = 0; i < names.size(); ++i) {
        const auto serial = settings.ReadInteger(u"CDSerialNr"_s + QString::number(i));
        cds.push_back({names[i], static_cast<quint32>(serial.value_or(0))});
    }
    database.SetCDNames(std::move(cds));
}

void SaveCdNames(const Database& database, TRWReg& settings) {
    int count = 0;
    for (const CdName& cd : database.CDNames()) {
        settings.WriteString(u"CDName"_s + QString::number(count), cd.Name);
        settings.WriteInteger(u"CDSerialNr"_s + QString::number(count), static_cast<int>(cd.Serial));
        ++count;
    }
    settings.DeleteNumbered(u"CDName"_s, count);
    settings.DeleteNumbered(u"CDSerialNr"_s, count);
}

// An interval that the setter would refuse counts as missing.
int StoredAutoSave(const TRWReg& settings) {
    const int interval = settings.ReadInteger(u"AutoSave"_s).value_or(0);
    return interval >= -1 ? interval : 0;
}

}  // namespace

void LoadDatabaseSettings(TMusicDatabase& database, const TRWReg& settings) {
    database.SetAutoSave(StoredAutoSave(settings));
    if (const auto level = ReadEnum<TCompressionLevel>(settings, u"Compression"_s, clMax + 1))
        database.SetCompression(*level);
    for (const BoolSetting& setting : kBools)
        if (const auto value = settings.ReadBool(setting.Name.toString())) (database.*setting.Set)(*value);
    if (const auto type = ReadEnum<TSortType>(settings, u"SortType"_s, stAlbumOrder + 1))
        database.SetSortType(*type);
    if (const auto type = ReadEnum<TSubSortType>(settings, u"SubSortType"_s, sstPath + 1))
        database.SetSubSortType(*type);
    if (const auto folder = settings.ReadString(u"MP3MoveRootDir"_s)) database.SetMP3MoveRootDir(*folder);
    if (const auto pattern = settings.ReadString(u"MP3NamePattern"_s)) database.SetMP3NamePattern(*pattern);
    LoadGenreFolders(database, settings);
    LoadCdNames(database, settings);
    database.Conversion().Load(settings);
    for (SettingsClient* client : database.SettingsClients())
        client->LoadSettings(settings);
}

void SaveDatabaseSettings(const TMusicDatabase& database, TRWReg& settings) {
    settings.WriteInteger(u"AutoSave"_s, database.AutoSave());
    settings.WriteInteger(u"Compression"_s, database.Compression());
    for (const BoolSetting& setting : kBools)
        settings.WriteBool(setting.Name.toString(), (database.*setting.Get)());
    settings.WriteInteger(u"SortType"_s, database.SortType());
    settings.WriteInteger(u"SubSortType"_s, database.SubSortType());
    settings.WriteString(u"MP3MoveRootDir"_s, database.MP3MoveRootDir());
    settings.WriteString(u"MP3NamePattern"_s, database.MP3NamePattern());
    SaveGenreFolders(database, settings);
    SaveCdNames(database, settings);
    database.Conversion().Save(settings);
    for (const SettingsClient* client : database.SettingsClients())
        client->SaveSettings(settings);
}
