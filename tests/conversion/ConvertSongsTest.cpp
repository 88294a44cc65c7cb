#include "MusicManagment/conversion/ConvertSongs.h"

#include <QRegularExpression>

#include "MusicManagment/database/batches/CacheBatch.h"
#include "MusicManagment/database/intake/Intake.h"
#include "MusicManagment/database/journal/Journal.h"
#include "MusicManagment/database/media/CataloguedMedia.h"
#include "MusicManagment/playlist/PlayList.h"
#include "tests/ScriptedDialogs.h"
#include "tests/ScriptedVolumes.h"
#include "tests/conversion/ConversionRig.h"

using namespace Qt::StringLiterals;

namespace {

class ConvertSongsTest : public ConversionRig {
 protected:
    ConvertSongsTest() {
        // The desktop's bin of this user lies there.
        qputenv("XDG_DATA_HOME", QFile::encodeName(folder_.Path(u"data"_s)));
        QDir(folder_.Path()).mkdir(u"data"_s);
        SetJournal(&journal_);
        database_.SetAsynchronous(false);
        database_.SetModernTags(true);
        database_.SetRenameInPlace(true);
        database_.Conversion().WmaScript = settings_.Script;
    }
    ~ConvertSongsTest() override {
        SetJournal(nullptr);
        qunsetenv("XDG_DATA_HOME");
    }

    SongHandle Add(const QString& name) {
        TID3Tag record = ReadSong(Sound(name), database_.AudioReadOptions()).Tag;
        record.Artist = u"Band"_s;
        record.Title = name.section(u'.', 0, 0);
        record.PlayCount = 7;
        record.Flags = sfBurned;
        record.MainGenre = 3;
        record.AddTime = 40000;
        return database_.Songs().HandleOf(database_.AddEntry(folder_.Path(name), record, AddAs::Loaded));
    }
    const TID3Tag& Song(SongHandle song) const { return *database_.Songs().Find(song); }
    QStringList Sounds() const { return Files().filter(QRegularExpression(u"\\.(mp3|wav|wma|ogg)$"_s)); }

    ScriptedDialogs dialogs_;
    ScriptedVolumes volumes_;
    Journal journal_{folder_.Path(u"journal.tsj"_s)};
    TMusicDatabase database_;
};

}  // namespace

TEST_F(ConvertSongsTest, InPlaceTheSongGoesOnWithItsNewFileAndIsTakenBack) {
    const SongHandle wave = Add(u"eins.wav"_s);
    const SongHandle small = Add(u"zwei.mp3"_s);
    const SongHandle broken = Add(u"drei.wav"_s);
    folder_.Put(u"drei.wav"_s, QByteArray("kein Ton mehr"));
    const QByteArray oldWave = folder_.Get(u"eins.wav"_s);
    const QByteArray oldSmall = folder_.Get(u"zwei.mp3"_s);
    TPlayList list;
    list.SetMusicDatabase(&database_);
    list.Insert(0, {.Name = Song(wave).FileName});
    QStringList released;
    database_.OnReleaseFile = [&](const QString& path) {
        released << path;
        return [&](const QString& now) { released << now; };
    };

    const ConversionResult result = ConvertSongs(
        database_, AllSongs(database_), {.Format = MusicFormat::Mp3, .Place = ConversionPlace::InPlace});
    EXPECT_EQ(result.Done, 2);
    EXPECT_EQ(result.Replaced, 2);
    ASSERT_EQ(result.Failed.size(), 1);
    EXPECT_TRUE(result.Failed[0].startsWith(folder_.Path(u"drei.wav"_s)));
    const QString now = folder_.Path(u"Band - eins.mp3"_s);  // renamed by the settings
    EXPECT_EQ(Song(wave).FileName, now);
    EXPECT_TRUE(Song(wave).MPEGLayer.startsWith(u"MPEG"_s));
    EXPECT_EQ(Song(wave).PlayCount, 7);
    EXPECT_EQ(Song(wave).Flags, sfBurned);
    EXPECT_EQ(Song(wave).MainGenre, 3);
    EXPECT_EQ(Song(wave).AddTime, 40000);
    EXPECT_EQ(Song(small).FileName, folder_.Path(u"Band - zwei.mp3"_s));
    EXPECT_EQ(Song(broken).FileName, folder_.Path(u"drei.wav"_s));
    EXPECT_EQ(Sounds(), (QStringList{u"Band - eins.mp3"_s, u"Band - zwei.mp3"_s, u"drei.wav"_s}));
    EXPECT_EQ(list.Entry(0).Name, now);
    EXPECT_TRUE(released.contains(folder_.Path(u"eins.wav"_s)) && released.contains(now));

    EXPECT_EQ(journal_.ToUndo()->Caption, u"2 Songs konvertieren"_s);
    EXPECT_EQ(journal_.Undo(&database_).Problems, QStringList());
    EXPECT_EQ(Song(wave).FileName, folder_.Path(u"eins.wav"_s));
    EXPECT_EQ(folder_.Get(u"eins.wav"_s), oldWave);
    EXPECT_EQ(folder_.Get(u"zwei.mp3"_s), oldSmall);
    EXPECT_EQ(Song(small).FileName, folder_.Path(u"zwei.mp3"_s));
}

