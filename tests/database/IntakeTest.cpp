#include "MusicManagment/database/intake/Intake.h"

#include <gtest/gtest.h>

#include "CommonRUKTools/Shell.h"
#include "tests/ErrorOf.h"
#include "tests/HandClock.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/database/Listing.h"
#include "tests/database/RecordingTrash.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

class IntakeTest : public testing::Test {
 protected:
    IntakeTest() {
        database_.SetAsynchronous(false);
        database_.OnStartProgress = [this](TMusicDatabase& database) { runs_ << database.Caption(); };
        database_.OnProgress = [this](TMusicDatabase& database, const ProgressPoint& point) {
            points_.push_back(point);
            if (stopAt_ == static_cast<int>(points_.size())) database.RequestAbort();
        };
    }

    // Positions of the points of one type.
    std::vector<qint64> Points(TProgressType type) const {
        std::vector<qint64> positions;
        for (const ProgressPoint& point : points_)
            if (point.Type == type) positions.push_back(point.Cur);
        return positions;
    }
    QStringList AddSongs(int count) const {
        QStringList paths;
        for (int i = 0; i < count; ++i)
            paths << songs_.Add(u"Band - Title %1.wav"_s.arg(i, 3, 10, QChar(u'0')));
        return paths;
    }

    SongFolder songs_;
    ScriptedDialogs dialogs_;
    TMusicDatabase database_;
    QStringList runs_;  // captions at the start of each run
    std::vector<ProgressPoint> points_;
    int stopAt_ = -1;  // number of the progress point at which the user asks to stop
};

class RecordingShell : public Shell {
 public:
    RecordingShell() { SetShell(this); }
    ~RecordingShell() override { SetShell(nullptr); }
    bool OpenWithDefaultProgram(const QString& path) override {
        QFile file(path);
        EXPECT_TRUE(file.open(QIODevice::ReadOnly));
        Opened << path;
        Text = QString::fromUtf8(file.readAll());
        return true;
    }
    bool StartProgram(const QString&, const QStringList&) override { return false; }
    QStringList Opened;
    QString Text;
};

}  // namespace

TEST_F(IntakeTest, PickedFilesAreReadPlacedAndReported) {
    dialogs_.Files.push_back({songs_.Add(u"Wir - Zuletzt.wav"_s, 3), songs_.Add(u"Wir - Anfang.wav"_s),
                              songs_.Path(u"gone.mp3"_s)});
    const IntakeResult result = AddSongsFromDialog(database_);
    EXPECT_EQ(result.Added, 2);
    EXPECT_EQ(result.NewFiles, songs_.Paths({u"Wir - Zuletzt.wav"_s, u"Wir - Anfang.wav"_s}));
    EXPECT_EQ(result.UnreadableNames, QStringList{u"Datei nicht gefunden: "_s + songs_.Path(u"gone.mp3"_s)});
    EXPECT_EQ(TitlesOf(database_), (QStringList{u"Anfang"_s, u"Zuletzt"_s}));
    EXPECT_EQ(database_.Song(1).Length, 3);
    EXPECT_EQ(database_.Song(1).FileName, songs_.Path(u"Wir - Zuletzt.wav"_s));
    EXPECT_EQ(database_.Artists().At(0).Number, 2);
    EXPECT_TRUE(database_.Modified());
    EXPECT_EQ(runs_, QStringList{u"MusicDatabase v6.0 - Nehme Songs in die Datenbank auf"_s});
    EXPECT_FALSE(database_.ProgressRunning());

    ASSERT_EQ(dialogs_.FileDialogs.size(), 1u);
    EXPECT_EQ(dialogs_.FileDialogs[0].Filter, u"Musik|*.mp3;*.mp2;*.wma;*.wav;|Alle Dateien|*.*"_s);
    ASSERT_EQ(dialogs_.Reports.size(), 1u);
    EXPECT_EQ(dialogs_.Reports[0].Message, u"Es wurde(n) 2 neue(r) Song(s) in die Datenbank aufgenommen."_s);
    EXPECT_TRUE(dialogs_.Reports[0].HasComplaints());
    EXPECT_TRUE(dialogs_.Messages.isEmpty()) << "a file that cannot be read is passed over without a word";
}

TEST_F(IntakeTest, ACancelledDialogEndsTheCommand) {
    EXPECT_EQ(AddSongsFromDialog(database_).Added, 0);
    EXPECT_EQ(AddFolder(database_, QString(), true).Added, 0);
    EXPECT_EQ(dialogs_.FolderCaptions,
              QStringList{u"Ordner zum Durchsuchen nach Songs auswählen (inkl. Unterordner):"_s});
    EXPECT_TRUE(runs_.isEmpty());
    EXPECT_TRUE(dialogs_.Reports.empty());
}

