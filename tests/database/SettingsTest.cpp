#include "MusicManagment/database/commands/Settings.h"

#include <gtest/gtest.h>

#include <QTemporaryDir>

#include "CommonRUKTools/RWReg.h"
#include "MusicManagment/database/commands/DatabaseSettings.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

class SettingsTest : public testing::Test {
 protected:
    QTemporaryDir folder_;
    TRWReg settings_{u"\\Software\\RUK\\Tunestead3"_s, folder_.filePath(u"s.conf"_s)};
};

class VolumeClient : public SettingsClient {
 public:
    void LoadSettings(const TRWReg& settings) override {
        Volume = settings.ReadInteger(u"Volume"_s).value_or(Volume);
    }
    void SaveSettings(TRWReg& settings) const override { settings.WriteInteger(u"Volume"_s, Volume); }
    int Volume = 50;
};

}  // namespace

TEST_F(SettingsTest, AnEmptyStoreKeepsEverythingButAutoSaveAndGenreFolders) {
    TMusicDatabase database;
    database.SetAutoSave(60'000);
    database.SetSortType(stYear);
    database.SetMP3NamePattern(u"%TITLE%"_s);
    EXPECT_EQ(database.MP3MoveSubDirs()[3], u"Hard Rock, Heavy Metal"_s);
    LoadDatabaseSettings(database, settings_);
    EXPECT_EQ(database.AutoSave(), 0);
    EXPECT_EQ(database.SortType(), stYear);
    EXPECT_EQ(database.MP3NamePattern(), u"%TITLE%"_s);
    EXPECT_EQ(database.MP3MoveSubDirs(), DefaultGenreFolderNames());
}

// A component that nobody has set is what its table says, and the limits of the table are taken.
TEST_F(SettingsTest, TheTableAndTheDatabaseAgree) {
    const TMusicDatabase fresh;
    ForEachSetting(DatabaseSettings::kAll, [&](const auto& setting) {
        if (setting.Row.Name != u"MP3MoveRootDir")  // depends on the user's folders
            EXPECT_EQ(setting.Of(fresh), DefaultValue(setting.Row))
                << setting.Row.Name.toString().toStdString();
    });
    TMusicDatabase stored;
    stored.SetCDNames({{u"Rock 1"_s, 0xFEDCBA98}, {u"Jazz"_s, 7}});
    stored.Conversion().Wma = QByteArray("0123456789");
    UseRules(stored, Rules::Modern);
    SaveDatabaseSettings(stored, settings_);
    TMusicDatabase loaded;
    LoadDatabaseSettings(loaded, settings_);
    ASSERT_EQ(loaded.CDNames().size(), 2u);
    EXPECT_EQ(loaded.CDNames()[1].Serial, 0xFEDCBA98);
    EXPECT_EQ(loaded.Conversion().Wma, QByteArray("0123456789"));
    ForEachSetting(DatabaseSettings::kRules, [&](const auto& pair) { EXPECT_TRUE(pair.Of(loaded)); });
}

TEST_F(SettingsTest, ShorterListsAreFilledUpAndLeaveNoStaleValues) {
    for (int i = 0; i < 5; ++i)
        settings_.WriteString(u"MP3MoveSubDirs"_s + QString::number(i), u"Ordner/"_s);
    settings_.WriteString(u"MP3MoveSubDirs25"_s, u"stale"_s);
    TMusicDatabase database;
    database.SetCDNames({{u"A"_s, 1}, {u"B"_s, 2}});
    LoadDatabaseSettings(database, settings_);
    EXPECT_EQ(database.MP3MoveSubDirs()[4], u"Ordner"_s);
    EXPECT_EQ(database.MP3MoveSubDirs()[5], u"Genre #5"_s);
    SaveDatabaseSettings(database, settings_);
    database.SetCDNames({{u"B"_s, 2}});
    SaveDatabaseSettings(database, settings_);
    EXPECT_FALSE(settings_.Exists(u"CDName1"_s));
    EXPECT_FALSE(settings_.Exists(u"CDSerialNr1"_s));
}

TEST_F(SettingsTest, DamagedValuesCountAsMissingAndClientsJoin) {
    settings_.WriteInteger(u"SortType"_s, 99);
    settings_.WriteInteger(u"AutoSave"_s, -7);
    settings_.WriteString(u"SortBackwards"_s, u"ja"_s);
    settings_.WriteBinary(u"WAVEncoderSettings"_s, "zu kurz");
    settings_.WriteInteger(u"Volume"_s, 80);
    TMusicDatabase database;
    VolumeClient client;
    database.JoinSettings(client);
    LoadDatabaseSettings(database, settings_);
    EXPECT_EQ(database.SortType(), stGenre);
    EXPECT_EQ(database.AutoSave(), 0);
    EXPECT_FALSE(database.SortBackwards());
    EXPECT_EQ(database.Conversion().Wav, QByteArray(12, '\0'));
    EXPECT_EQ(client.Volume, 80);
    database.LeaveSettings(client);
    client.Volume = 10;
    LoadDatabaseSettings(database, settings_);
    EXPECT_EQ(client.Volume, 10);
}