TEST_F(ConvertSongsTest, TwoOfOneNameGetANumberAndNothingIsAsked) {
    database_.SetRenameAndMoveMP3s(false);
    Add(u"lied.wav"_s);
    Add(u"lied.ogg"_s);
    EXPECT_EQ(ConvertSongs(database_, AllSongs(database_), {.Place = ConversionPlace::InPlace}).Replaced, 2);
    EXPECT_EQ(Sounds(), (QStringList{u"lied (2).mp3"_s, u"lied.mp3"_s}));
    EXPECT_EQ(dialogs_.Questions, QStringList());
}

TEST_F(ConvertSongsTest, BesideAndInAFolderTheCollectionStaysAsItIs) {
    const SongHandle a = Add(u"a.wav"_s);
    const TID3Tag before = Song(a);
    EXPECT_EQ(ConvertSongs(database_, OneSong(a), {.Format = MusicFormat::Wma}).Done, 1);
    EXPECT_EQ(ConvertSongs(database_, OneSong(a),
                           {.Place = ConversionPlace::Folder, .Folder = folder_.Path(u"neu/hier"_s)})
                  .Done,
              1);
    EXPECT_TRUE(QFile::exists(folder_.Path(u"a.wma"_s)) && QFile::exists(folder_.Path(u"neu/hier/a.mp3"_s)));
    EXPECT_EQ(Song(a), before);
    EXPECT_EQ(database_.Count(), 1);
    EXPECT_FALSE(journal_.ToUndo());
}

TEST_F(ConvertSongsTest, ASongOnAMediumGetsACopyThatIsPlayedAndDropped) {
    SongFolder stick;
    WriteSound(stick.Path(u"Band - Lied.wav"_s), Sine({}, 0.4));
    volumes_.Mount(stick.Path(), 0x1A2B3C4D, u"STICK"_s);
    database_.SetModernMedia(true);
    database_.SetMP3MoveRootDir(folder_.Path(u"root"_s));
    CatalogueMedium(database_, stick.Path());
    ASSERT_EQ(AddPaths(database_, {stick.Path()}, true).Added, 1);
    const QString song = database_.Song(0).FileName;
    const ConversionResult result = ConvertSongs(
        database_, AllSongs(database_), {.Format = MusicFormat::Wma, .Place = ConversionPlace::InPlace});
    EXPECT_EQ(result.Done, 1);
    EXPECT_EQ(database_.Song(0).FileName, song);
    volumes_.Now.clear();
    const QString copy = database_.ResolveSongPath(song, {.Ask = false});
    EXPECT_TRUE(copy.endsWith(u"Band - Lied.wma"_s)) << copy.toStdString();
    DropCaches(database_, AllSongs(database_));
    EXPECT_FALSE(QFile::exists(copy));
    // Without medium and copy.
    EXPECT_EQ(ConvertSongs(database_, AllSongs(database_), {}).Missing, QStringList{song});
}
