#include <gtest/gtest.h>

#include <QJsonArray>

#include "tests/PrintQt.h"
#include "tests/cli/CommandRunner.h"

using namespace Qt::StringLiterals;

// tag, rename, batch, ban, trash and undo, with a journal and a bin of the test's own.

namespace {

class ChangeCommandsTest : public CommandTest {
 protected:
    ChangeCommandsTest() {
        folder_.Put(u"data/x"_s, QByteArray());
        qputenv("XDG_DATA_HOME", QFile::encodeName(Path(u"data"_s)));
        for (const QString& name : {u"Anna - A.wav"_s, u"Anna - B.wav"_s, u"Zoe - C.wav"_s})
            PutWave(u"music/"_s + name);
        RunWords({u"scan"_s, u"--db"_s, database_, Path(u"music"_s)});
    }
    ~ChangeCommandsTest() override { qunsetenv("XDG_DATA_HOME"); }

    CommandResult Run(const QString& command, const QStringList& more) const {
        return RunWords(QStringList{command, u"--db"_s, database_} + more);
    }
    QString Song(const QString& name) const { return Path(u"music/"_s + name); }
    QStringList Files() const { return QDir(Path(u"music"_s)).entryList(QDir::Files); }

    QString database_ = Path(u"songs.tsdb"_s);
};

}  // namespace

TEST_F(ChangeCommandsTest, ATagIsShownWrittenAndTakenBack) {
    const QByteArray before = folder_.Get(u"music/Anna - A.wav"_s);
    const QStringList change{u"--set"_s,  u"album=LP"_s,          u"--set"_s, u"title=X"_s, u"--rename"_s,
                             u"--json"_s, Song(u"Anna - A.wav"_s)};
    const auto trial = Run(u"tag"_s, QStringList{u"--dry-run"_s} + change);
    EXPECT_EQ(folder_.Get(u"music/Anna - A.wav"_s), before);
    const auto done = Run(u"tag"_s, change);
    EXPECT_EQ(done.Status, esDone);
    EXPECT_EQ(done.Out, trial.Out);
    ASSERT_EQ(done.Objects().size(), 3u);  // name, title, album
    EXPECT_EQ(done.Objects()[2][u"new"_s], u"LP"_s);
    EXPECT_EQ(Files(), (QStringList{u"Anna - B.wav"_s, u"Anna - X.wav"_s, u"Zoe - C.wav"_s}));
    EXPECT_EQ(RunWords({u"undo"_s, u"--list"_s, u"--json"_s}).Objects().at(0)[u"caption"_s], u"1 Tag"_s);
    EXPECT_EQ(RunWords({u"undo"_s}).Status, esDone);
    EXPECT_EQ(folder_.Get(u"music/Anna - A.wav"_s), before);
    EXPECT_EQ(RunWords({u"undo"_s}).Status, esFailed);
    EXPECT_EQ(Run(u"tag"_s, {u"--set"_s, u"year=99"_s, Song(u"Zoe - C.wav"_s)}).Status, esWrongUsage);
    EXPECT_EQ(Run(u"tag"_s, {u"--set"_s, u"year=1999"_s, Song(u"no.wav"_s)}).Status, esFailed);
}

TEST_F(ChangeCommandsTest, FilesAreRenamedUnlessSomethingIsInTheWay) {
    const auto renamed = Run(u"rename"_s, {u"--pattern"_s, u"%ARTIST%"_s, u"--json"_s, u"--all"_s});
    EXPECT_EQ(renamed.Status, esFailed);
    int problems = 0;
    for (const auto& song : renamed.Objects())
        problems += song[u"problem"_s].isNull() ? 0 : 1;
    EXPECT_EQ(problems, 1);  // the second one of Anna
    EXPECT_EQ(Files(), (QStringList{u"Anna - B.wav"_s, u"Anna.wav"_s, u"Zoe.wav"_s}));
    EXPECT_EQ(Run(u"rename"_s, {u"--filter"_s, u"titel:c"_s}).Status, esDone);
    EXPECT_TRUE(Files().contains(u"Zoe - C.wav"_s));
    EXPECT_EQ(Run(u"rename"_s, {u"--all"_s, u"--filter"_s, u"a"_s}).Status, esWrongUsage);
}

TEST_F(ChangeCommandsTest, SongsAreFlaggedBannedAndBroughtBack) {
    const auto flagged = Run(u"batch"_s, {u"--do"_s, u"set-flag=Gebrannt"_s, u"--json"_s, u"--all"_s});
    EXPECT_EQ(flagged.Objects().at(0)[u"changed"_s], 3);
    EXPECT_EQ(Run(u"batch"_s, {u"--do"_s, u"set-flag=Rot"_s, u"--all"_s}).Status, esWrongUsage);
    const QString bans = Path(u"bans.str"_s);
    EXPECT_EQ(Run(u"ban"_s, {u"--bannlist"_s, bans, Song(u"Zoe - C.wav"_s)}).Status, esDone);
    EXPECT_EQ(Run(u"ban"_s, {u"--bannlist"_s, bans, u"--list"_s}).Out, u"Zoe - C\n"_s);
    EXPECT_EQ(Run(u"trash"_s, {Song(u"Anna - B.wav"_s)}).Status, esDone);
    EXPECT_EQ(Files(), QStringList{u"Anna - A.wav"_s});
    RunWords({u"scan"_s, u"--db"_s, Path(u"other.tsdb"_s), Path(u"music"_s)});
    const auto refused = RunWords({u"undo"_s, u"--db"_s, Path(u"other.tsdb"_s)});
    EXPECT_TRUE(refused.Status == esFailed && refused.Err.contains(database_ + u" (anzugeben mit --db)"_s));
    EXPECT_EQ(RunWords({u"undo"_s}).Status, esDone);
    EXPECT_EQ(RunWords({u"undo"_s, u"--bannlist"_s, bans}).Status, esDone);
    EXPECT_EQ(Files().size(), 3);
    EXPECT_EQ(Run(u"list"_s, {}).Out.count(u'\n'), 3);
    EXPECT_EQ(Run(u"ban"_s, {u"--bannlist"_s, bans, u"--list"_s}).Out, QString());
}

TEST_F(ChangeCommandsTest, WhatAKilledProgramCouldNotSaveIsCaughtUpWithFirst) {
    const QByteArray saved = folder_.Get(u"songs.tsdb"_s);
    const QDateTime savedAt = QFileInfo(database_).lastModified();
    const auto loseTheSave = [&] {
        folder_.Put(u"songs.tsdb"_s, saved);
        QFile file(database_);
        ASSERT_TRUE(file.open(QIODevice::ReadWrite) &&
                    file.setFileTime(savedAt, QFileDevice::FileModificationTime));
    };
    ASSERT_EQ(Run(u"tag"_s, {u"--set"_s, u"title=X"_s, Song(u"Anna - A.wav"_s)}).Status, esDone);
    loseTheSave();
    EXPECT_EQ(Run(u"scan"_s, {Path(u"music"_s)}).Status, esDone);
    EXPECT_TRUE(Run(u"list"_s, {}).Out.contains(u"\tX\t"_s));
    loseTheSave();
    EXPECT_EQ(Run(u"rename"_s, {u"--pattern"_s, u"%TITLE%"_s, u"--all"_s}).Status, esDone);
    EXPECT_EQ(Files(), (QStringList{u"B.wav"_s, u"C.wav"_s, u"X.wav"_s}));
}
