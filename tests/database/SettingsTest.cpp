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
        const QString name = setting.Row.Name.toString();
        if (name == u"MP3MoveRootDir") return;  // depends on the user's folders
        EXPECT_EQ(setting.Of(fresh), DefaultValue(setting.Row)) << name.toStdString();
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

TEST_F(SettingsTest, DamagedValuesCountAsMissing) {
    settings_.WriteInteger(u"SortType"_s, 99);
    settings_.WriteInteger(u"AutoSave"_s, -7);
    settings_.WriteString(u"SortBackwards"_s, u"ja"_s);
    settings_.WriteBinary(u"WAVEncoderSettings"_s, "zu kurz");
    TMusicDatabase database;
    LoadDatabaseSettings(database, settings_);
    EXPECT_EQ(database.SortType(), stGenre);
    EXPECT_EQ(database.AutoSave(), 0);
    EXPECT_FALSE(database.SortBackwards());
    EXPECT_EQ(database.Conversion().Wav, QByteArray(12, '\0'));
}