TEST_F(IntakeTest, AFolderIsSearchedWithOrWithoutItsSubfolders) {
    songs_.Add({u"A - 1.wav"_s, u"sub/A - 2.WAV"_s, u"sub/cover.jpg"_s, u"A - 3.ogg"_s});
    dialogs_.Folders.push_back(songs_.Path());
    EXPECT_EQ(AddFolder(database_, QString(), false).NewFiles, songs_.Paths({u"A - 1.wav"_s}));
    const IntakeResult result = AddFolder(database_, songs_.Path() + u"/./"_s, true);
    EXPECT_EQ(result.NewFiles, songs_.Paths({u"sub/A - 2.WAV"_s}));
    EXPECT_EQ(result.Known, 1);
    EXPECT_EQ(result.Unreadable, 0);
    EXPECT_EQ(runs_.last(), u"MusicDatabase v6.0 - Dursuche Ordner nach neuen Songs"_s);
    EXPECT_EQ(dialogs_.Reports.size(), 2u);

    QStringList descriptions;
    for (const ProgressPoint& point : points_)
        if (point.Type == ptSearchFolders) descriptions << point.Description;
    EXPECT_EQ(descriptions, (QStringList{u"Erstelle Cache-Liste"_s, songs_.Path(), u"Erstelle Cache-Liste"_s,
                                         songs_.Path(), songs_.Path(u"sub"_s)}));
    EXPECT_EQ(AddFolder(database_, songs_.Path(u"none"_s), true).Unreadable, 1);
}

TEST_F(IntakeTest, EveryFifthFileIsAProgressPointWhereStoppingKeepsWhatWasTakenIn) {
    QStringList files = AddSongs(12);
    QStringList list = files;
    EXPECT_EQ(AddFileList(database_, list, true), 12);
    EXPECT_EQ(list, files);
    EXPECT_EQ(Points(ptAddSongs), (std::vector<qint64>{0, 5, 10}));
    EXPECT_EQ(points_[1].Max, 12);

    database_.Clear();
    stopAt_ = 5;  // counted from the first run
    QStringList names{u"before"_s};
    IntakeResult result;
    EXPECT_EQ(AddFileList(database_, list, true, &names, &result), 5);
    EXPECT_EQ(list, files.first(5));
    EXPECT_EQ(names, QStringList{u"before"_s} + files.first(5));
    EXPECT_TRUE(result.Stopped);
    EXPECT_EQ(database_.Count(), 5);
}

TEST_F(IntakeTest, ReadingAheadChangesNothing) {
    const HandClock clock;
    QStringList files;
    for (int i = 0; i < 300; ++i) {
        const QString name = u"Band %1 - Title.%2"_s.arg(i % 7).arg(i);
        // Whole, damaged in its head, empty, not there, a folder, offered a second time.
        const QString path = i % 6 == 3 ? songs_.Path(name + u".mp3"_s) : songs_.Add(name + u".wav"_s, 1);
        if (i % 6 == 1) QFile::resize(path, 20);
        if (i % 6 == 2) QFile::resize(path, 0);
        if (i % 6 == 4) QDir().mkpath(songs_.Path(name + u".mp2"_s));
        files << (i % 6 == 4 ? songs_.Path(name + u".mp2"_s) : i % 6 == 5 ? files[i - 5] : path);
    }
    TMusicDatabase oneByOne;
    QStringList expected;
    for (const QString& path : files)
        if (!oneByOne.Contains(path) && AddSongFile(oneByOne, path) >= 0) expected << path;
    IntakeResult result;
    QStringList list = files;
    EXPECT_EQ(AddFileList(database_, list, true, nullptr, &result), 150);
    EXPECT_EQ(list, expected);
    EXPECT_EQ(result.NewFiles, expected);
    EXPECT_EQ(result.Known, 50);
    EXPECT_EQ(result.UnreadableNames.size(), 100);
    EXPECT_EQ(result.UnreadableNames[0], u"Datei nicht gefunden: "_s + files[3]);
    ASSERT_EQ(database_.Count(), oneByOne.Count());
    for (int i = 0; i < oneByOne.Count(); ++i)
        EXPECT_TRUE(database_.Song(i) == oneByOne.Song(i)) << i;
}

TEST_F(IntakeTest, StoppingTheWalkReadsNoSong) {
    AddSongs(3);
    songs_.Add(u"sub/Band - Last.wav"_s);
    stopAt_ = 3;  // the cache list, the folder, its sub-folder
    const IntakeResult result = AddFolder(database_, songs_.Path(), true);
    EXPECT_TRUE(result.Stopped);
    EXPECT_EQ(database_.Count(), 0);
    EXPECT_TRUE(Points(ptAddSongs).empty());
    EXPECT_FALSE(database_.ProgressRunning());
}

