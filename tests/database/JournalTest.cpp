#include "MusicManagment/database/journal/Journal.h"

#include <gtest/gtest.h>

#include <QDirIterator>
#include <random>

#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/journal/FileBatch.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/StepGate.h"
#include "tests/database/SongFolder.h"

#ifndef Q_OS_WIN
#include <sys/stat.h>
#include <sys/wait.h>
#endif

using namespace Qt::StringLiterals;

namespace {

// What a batch does with each of its songs.
enum Doing : unsigned {
    kInPlace = 1,  // a new title of the same room, and another end
    kRebuild = 2,  // a longer title before the rest
    kRename = 4,   // into a folder that is made for it
    kAcross = 8,   // the folder lies on another file system
    kTrash = 16,   // into the bin, and out of the collection
};

constexpr int kHead = 44;
constexpr qint64 kOldTime = 1'000'000'000'000;  // milliseconds

// A few songs, their collection and journal, and a batch that changes all of them. The contents of a file
// tell the title that its record is to have.
class Songs {
 public:
    Songs(int count, unsigned doing, JournalLimits limits = {})
        : OwnJournal(folder_.Path(u"journal.tsj"_s), limits), count_(count), doing_(doing) {
        qputenv("XDG_DATA_HOME", QFile::encodeName(folder_.Path(u"data"_s)));
        QDir(folder_.Path()).mkdir(u"data"_s);
        for (int i = 0; i < count; ++i) {
            folder_.Put(OldName(i), Old(i));
            QFile file(folder_.Path(OldName(i)));
            EXPECT_TRUE(file.open(QIODevice::ReadWrite) &&
                        file.setFileTime(QDateTime::fromMSecsSinceEpoch(kOldTime + i),
                                         QFileDevice::FileModificationTime));
            file.close();
            EXPECT_GE(Database.AddEntry(QString(), Record(folder_.Path(OldName(i)), OldTitle(i))), 0);
        }
        EXPECT_TRUE(Database.SaveDatabase(folder_.Path(u"songs.tsdb"_s)));
    }
    ~Songs() { qunsetenv("XDG_DATA_HOME"); }

    void Change(StepGate& gate) {
        gate.BetweenFileSystems = (doing_ & kAcross) != 0;
        FileBatch batch(&OwnJournal, &Database, QString::number(count_) + u" Songs"_s);
        for (int i = 0; i < count_; ++i)
            batch.Add(Item(i));
        batch.Finish();
        failures_ = batch.Failures();
    }
    void Undo(StepGate& gate) {
        gate.BetweenFileSystems = (doing_ & kAcross) != 0;
        OwnJournal.Undo(&Database);
    }
    void Ban(const QString& entry) {
        FileBatch(&OwnJournal, &Database, entry).Add(std::move(FileItem().Ban(entry)));
    }

    // Each file is whole, the old or the new one, in the old place or the new one, and there is nothing else;
    // the collection knows each by its title and place. Returns how many are wholly as they were.
    int CheckWhole() const {
        int old = 0;
        QStringList known;
        for (int i = 0; i < count_; ++i) {
            const bool moved = !QFile::exists(folder_.Path(OldName(i)));
            const QString name = moved ? NewName(i) : OldName(i);
            if (moved && (doing_ & kTrash) != 0) {
                EXPECT_FALSE(Database.Contains(folder_.Path(OldName(i))));
                continue;
            }
            known << name;
            const QByteArray contents = folder_.Get(name);
            EXPECT_TRUE(contents == Old(i) || contents == New(i)) << name.toStdString();
            const bool isNew = contents != Old(i);
            const SongIndex song = Database.IndexOf(folder_.Path(name));
            EXPECT_GE(song, 0) << name.toStdString();
            if (song >= 0) {
                EXPECT_EQ(Database.Song(song).Title, isNew ? NewTitle(i) : OldTitle(i));
            }
            const bool hasOldTime =
                QFileInfo(folder_.Path(name)).lastModified().toMSecsSinceEpoch() == kOldTime + i;
            EXPECT_EQ(hasOldTime, !isNew);
            if (!isNew && !moved) ++old;
        }
        EXPECT_EQ(Database.Count(), known.size());
        EXPECT_EQ(Names(), known);
        return old;
    }
    // Everything can be taken back.
    void CheckTakingBack() {
        while (OwnJournal.ToUndo())
            ASSERT_EQ(OwnJournal.Undo(&Database).Problems, QStringList());
        ASSERT_EQ(CheckWhole(), count_);
    }
    // What a start of the program does after it was ended anywhere.
    void Recover() {
        EXPECT_EQ(OwnJournal.TakeBackUnfinished().Problems, QStringList());
        Database.OpenDatabase(QString(Database.FileName()));
        OwnJournal.BringUpToDate(Database);
    }

