#include <gtest/gtest.h>

#include <QJsonArray>

#include "CommonRUKTools/FileLock.h"
#include "cli/platform/Terminal.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedVolumes.h"
#include "tests/cli/CommandRunner.h"

using namespace Qt::StringLiterals;

// scan, list, groups and save together: what one writes the others read.

namespace {

class CollectionCommandsTest : public CommandTest {
 protected:
    void SetUp() override {
        PutWave(u"music/Zoe - Beta.wav"_s, 70);
        PutWave(u"music/Anna - Gamma.wav"_s, 3);
        PutWave(u"music/sub/Ötzi - Alpha.wav"_s, 200);
        Put(Path(u"music/notes.txt"_s), AsBytes("no song"));
    }

    CommandResult Run(const QString& command, const QStringList& more) const {
        return RunWords(QStringList{command, u"--db"_s, database_} + more);
    }
    CommandResult Scan(const QStringList& more = {}) const {
        return Run(u"scan"_s, QStringList{Path(u"music"_s)} + more);
    }
    // The values of one key, in the order of the lines.
    QStringList Listed(const QString& key, const QStringList& more) const {
        QStringList values;
        for (const auto& song : Run(u"list"_s, QStringList{u"--json"_s} + more).Objects())
            values << song[key].toVariant().toString();
        return values;
    }
    QByteArray DatabaseBytes() const { return folder_.Get(u"songs.tsdb"_s); }

    QString database_ = Path(u"songs.tsdb"_s);
};

}  // namespace

TEST_F(CollectionCommandsTest, WhatIsScannedIsListedInTheWantedOrder) {
    const auto scan = Scan();
    EXPECT_EQ(scan.Status, esDone);
    EXPECT_EQ(scan.Out, u"Es wurde(n) 3 neue(r) Song(s) in die Datenbank aufgenommen.\n"_s);
    EXPECT_EQ(scan.Err, QString());
    EXPECT_EQ(Listed(u"artist"_s, {}), (QStringList{u"Anna"_s, u"Ötzi"_s, u"Zoe"_s}));
    EXPECT_EQ(Listed(u"index"_s, {}), (QStringList{u"0"_s, u"1"_s, u"2"_s}));
    EXPECT_EQ(Listed(u"title"_s, {u"--sort"_s, u"stTitle"_s}),
              (QStringList{u"Alpha"_s, u"Beta"_s, u"Gamma"_s}));
    EXPECT_EQ(Listed(u"length"_s, {u"--sort=stLength"_s, u"--backwards"_s}),
              (QStringList{u"200"_s, u"70"_s, u"3"_s}));
    EXPECT_EQ(Listed(u"fileName"_s, {u"--subsort"_s, u"sstPath"_s}),
              (QStringList{Path(u"music/Anna - Gamma.wav"_s), Path(u"music/sub/Ötzi - Alpha.wav"_s),
                           Path(u"music/Zoe - Beta.wav"_s)}));
    EXPECT_EQ(Run(u"list"_s, {}).Out,
              u"0\tAnna\tGamma\t\t0:03\n1\tÖtzi\tAlpha\t\t3:20\n2\tZoe\tBeta\t\t1:10\n"_s);
}

TEST_F(CollectionCommandsTest, ASecondScanAddsOnlyWhatIsNew) {
    const auto first = Scan({u"--json"_s, u"--no-subfolders"_s}).Objects().at(0);
    EXPECT_EQ(first[u"added"_s], 2);
    EXPECT_EQ(first[u"files"_s].toArray().size(), 2);
    const auto second = Scan({u"--json"_s}).Objects().at(0);
    EXPECT_EQ(second[u"added"_s], 1);
    EXPECT_EQ(second[u"known"_s], 2);
    EXPECT_EQ(second[u"banned"_s], 0);
    EXPECT_EQ(second[u"unreadable"_s], 0);
    EXPECT_EQ(second[u"files"_s].toArray(), QJsonArray{Path(u"music/sub/Ötzi - Alpha.wav"_s)});
}

TEST_F(CollectionCommandsTest, APathIsTakenWholeAndAMissingOneIsAFailure) {
    const QString former = QDir::currentPath();
    ASSERT_TRUE(QDir::setCurrent(folder_.Path()));
    const auto result = Run(u"scan"_s, {u"music/../music/Zoe - Beta.wav"_s, u"nowhere"_s});
    QDir::setCurrent(former);
    EXPECT_EQ(result.Status, esFailed);
    EXPECT_TRUE(result.Err.contains(u"nowhere"_s)) << result.Err.toStdString();
    const QString song = QFileInfo(Path(u"music/Zoe - Beta.wav"_s)).canonicalFilePath();
    EXPECT_EQ(Listed(u"fileName"_s, {}), QStringList{song});
}

TEST_F(CollectionCommandsTest, AMediumIsCataloguedOnRequestAndKnownFromThenOn) {
    ScriptedVolumes volumes;
    volumes.Mount(QFileInfo(Path(u"music"_s)).canonicalFilePath(), 0x1A2B3C4D, u"STICK"_s);
    const QString beta = u":1A2B3C4D:\\Zoe - Beta.wav"_s;
    ASSERT_EQ(Scan({u"--no-subfolders"_s, u"--medium"_s, u"Mein Stick"_s}).Status, esDone);
    EXPECT_EQ(Listed(u"fileName"_s, {u"--sort=stArtist"_s}).last(), beta);
    const auto again = Scan({u"--json"_s}).Objects().at(0);
    EXPECT_EQ(again[u"known"_s], 2);
    EXPECT_EQ(again[u"files"_s].toArray(), QJsonArray{u":1A2B3C4D:\\sub\\Ötzi - Alpha.wav"_s});
    // A path is no name.
    EXPECT_EQ(Run(u"scan"_s, {u"--medium"_s, Path(u"music"_s)}).Status, esDone);
}

