#include <gtest/gtest.h>

#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/tsdb/DatabaseFile.h"
#include "tests/ErrorOf.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

class DatabaseCommandsTest : public testing::Test {
 protected:
    QString Path(const QString& name) const { return folder_.Path(name); }
    QStringList FilesThere() const { return QDir(folder_.Path()).entryList(QDir::Files | QDir::Hidden); }

    static void AddSongs(TMusicDatabase& database, int count) {
        for (int i = 0; i < count; ++i) {
            TID3Tag song;
            song.FileName = u"/m/%1.mp3"_s.arg(i, 5);
            song.Artist = u"Artist %1"_s.arg(i % 3);
            song.Year = u"1999"_s;
            song.AddTime = 1;
            database.AddEntry(QString(), song, AddAs::Returning);
        }
        database.RecountGroups();
    }
    static int SongsIn(const QString& path) {
        TMusicDatabase database;
        database.OpenDatabase(path);
        return database.Count();
    }
    static void StopAt(TMusicDatabase& database, qint64 song) {
        database.OnProgress = [song](TMusicDatabase& sender, const ProgressPoint& point) {
            if (point.Cur == song) sender.RequestAbort();
        };
    }

    SongFolder folder_;
    ScriptedDialogs dialogs_;
};

}  // namespace

TEST_F(DatabaseCommandsTest, TheNameIsAskedForOnlyWhenItMustAndKeptWhenTold) {
    const QString a = Path(u"a.tsdb"_s);
    TMusicDatabase database;
    AddSongs(database, 3);
    EXPECT_FALSE(database.SaveDatabase());  // no name yet, and the user cancels
    EXPECT_FALSE(database.OpenDatabaseFromDialog());
    EXPECT_TRUE(FilesThere().isEmpty());
    ASSERT_EQ(dialogs_.FileDialogs.size(), 2u);
    EXPECT_EQ(dialogs_.FileDialogs[0].Title, u"Datenbank speichern unter"_s);
    EXPECT_TRUE(dialogs_.FileDialogs[0].ConfirmOverwrite);
    EXPECT_EQ(dialogs_.FileDialogs[1].Title, u"Datenbank öffnen"_s);

    dialogs_.Files.push_back({a});
    EXPECT_TRUE(database.SaveDatabase());
    EXPECT_TRUE(database.SaveDatabase());  // by its name now
    EXPECT_TRUE(database.SaveDatabase(Path(u"b.tsdb"_s), true));
    EXPECT_EQ(database.FileName(), a);
    dialogs_.Files.push_back({Path(u"c.tsdb"_s)});
    EXPECT_TRUE(database.SaveDatabase(Path(u"b.tsdb"_s), false, true));
    EXPECT_EQ(dialogs_.FileDialogs.back().Preset, Path(u"b.tsdb"_s));
    EXPECT_EQ(database.FileName(), Path(u"c.tsdb"_s));
    EXPECT_EQ(FilesThere(), (QStringList{u"a.tsdb"_s, u"b.tsdb"_s, u"c.tsdb"_s}));

    dialogs_.Files.push_back({a});
    EXPECT_TRUE(database.OpenDatabaseFromDialog());
    EXPECT_EQ(database.FileName(), a);
    EXPECT_TRUE(database.OpenDatabase(QString(), true));
    EXPECT_EQ(database.Count(), 0);
    EXPECT_EQ(database.FileName(), a);
    EXPECT_TRUE(database.OpenDatabase(Path(u"b.tsdb"_s), true));
    EXPECT_EQ(database.FileName(), a);
    EXPECT_TRUE(database.OpenDatabase(QString()));
    EXPECT_EQ(database.FileName(), QString());
}

TEST_F(DatabaseCommandsTest, AStoppedSaveLeavesTheOldFileAndNoTemporary) {
    TMusicDatabase database;
    AddSongs(database, 120);
    ASSERT_TRUE(database.SaveDatabase(Path(u"a.tsdb"_s)));
    AddSongs(database, 30);
    StopAt(database, 100);
    EXPECT_FALSE(database.SaveDatabase());
    EXPECT_TRUE(database.Modified());
    EXPECT_FALSE(database.Busy() || database.ProgressRunning());
    EXPECT_EQ(FilesThere(), QStringList{u"a.tsdb"_s});
    EXPECT_EQ(SongsIn(Path(u"a.tsdb"_s)), 120);

    // What the writer leaves then holds the songs written.
    SafeFile file(Path(u"part.tsdb"_s));
    EXPECT_FALSE(WriteDatabase(database, file));
    file.Commit();
    EXPECT_EQ(SongsIn(Path(u"part.tsdb"_s)), 100);
}