    const QStringList& Failures() const { return failures_; }
    const SongFolder& Folder() const { return folder_; }

    static QString OldName(int i) { return u"old%1.mp3"_s.arg(i, 3, 10, QChar(u'0')); }
    QString NewName(int i) const {
        return (doing_ & (kRename | kAcross)) != 0 ? u"to/new/%1.mp3"_s.arg(i, 3, 10, QChar(u'0'))
                                                   : OldName(i);
    }

 private:
    static TID3Tag Record(const QString& path, const QString& title) {
        TID3Tag record;
        record.FileName = path;
        record.Title = title;
        return record;
    }
    static QString OldTitle(int i) { return u"before "_s + QString::number(i); }
    static QString NewTitle(int i) { return u"after "_s + QString::number(i); }
    static QByteArray Head(const QString& title, int size = kHead) {
        return title.toLatin1().leftJustified(size);
    }
    static QByteArray Audio(int i) {
        QByteArray audio(1500 + 13 * i, '\0');
        std::mt19937 random(static_cast<unsigned>(i));
        for (char& c : audio)
            c = static_cast<char>(random());
        return audio;
    }
    static QByteArray End(int i) { return QByteArray(i % 3 == 0 ? 128 : 0, 'v'); }
    static QByteArray Old(int i) { return Head(OldTitle(i)) + Audio(i) + End(i); }
    QByteArray New(int i) const {
        if ((doing_ & kRebuild) != 0) return Head(NewTitle(i), 900) + Audio(i) + End(i);
        if ((doing_ & kInPlace) != 0) return Head(NewTitle(i)) + Audio(i) + End(i + 1);
        return Old(i);
    }

    FilePatch PatchOf(int i) const {
        FilePatch patch;
        const QByteArray made = New(i);
        const qsizetype head =
            made.size() - Audio(i).size() - End((doing_ & kRebuild) != 0 ? i : i + 1).size();
        const auto bytes = [](const QByteArray& text) {
            return AsBytes({text.constData(), static_cast<std::size_t>(text.size())});
        };
        patch.Insert(bytes(made.left(head)));
        patch.Keep(kHead, Audio(i).size());
        patch.Insert(bytes(made.mid(head + Audio(i).size())));
        return patch;
    }

    FileItem Item(int i) const {
        const QString path = folder_.Path(OldName(i));
        const TID3Tag old = Record(path, OldTitle(i));
        FileItem item;
        if ((doing_ & kTrash) != 0) return std::move(item.Trash(path).Record(old, std::nullopt));
        TID3Tag changed = old;
        if ((doing_ & (kInPlace | kRebuild)) != 0) {
            changed.Title = NewTitle(i);
            item.Patch(path, PatchOf(i), StateOf(path)).Record(old, changed);
        }
        if ((doing_ & (kRename | kAcross)) != 0) {
            TID3Tag moved = changed;
            moved.FileName = folder_.Path(NewName(i));
            item.Move(path, moved.FileName).Record(changed, moved);
        }
        return item;
    }

    // Of everything in the folder but the program's own files.
    QStringList Names() const {
        QStringList names;
        QDirIterator files(folder_.Path(), QDir::Files | QDir::Hidden, QDirIterator::Subdirectories);
        while (files.hasNext()) {
            const QString name = files.next().mid(folder_.Path().size() + 1);
            const bool isOurs = name.startsWith(u"songs.tsdb"_s) || name.contains(u"journal.tsj"_s) ||
                                name.startsWith(u"data/"_s);
            if (!isOurs) names << name;
        }
        names.sort();
        return names;
    }

    const SongFolder folder_;

 public:
    TMusicDatabase Database;
    Journal OwnJournal;

 private:
    int count_;
    unsigned doing_;
    QStringList failures_;
};

class JournalTest : public testing::Test {
 protected:
    // Nothing is waited for there, and flushes are what is counted.
    JournalTest() {
        if (QFileInfo(u"/dev/shm"_s).isWritable()) qputenv("TMPDIR", "/dev/shm");
    }
    ~JournalTest() override { qunsetenv("TMPDIR"); }