TEST_F(CollectionCommandsTest, AnInterruptedScanKeepsWhatItHas) {
    ASSERT_EQ(Scan({u"--no-subfolders"_s}).Status, esDone);
    RequestInterrupt();
    const auto whileReading = Scan();
    EXPECT_EQ(whileReading.Status, esFailed);
    EXPECT_EQ(Listed(u"index"_s, {}).size(), 2);

    ASSERT_TRUE(QFile::remove(database_));
    RequestInterrupt();  // a new database is not read, so it is the intake that stops
    const auto result = Scan();
    EXPECT_EQ(result.Status, esFailed);
    EXPECT_TRUE(result.Err.contains(u"Abgebrochen"_s));
    EXPECT_TRUE(QFile::exists(database_));
    EXPECT_EQ(Scan().Status, esDone);  // the next run knows nothing of it
}

TEST_F(CollectionCommandsTest, GroupsStandInTheOrderOfTheirLists) {
    ASSERT_EQ(Scan().Status, esDone);
    EXPECT_EQ(Run(u"groups"_s, {u"--by"_s, u"length"_s}).Out,
              u"Unter einer Minute\t1\n1 bis 2 Minuten\t1\n3 bis 4 Minuten\t1\n"_s);
    EXPECT_EQ(Run(u"groups"_s, {u"--by"_s, u"year"_s, u"--json"_s}).Out,
              u"{\"caption\":\"Unbekannt\",\"count\":3}\n"_s);
}

TEST_F(CollectionCommandsTest, SavingKeepsTheSongsAtTheWantedCompression) {
    ASSERT_EQ(Scan().Status, esDone);
    const QString list = Run(u"list"_s, {u"--json"_s}).Out;
    const QString plain = Path(u"plain"_s);
    ASSERT_EQ(Run(u"save"_s, {u"--out"_s, plain, u"--compression"_s, u"none"_s}).Status, esDone);
    EXPECT_GT(QFileInfo(plain).size(), 2 * QFileInfo(database_).size());
    ASSERT_EQ(RunWords({u"save"_s, u"--db"_s, plain, u"--out"_s, plain}).Status, esDone);
    EXPECT_EQ(QFileInfo(plain).size(), QFileInfo(database_).size());
    EXPECT_EQ(RunWords({u"list"_s, u"--json"_s, u"--db"_s, plain}).Out, list);
}

TEST_F(CollectionCommandsTest, BannedSongsAreCountedAndStayOutside) {
    folder_.Put(u"banned.str"_s, "Zoe - Beta\r\n");
    const auto scan = Scan({u"--bannlist"_s, Path(u"banned.str"_s), u"--json"_s});
    EXPECT_EQ(scan.Objects().at(0)[u"banned"_s], 1);
    EXPECT_EQ(Listed(u"artist"_s, {}), (QStringList{u"Anna"_s, u"Ötzi"_s}));
    EXPECT_EQ(Scan({u"--bannlist"_s, Path(u"none.str"_s)}).Status, esFailed);
}

TEST_F(CollectionCommandsTest, APathThatWasMistypedMakesNoDatabase) {
    const auto scan = Run(u"scan"_s, {Path(u"musik"_s)});
    EXPECT_EQ(scan.Status, esFailed);
    EXPECT_TRUE(scan.Err.contains(Path(u"musik"_s)));
    EXPECT_EQ(Run(u"list"_s, {}).Status, esFailed);
    EXPECT_EQ(QDir(folder_.Path()).entryList(QDir::Files | QDir::Hidden), QStringList());
}

TEST_F(CollectionCommandsTest, WhatAnotherProgramHasOpenIsReadButNotWritten) {
    ASSERT_EQ(Scan({u"--no-subfolders"_s}).Status, esDone);
    const FileLock window(database_);
    for (const auto& result : {Scan(), Run(u"save"_s, {u"--out"_s, database_})}) {
        EXPECT_EQ(result.Status, esFailed);
        EXPECT_TRUE(result.Err.contains(u"(Prozess "_s)) << result.Err.toStdString();
    }
    EXPECT_EQ(Listed(u"index"_s, {}).size(), 2);
    EXPECT_EQ(Run(u"save"_s, {u"--out"_s, Path(u"copy.tsdb"_s)}).Status, esDone);
}

TEST_F(CollectionCommandsTest, ADamagedDatabaseIsNeverWritten) {
    Put(database_, AsBytes("this is no database"));
    const QByteArray before = DatabaseBytes();
    for (const auto& result : {Scan(), Run(u"list"_s, {}), Run(u"groups"_s, {u"--by"_s, u"album"_s}),
                               Run(u"save"_s, {u"--out"_s, Path(u"out"_s)})}) {
        EXPECT_EQ(result.Status, esFailed);
        EXPECT_EQ(result.Out, QString());
        EXPECT_TRUE(result.Err.contains(u"Dies ist keine gültige Datenbank."_s)) << result.Err.toStdString();
    }
    EXPECT_EQ(DatabaseBytes(), before);
    EXPECT_FALSE(QFile::exists(Path(u"out"_s)));
    database_ = Path(u"no folder/songs.tsdb"_s);
    EXPECT_EQ(Scan().Status, esFailed);
    EXPECT_EQ(RunWords({u"list"_s, u"--db"_s, Path(u"missing"_s)}).Status, esFailed);
}