TEST_F(DatabaseCommandsTest, ASaveThatCannotReplaceItsTargetKeepsTheDatabaseModified) {
    ASSERT_TRUE(QDir(folder_.Path()).mkdir(u"taken"_s));
    const QString target = Path(u"taken"_s);
    TMusicDatabase database;
    AddSongs(database, 1);
    EXPECT_EQ(ErrorOf([&] { database.SaveDatabase(target); }),
              u"Fehler beim Speichern: Kann "_s + target + u".tmp nicht in "_s + target + u" umbenennen"_s);
    EXPECT_TRUE(database.Modified());
    EXPECT_EQ(database.FileName(), QString());
    EXPECT_TRUE(FilesThere().isEmpty());
    EXPECT_NE(ErrorOf([&] { database.SaveDatabase(Path(u"none/a.tsdb"_s)); }), QString());
}

TEST_F(DatabaseCommandsTest, SongsCannotChangeBetweenTheProgressPointsOfASave) {
    TMusicDatabase database;
    AddSongs(database, 60);
    std::vector<qint64> points;
    database.OnProgress = [&](TMusicDatabase& sender, const ProgressPoint& point) {
        points.push_back(point.Cur);
        EXPECT_FALSE(sender.RemoveEntry(0));
    };
    EXPECT_TRUE(database.SaveDatabase(Path(u"a.tsdb"_s)));
    EXPECT_EQ(points, (std::vector<qint64>{0, 50}));
}

TEST_F(DatabaseCommandsTest, LoadingTellsTheViewsInOrder) {
    TMusicDatabase saved;
    AddSongs(saved, 51);
    saved.SaveDatabase(Path(u"a.tsdb"_s));

    TMusicDatabase database;
    AddSongs(database, 2);
    QStringList events;
    database.OnChange = [&](TMusicDatabase& sender, SongIndex index, TChangeType change) {
        events << u"change %1 %2 of %3"_s.arg(index).arg(change).arg(sender.Count());
    };
    database.OnClear = [&](TMusicDatabase&) { events << u"clear"_s; };
    database.OnStartProgress = [&](TMusicDatabase& sender) { events << sender.Caption(); };
    database.OnPrepareMultiAdd = [&](TMusicDatabase&, int count) { events << u"prepare %1"_s.arg(count); };
    database.OnProgress = [&](TMusicDatabase& sender, const ProgressPoint& point) {
        events << u"%1 of %2"_s.arg(point.Cur).arg(point.Max);
        EXPECT_TRUE(sender.Loading());
        EXPECT_EQ(point.Type, ptLoadDatabase);
    };
    database.OnOverviewChanged = [&](TMusicDatabase&) { events << u"overview"_s; };
    database.OnEndProgress = [&](TMusicDatabase&) { events << u"end"_s; };
    ASSERT_TRUE(database.OpenDatabase(Path(u"a.tsdb"_s)));
    EXPECT_EQ(events,
              (QStringList{u"overview"_s, u"change -1 2 of 0"_s, u"clear"_s,
                           u"MusicDatabase v6.0 - Entpacke und lese Datenbank"_s, u"prepare 51"_s,
                           u"0 of 51"_s, u"50 of 51"_s, u"overview"_s, u"end"_s, u"change -1 0 of 51"_s}));
}