    ScriptedDialogs dialogs_;
};

#ifndef Q_OS_WIN
// Runs something in a process that ends before the step of this number; whether it came to its end.
template <typename Action>
bool RunsToItsEnd(int step, Action action) {
    const pid_t child = ::fork();
    if (child == 0) {
        StepGate gate(step, StepGate::Then::Dies);
        action(gate);
        ::_exit(0);
    }
    int status = 0;
    ::waitpid(child, &status, 0);
    EXPECT_TRUE(WIFEXITED(status) ? WEXITSTATUS(status) == 0 : WTERMSIG(status) == SIGKILL);
    return WIFEXITED(status);
}

struct Case {
    const char* Name;
    int Songs;
    unsigned Doing;
    int Moments = 40;  // at which a process is ended, or all of them
};

class KilledTest : public JournalTest, public testing::WithParamInterface<Case> {
 protected:
    // Returns how far apart the moments lie at which a process is ended, evenly spread.
    static int ChangeAll(Songs& songs) {
        StepGate gate;
        songs.Change(gate);
        EXPECT_EQ(songs.Failures(), QStringList());
        return std::max(1, gate.Steps / GetParam().Moments);
    }
    // After any end: whole files, an agreeing collection, and everything can be taken back.
    static void CheckAfter(Songs& songs) {
        songs.Recover();
        songs.CheckWhole();
        ASSERT_NO_FATAL_FAILURE(songs.CheckTakingBack());
        EXPECT_FALSE(QFile::exists(songs.Folder().Path(u"to"_s)));
        EXPECT_TRUE(QDir(songs.Folder().Path(u"data/Trash/info"_s)).isEmpty());
        EXPECT_TRUE(songs.OwnJournal.TakeBackUnfinished().IsEmpty());
    }
};

INSTANTIATE_TEST_SUITE_P(Journal, KilledTest,
                         testing::Values(Case{"InPlace", 4, kInPlace}, Case{"Rebuild", 3, kRebuild},
                                         Case{"Rename", 4, kRename}, Case{"Across", 2, kAcross},
                                         Case{"RebuildAndMove", 2, kRebuild | kAcross},
                                         Case{"Trash", 3, kTrash},
                                         Case{"FiftySongs", 50, kRebuild | kRename, 10}),
                         [](const auto& test) { return std::string(test.param.Name); });
#endif

}  // namespace

#ifndef Q_OS_WIN
TEST_P(KilledTest, WhereverABatchEndsEachFileIsWholeAndTheCollectionAgrees) {
    const Case& what = GetParam();
    Songs trial(what.Songs, what.Doing);
    const int stride = ChangeAll(trial);
    bool ended = false;
    for (int step = 0; !ended; step += stride) {
        Songs songs(what.Songs, what.Doing);
        ended = RunsToItsEnd(step, [&songs](StepGate& gate) { songs.Change(gate); });
        SCOPED_TRACE(step);
        RunsToItsEnd(step % 11, [&songs](StepGate&) { songs.OwnJournal.TakeBackUnfinished(); });
        ASSERT_NO_FATAL_FAILURE(CheckAfter(songs));
        if (HasFailure()) return;
    }
}

TEST_P(KilledTest, WhereverTakingBackEndsTheRestCanBeTakenBack) {
    const Case& what = GetParam();
    bool ended = false;
    for (int step = 0, stride = 0; !ended; step += stride) {
        Songs songs(what.Songs, what.Doing);
        stride = ChangeAll(songs);  // taking back has about as many steps
        ASSERT_TRUE(songs.Database.SaveDatabase());
        ended = RunsToItsEnd(step, [&songs](StepGate& gate) { songs.Undo(gate); });
        SCOPED_TRACE(step);
        ASSERT_NO_FATAL_FAILURE(CheckAfter(songs));
        if (HasFailure()) return;
    }
}
#endif

TEST_F(JournalTest, AFullDiskAtAnyWriteLeavesEachFileWhole) {
    for (const unsigned doing : {kInPlace + 0U, kRebuild + kRename + 0U, kAcross + 0U})
        for (const auto then : {StepGate::Then::Fails, StepGate::Then::FailsFromThere})
            for (int step = 0, last = 1; step < last; ++step) {
                SCOPED_TRACE(testing::Message() << doing << " " << step);
                Songs songs(3, doing);
                {
                    StepGate gate(step, then);
                    songs.Change(gate);
                    last = gate.Steps;
                }
                songs.OwnJournal.TakeBackUnfinished();
                songs.CheckWhole();
                ASSERT_NO_FATAL_FAILURE(songs.CheckTakingBack());
                if (HasFailure()) return;
            }
}