TEST_F(IntakeTest, TheCacheListOfALargeCollectionIsMadeInSteps) {
    for (int i = 0; i < 20'000; ++i)
        database_.AddEntry(u":00000000:\\"_s + QString::number(i), {}, AddAs::Loaded);
    const QStringList files = AddSongs(1);
    database_.OnProgress = [&](TMusicDatabase& database, const ProgressPoint& point) {
        points_.push_back(point);
        if (point.Type != ptSearchFolders) return;
        EXPECT_FALSE(database.RemoveEntry(0));
        EXPECT_TRUE(database.Contains(u":00000000:\\19999"_s));
    };
    EXPECT_EQ(AddPaths(database_, files, true).Added, 1);
    EXPECT_EQ(Points(ptSearchFolders), (std::vector<qint64>{16'384}));
    EXPECT_FALSE(database_.Busy());
}

TEST_F(IntakeTest, KnownFilesArePassedOverOnlyWhenAsked) {
    QStringList files = AddSongs(2);
    AddFileList(database_, files, true);
    QStringList again = files + AddSongs(3);
    IntakeResult result;
    EXPECT_EQ(AddFileList(database_, again, true, nullptr, &result), 1);
    EXPECT_EQ(result.Known, 4) << "two from before, and the first two of the three";
    EXPECT_EQ(again, songs_.Paths({u"Band - Title 002.wav"_s}));
    again = files;
    EXPECT_EQ(AddFileList(database_, again, false), 2);
    EXPECT_EQ(database_.Count(), 5);
}

TEST_F(IntakeTest, ASongHasOneSpelling) {
    songs_.Add(u"sub/A - 1.wav"_s);
    const QString here = QDir::currentPath();
    ASSERT_TRUE(QDir::setCurrent(songs_.Path()));
    const IntakeResult result =
        AddPaths(database_,
                 {u"sub/A - 1.wav"_s, u"./sub//A - 1.wav"_s, songs_.Path(u"sub/../sub/./A - 1.wav"_s), u"."_s,
                  songs_.Path() + u"//sub/"_s},
                 true);
    QDir::setCurrent(here);
    EXPECT_EQ(result.NewFiles, songs_.Paths({u"sub/A - 1.wav"_s}));
    EXPECT_EQ(result.Unreadable, 0);
    EXPECT_TRUE(database_.Contains(songs_.Path(u"sub/A - 1.wav"_s)));
}

TEST_F(IntakeTest, ASongThatIsReachedByTwoWaysIsOne) {
    songs_.Add({u"a/A - 1.wav"_s, u"b/A - 2.wav"_s, u"b/c/A - 1.wav"_s});
    QFile::link(songs_.Path(), songs_.Path(u"a/up"_s));
    EXPECT_EQ(AddPaths(database_, songs_.Paths({u"a"_s}), true).Added, 3);
    const IntakeResult again = AddPaths(database_, {songs_.Path()}, true);
    EXPECT_EQ(again.Added, 0);
    EXPECT_EQ(again.Known, 3);
    QFile::remove(songs_.Path(u"a/up"_s));
    database_.Clear();
    EXPECT_EQ(AddPaths(database_, {songs_.Path()}, true).Added, 3) << "the same name is not the same song";
}

TEST_F(IntakeTest, FilesAndFoldersTogetherAreOneRunWithoutReport) {
    songs_.Add({u"b/A - 1.wav"_s, u"a/A - 2.wav"_s, u"A - 3.wav"_s, u"list.txt"_s});
    const IntakeResult result = AddPaths(
        database_, songs_.Paths({u"A - 3.wav"_s, u"b"_s, u"list.txt"_s, u"a"_s, u"gone"_s, u"gone.mp3"_s}),
        true);
    EXPECT_EQ(result.NewFiles, songs_.Paths({u"A - 3.wav"_s, u"b/A - 1.wav"_s, u"a/A - 2.wav"_s}));
    EXPECT_EQ(result.UnreadableNames,
              (QStringList{u"Keine Musikdatei: "_s + songs_.Path(u"list.txt"_s),
                           u"Datei nicht gefunden: "_s + songs_.Path(u"gone"_s),
                           u"Datei nicht gefunden: "_s + songs_.Path(u"gone.mp3"_s)}));
    EXPECT_EQ(result.Unreadable, 3);
    EXPECT_EQ(runs_.size(), 1);
    EXPECT_TRUE(dialogs_.Reports.empty());
}

TEST_F(IntakeTest, NothingBeginsWhileTheDatabaseCannotChange) {
    const auto isRefused = [](auto command) {
        return ErrorOf(command) == u"Hinzufügen von Songs zur Datenbank ist momentan nicht möglich."_s;
    };
    const auto expectRefusals = [&] {
        EXPECT_TRUE(isRefused([&] { AddSongsFromDialog(database_); }));
        EXPECT_TRUE(isRefused([&] { AddFolder(database_, QString(), true); }));
        EXPECT_TRUE(isRefused([&] { AddPaths(database_, {songs_.Path()}, true, GivenFolders::Remembered); }));
        EXPECT_TRUE(database_.UpdateFolders().isEmpty());
        EXPECT_TRUE(dialogs_.FileDialogs.empty() && dialogs_.FolderCaptions.isEmpty());
    };
    {
        const ProgressRun run(database_, u"other"_s);
        expectRefusals();
    }
    database_.BeginBusy();
    expectRefusals();
    QStringList list;
    EXPECT_TRUE(isRefused([&] { AddFileList(database_, list, true); }));
    database_.EndBusy();
    database_.SetReadOnly(true);
    expectRefusals();
}

TEST_F(IntakeTest, BannedSongsAreCountedAndThrownAwayWhenWanted) {
    const RecordingTrash trash;
    songs_.Add({u"Band - Ohrwurm.wav"_s, u"Band - Gut.wav"_s});
    database_.BannList().Insert(u"Band - Ohrwurm"_s);
    IntakeResult result = AddPaths(database_, {songs_.Path()}, true);
    EXPECT_EQ(result.Added, 1);
    EXPECT_EQ(result.Banned, 1);
    EXPECT_EQ(result.BannedFiles, songs_.Paths({u"Band - Ohrwurm.wav"_s}));
    EXPECT_EQ(result.Unreadable, 0);
    EXPECT_TRUE(trash.Taken.isEmpty());
    database_.SetAutoDelBannedFiles(true);
    result = AddPaths(database_, {songs_.Path()}, true);
    EXPECT_EQ(result.Banned, 1);
    EXPECT_EQ(trash.Taken, songs_.Paths({u"Band - Ohrwurm.wav"_s}));
}

TEST_F(IntakeTest, DetailsNameTheSongsAndWhatWasUnreadable) {
    RecordingShell shell;
    const QStringList files = AddSongs(2) + songs_.Paths({u"gone.mp3"_s});
    AddSongsFromDialog(database_, files);
    dialogs_.Reports.at(0).OpenAsText();
    ASSERT_EQ(shell.Opened.size(), 1);
    EXPECT_TRUE(shell.Opened[0].endsWith(u"/Tunestead - Änderungen in der Datenbank.txt"_s));
    EXPECT_NE(QFileInfo(shell.Opened[0]).path(), QDir::tempPath()) << "where everybody may put links";
    EXPECT_EQ(shell.Text, u"Folgende(r) Song(s) (2) wurde(n) neu aufgenommen:\n"_s + files[0] + u'\n' +
                              files[1] +
                              u"\n\nNicht gelesen werden konnte(n) (1):\n"
                              "Datei nicht gefunden: "_s +
                              files[2] + u'\n');
    EXPECT_EQ(IntakeDetails({}), u"Folgende(r) Song(s) (0) wurde(n) neu aufgenommen:\n"_s);
}

TEST_F(IntakeTest, EachCommandSavesWithItsFoldersWhenAskedToAndBeforeItReports) {
    songs_.Add({u"1/A - 1.wav"_s, u"2/A - 2.wav"_s, u"3/A - 3.wav"_s});
    database_.SetFileName(songs_.Path(u"songs.tsdb"_s));
    AddFolder(database_, songs_.Path(u"1"_s), true);
    EXPECT_FALSE(QFile::exists(database_.FileName()));
    database_.SetAutoSave(-1);
    const auto saved = [this] {
        TMusicDatabase reopened;
        reopened.OpenDatabase(database_.FileName());
        return std::pair(reopened.Count(), reopened.UpdateFolders());
    };
    AddFolder(database_, songs_.Path(u"1"_s), true, GivenFolders::Remembered);
    EXPECT_EQ(saved(), std::pair(1, songs_.Paths({u"1"_s})));
    AddPaths(database_, songs_.Paths({u"2"_s, u"1/A - 1.wav"_s}), true, GivenFolders::Remembered);
    EXPECT_EQ(saved(), std::pair(2, songs_.Paths({u"1"_s, u"2"_s})));
    dialogs_.Reports.clear();
    dialogs_.OnReport = [&] { EXPECT_EQ(saved().first, 3); };
    AddSongsFromDialog(database_, songs_.Paths({u"3/A - 3.wav"_s}));
    EXPECT_EQ(dialogs_.Reports.size(), 1u);
}

TEST_F(IntakeTest, SongsAreDatedWithTheTimeOfTheirIntake) {
    const HandClock clock;
    AddPaths(database_, AddSongs(6), true);
    ASSERT_EQ(database_.Count(), 6);
    for (const auto& song : database_.Songs())
        EXPECT_EQ(song->AddTime, clock.Day);
}