TEST_F(DatabaseCommandsTest, AStoppedLoadKeepsItsSongsAndCountsThemButNotTheName) {
    TMusicDatabase saved;
    AddSongs(saved, 120);
    saved.SaveDatabase(Path(u"a.tsdb"_s));

    TMusicDatabase database;
    database.SetFileName(Path(u"old.tsdb"_s));
    int changes = 0;
    database.OnChange = [&](TMusicDatabase&, SongIndex, TChangeType change) {
        changes += change == ctChanged;
    };
    StopAt(database, 100);
    EXPECT_FALSE(database.OpenDatabase(Path(u"a.tsdb"_s)));
    EXPECT_EQ(database.Count(), 100);
    EXPECT_EQ(database.Artists().At(0).Number, 40);
    EXPECT_EQ(database.Artists().At(2).Number, 20);
    EXPECT_EQ(database.Lengths().At(0).Number, 100);
    EXPECT_EQ(database.FileName(), QString());
    EXPECT_EQ(changes, 1);
    EXPECT_FALSE(database.Loading() || database.ProgressRunning() || database.Modified());
}

TEST_F(DatabaseCommandsTest, AFileThatCannotBeOpenedLeavesTheDatabaseAsItIs) {
    TMusicDatabase database;
    AddSongs(database, 3);
    for (const QString& path : {Path(u"none.tsdb"_s), folder_.Path()}) {
        const QString message = ErrorOf([&] { database.OpenDatabase(path); });
        EXPECT_TRUE(message.startsWith(u"Die Datenbank konnte nicht geöffnet werden\n"_s))
            << message.toStdString();
        EXPECT_EQ(database.Count(), 3);
    }
}

TEST_F(DatabaseCommandsTest, NothingIsTouchedWhileAnotherRunIsGoing) {
    TMusicDatabase database;
    AddSongs(database, 3);
    database.SaveDatabase(Path(u"a.tsdb"_s));
    {
        const ProgressRun run(database, u"Anderes"_s);
        EXPECT_THROW(database.OpenDatabase(Path(u"a.tsdb"_s)), EAbort);
        EXPECT_THROW(database.OpenDatabase(QString()), EAbort);
        EXPECT_THROW(database.SaveDatabase(Path(u"a.tsdb"_s)), EAbort);
        EXPECT_TRUE(database.ProgressRunning());
    }
    database.BeginBusy();
    EXPECT_NE(ErrorOf([&] { database.OpenDatabase(Path(u"a.tsdb"_s)); }), QString());
    database.EndBusy();
    EXPECT_EQ(database.Count(), 3);
    EXPECT_EQ(database.FileName(), Path(u"a.tsdb"_s));
    EXPECT_EQ(dialogs_.Messages.size(), 3);
    EXPECT_EQ(FilesThere(), QStringList{u"a.tsdb"_s});
}

TEST_F(DatabaseCommandsTest, OneProgramWritesAFileAndTheLaterOneReadsIt) {
    TMusicDatabase first;
    AddSongs(first, 3);
    first.Lock().SetWanted(true);
    ASSERT_TRUE(first.SaveDatabase(Path(u"a.tsdb"_s)));
    {
        TMusicDatabase later;
        later.Lock().SetWanted(true);
        ASSERT_TRUE(later.OpenDatabase(Path(u"a.tsdb"_s)));
        EXPECT_EQ(later.Count(), 3);
        EXPECT_TRUE(later.ReadOnly());
        ASSERT_EQ(dialogs_.Messages.size(), 1);
        EXPECT_TRUE(dialogs_.Messages[0].contains(u"(Prozess "_s));
        EXPECT_NE(ErrorOf([&] { later.SaveDatabase(); }), QString());
        EXPECT_TRUE(later.SaveDatabase(Path(u"b.tsdb"_s)));
        EXPECT_FALSE(later.ReadOnly()) << "a file of its own";
        EXPECT_NE(ErrorOf([&] { later.SaveDatabase(Path(u"a.tsdb"_s), true); }), QString());
        EXPECT_NE(ErrorOf([&] { first.SaveDatabase(Path(u"b.tsdb"_s), true); }), QString());
    }
    EXPECT_TRUE(first.SaveDatabase());
    EXPECT_TRUE(first.OpenDatabase(QString()));
    TMusicDatabase reader;
    EXPECT_TRUE(reader.OpenDatabase(Path(u"a.tsdb"_s)));
    EXPECT_EQ(FilesThere(), (QStringList{u"a.tsdb"_s, u"b.tsdb"_s})) << "readers lock nothing";
}