TEST_F(JournalTest, ABatchIsTakenBackAndDoneAgainUntilAnotherIsDone) {
    Songs songs(3, kRebuild | kRename);
    TMusicDatabase& database = songs.Database;
    Journal& journal = songs.OwnJournal;
    StepGate gate;
    songs.Change(gate);
    ASSERT_EQ(songs.CheckWhole(), 0);
    for (int i = 0; i < 2; ++i) {
        ASSERT_TRUE(journal.ToUndo());
        EXPECT_EQ(journal.ToUndo()->Caption, u"3 Songs"_s);
        EXPECT_EQ(journal.ToUndo()->Files, 3);
        EXPECT_EQ(journal.Undo(&database).Items, 3);
        EXPECT_EQ(songs.CheckWhole(), 3);
        EXPECT_FALSE(journal.ToUndo());
        EXPECT_EQ(Journal(journal.Path()).Redo(&database).Items, 3);  // as after a restart
        EXPECT_EQ(songs.CheckWhole(), 0);
        EXPECT_FALSE(journal.ToRedo());
    }
    journal.Undo(&database);
    ASSERT_TRUE(journal.ToRedo());
    songs.Ban(u"A - B"_s);
    EXPECT_TRUE(database.BannList().Contains(u"A - B"));
    EXPECT_FALSE(journal.ToRedo());
    journal.Undo(&database);
    EXPECT_FALSE(database.BannList().Contains(u"A - B"));
}

TEST_F(JournalTest, WhatHasChangedSinceIsLeftAloneAndNamed) {
    Songs songs(3, kRebuild | kRename);
    TMusicDatabase& database = songs.Database;
    Journal& journal = songs.OwnJournal;
    StepGate gate;
    songs.Change(gate);

    const QString changed = songs.Folder().Put(songs.NewName(1), "of somebody else");
    TID3Tag played = database.Song(database.IndexOf(songs.Folder().Path(songs.NewName(2))));
    played.PlayCount = 7;
    database.UpdateEntry(database.IndexOf(played.FileName), played);
    const UndoResult result = journal.Undo(&database);
    EXPECT_EQ(result.Items, 2);
    ASSERT_EQ(result.Problems.size(), 1);
    EXPECT_TRUE(result.Problems[0].contains(changed));
    EXPECT_EQ(songs.Folder().Get(songs.NewName(1)), "of somebody else");
    EXPECT_TRUE(database.Contains(changed));
    EXPECT_EQ(database.Song(database.IndexOf(songs.Folder().Path(Songs::OldName(2)))).PlayCount, 7U);
    EXPECT_FALSE(journal.ToUndo());
}

TEST_F(JournalTest, OneProgramChangesFilesAtATimeAndOnlyItsOwnDatabase) {
    Songs songs(1, kRename);
    Journal& journal = songs.OwnJournal;
    {
        FileBatch batch(&journal, &songs.Database, u"Bann"_s);
        batch.Add(std::move(FileItem().Ban(u"A - B"_s)));
        EXPECT_THROW(FileBatch(&journal, nullptr, u"zweiter"_s), EJournalBusy);
        EXPECT_THROW(Journal(journal.Path()).Undo(&songs.Database), EJournalBusy);
    }
    TMusicDatabase other;
    EXPECT_THROW(journal.Undo(&other), EOtherDatabase);
    EXPECT_THROW(journal.Undo(nullptr), EOtherDatabase);
    EXPECT_TRUE(journal.ToUndo());
}

TEST_F(JournalTest, TheOldestBatchesAreDroppedAndATornTailIsNothing) {
    Songs songs(1, kRename, {.Bytes = 1 << 20, .Batches = 3});
    for (int i = 0; i < 6; ++i)
        songs.Ban(QString::number(i));
    QFile file(songs.OwnJournal.Path());
    ASSERT_TRUE(file.open(QIODevice::ReadWrite));
    file.resize(file.size() - 5);  // the end of the last batch is not whole
    file.close();
    songs.Ban(u"6"_s);
    QStringList captions;
    for (const BatchInfo& batch : songs.OwnJournal.Batches())
        captions << batch.Caption;
    EXPECT_EQ(captions, (QStringList{u"6"_s, u"5"_s, u"4"_s, u"3"_s}));
    EXPECT_FALSE(songs.OwnJournal.FitsBatch(2 << 20));
}
