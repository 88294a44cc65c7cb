#include <gtest/gtest.h>

#include "MusicManagment/database/backup/BackupTaking.h"
#include "MusicManagment/database/intake/Intake.h"
#include "MusicManagment/database/journal/Journal.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/ScriptedVolumes.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

// Songs of the collection that are found again on a backup medium.

namespace {

constexpr quint32 kSerial = 0xABCD1234;

class BackupTest : public testing::Test {
 protected:
    BackupTest() {
        SetJournal(&journal_);
        volumes_.Mount(cd_.Path(), kSerial, u"SICHERUNG"_s, 0);
        database_.SetSortType(stPath);
    }
    ~BackupTest() override { SetJournal(nullptr); }

    SongHandle AddLost(const QString& artist, const QString& title, int seconds) {
        TID3Tag song;
        song.FileName = u"/lost/"_s + title + u".wav"_s;
        song.Artist = artist;
        song.Title = title;
        song.Length = static_cast<quint16>(seconds);
        song.PlayCount = 7;
        return database_.Songs().HandleOf(database_.AddEntry(song.FileName, song, AddAs::Returning));
    }
    void Read() {
        medium_ = BackupMediumOf(database_, cd_.Path());
        contents_ = ReadBackup(database_, medium_, cd_.Path());
        candidates_ = MatchBackup(database_, contents_.Files);
        ASSERT_EQ(candidates_.size(), contents_.Files.size());
    }
    // What may be which song, a line a file: "001%: ..." of each.
    QStringList Shown() const {
        QStringList lines;
        for (const BackupCandidates& all : candidates_) {
            QStringList texts;
            for (const BackupCandidate& each : all)
                texts << CandidateText(each, *database_.Songs().Find(each.Song));
            lines << texts.join(u"; "_s);
        }
        return lines;
    }
    BackupResult Take(const std::vector<BackupDecision>& decisions) {
        return TakeBackup(database_, medium_, u"Backup 1"_s, contents_.Files, decisions);
    }

    SongFolder cd_, disk_;
    ScriptedVolumes volumes_;
    ScriptedDialogs dialogs_;
    Journal journal_{disk_.Path(u"journal.tsj"_s)};
    TMusicDatabase database_;
    BackupMedium medium_;
    BackupContents contents_;
    std::vector<BackupCandidates> candidates_;
};

}  // namespace

using Kind = BackupDecision::Kind;

TEST_F(BackupTest, FilesAreMatchedByNameLengthAndSize) {
    const SongHandle exact = AddLost(u"ABBA"_s, u"Waterloo"_s, 3);
    AddLost(u"Abba"_s, u"Waterlooo"_s, 20);  // of another length: another version
    const SongHandle alike = AddLost(u"Queen"_s, u"Inuendo"_s, 9);
    const SongHandle there = database_.Songs().HandleOf(database_.AddSong(disk_.Add(u"A - Da.wav"_s, 4)));
    for (const auto& [name, seconds] : {std::pair{u"1/Abba - Waterloo.wav"_s, 3u},
                                        {u"1/Queen - Innuendo.wav"_s, 8u},
                                        {u"2/A - Da.wav"_s, 4u},
                                        {u"2/Abba - Waterloo.wav"_s, 3u},
                                        {u"3/Nobody - Knows.wav"_s, 2u}})
        cd_.Add(name, seconds);
    cd_.Put(u"3/text.txt"_s, QByteArray("x"));
    Read();
    EXPECT_EQ(Shown(), (QStringList{u"100%: ABBA - Waterloo (***)"_s, u"093%: Queen - Inuendo (**)"_s,
                                    u"100%: A - Da (***)"_s, u"100%: ABBA - Waterloo (***)"_s, QString()}));

    // A song once, and none whose own file is there.
    std::vector<BackupDecision> decisions = ProposeDecisions(candidates_);
    EXPECT_EQ(decisions, (std::vector<BackupDecision>{
                             {Kind::Tie, exact}, {Kind::Tie, alike}, {}, {}, {Kind::TakeIn, {}}}));
    decisions[2] = {Kind::Tie, there};
    decisions[3] = {Kind::Tie, exact};
    const auto mounted = std::exchange(volumes_.Now, {});  // nobody needs it any more
    volumes_.Mount(u"/"_s, 7);
    const BackupResult result = Take(decisions);
    volumes_.Now = mounted;
    EXPECT_EQ(result.Tied, 3);
    EXPECT_EQ(result.Added, 1);
    EXPECT_EQ(result.Failed.size(), 1);
    const TID3Tag tied = *database_.Songs().Find(exact);
    EXPECT_EQ(tied.FileName, u":ABCD1234:\\1\\Abba - Waterloo.wav"_s);
    EXPECT_EQ(tied.Artist, u"ABBA"_s);
    EXPECT_EQ(tied.PlayCount, 7u);
    // Its own file stays, is found while the medium is away, and is not taken in again.
    const QString own = disk_.Path(u"A - Da.wav"_s);
    const QString stored = u":ABCD1234:\\2\\A - Da.wav"_s;
    EXPECT_EQ(database_.ResolveSongPath(stored, {.Ask = false}), own);
    EXPECT_EQ(AddPaths(database_, {own}, true).Known, 1);
    EXPECT_EQ(database_.CDNameOf(tied.FileName), u"Backup 1"_s);
    EXPECT_TRUE(database_.Contains(u":ABCD1234:\\3\\Nobody - Knows.wav"_s));

    // What is there by its place is not offered again; all of it is one step.
    Read();
    EXPECT_EQ(contents_.Known, 4);
    EXPECT_EQ(contents_.Files.size(), 1u);
    EXPECT_EQ(journal_.ToUndo()->Caption, u"Backup-CD einlesen (5 Songs)"_s);
    EXPECT_TRUE(journal_.Undo(&database_).Problems.isEmpty());
    EXPECT_EQ(database_.Count(), 4);
    EXPECT_EQ(database_.Songs().Find(exact)->FileName, u"/lost/Waterloo.wav"_s);
    EXPECT_EQ(database_.Songs().Find(there)->FileName, own);
    journal_.Redo(&database_);
    EXPECT_EQ(database_.ResolveSongPath(stored, {.Ask = false}), own);
}

TEST_F(BackupTest, OnlyMediaThatCanBeTakenAwayAreBackups) {
    volumes_.Now.front().Optical = false;
    EXPECT_THROW(BackupMediumOf(database_, cd_.Path()), EMusicDatabaseException);
    database_.SetCDNames({{u"Alt"_s, kSerial}});
    EXPECT_EQ(BackupMediumOf(database_, cd_.Path()).Serial, kSerial);
    volumes_.Now.front().Serials.clear();
    EXPECT_THROW(BackupMediumOf(database_, cd_.Path()), EMusicDatabaseException);
}
