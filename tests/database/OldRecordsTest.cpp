#include "MusicManagment/database/tsdb/OldRecords.h"

#include <gtest/gtest.h>

#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/tsdb/DatabaseFile.h"
#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/Builders.h"
#include "tests/ScriptedDialogs.h"
#include "tests/database/DatabaseBuilder.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

// The values that replace what the audio file says.
struct Stored {
    quint16 Length = 0;
    quint8 Genre = 0;
    quint16 Reserved = 4095;
    quint32 PlayCount = 0;
    double AddTime = 0;
    quint32 Flags = 0xFFFFFFFF;
};

Bytes OldRecord(const QString& path, const Stored& stored, int minor) {
    const QByteArray name = path.toUtf8();
    ByteWriter record;
    record.Block({name.constData(), static_cast<std::size_t>(name.size())}, 261);
    while (record.Size() < 1287)
        record.U8(0xEE);  // not looked at
    record.U16Le(stored.Length);
    record.U8(stored.Genre);
    record.U8(0xEE);
    record.U16Le(stored.Reserved);
    record.U32Le(stored.PlayCount);
    if (minor == 0) return record.Bytes();
    record.F64Le(stored.AddTime);
    record.U32Le(stored.Flags);
    while (record.Size() < 1337)
        record.U8(0xEE);
    return record.Bytes();
}

class OldRecordsTest : public testing::TestWithParam<int> {
 protected:
    // A file of the version under test; in 1.2 with lists that know an artist "Liste" of three songs.
    Bytes FileOf(const std::vector<Bytes>& records) const {
        DatabaseBuilder builder(1, GetParam());
        builder.SongCount(static_cast<int>(records.size())).Number(1).Block("/Ordner", 260);
        if (GetParam() == 2)
            builder.Number(1).Block("Liste", 512).Number(3).Zeros(3 * 4).Number(20).Zeros(20 * 4);
        for (const Bytes& record : records)
            builder.Raw(record);
        return builder.File();
    }
    TID3Tag Fresh() const {
        TID3Tag tag;
        ReadAudioFile(song_, TMusicDatabase().AudioReadOptions(), tag);
        return tag;
    }
    bool Load(TMusicDatabase& database, const std::vector<Bytes>& records) const {
        const Bytes file = FileOf(records);
        MemorySource source(file);
        return ReadDatabase(database, source);
    }

    SongFolder folder_;
    ScriptedDialogs dialogs_;
    QString song_ =
        folder_.Put(u"Lied.mp3"_s, ByteSpan(Mp3Builder().Frames(100).Id3v1("Lied", "Gruppe").Data()));
};

}  // namespace

TEST_P(OldRecordsTest, StoredValuesReplaceWhatTheAudioFileSays) {
    TMusicDatabase database;
    const Stored stored{300, 7, 12, 99, 40'000.25, 5};
    ASSERT_TRUE(Load(database, {OldRecord(song_, stored, GetParam())}));
    ASSERT_EQ(database.Count(), 1);
    TID3Tag expected = Fresh();
    EXPECT_EQ(expected.Title, u"Lied"_s);
    expected.Length = 300;
    expected.MainGenre = 7;
    expected.Reserved = 12;
    expected.PlayCount = 99;
    expected.AddTime = GetParam() == 0 ? database.Song(0).AddTime : 40'000.25;
    if (GetParam() > 0) expected.Flags = 5;
    EXPECT_EQ(database.Song(0), expected);
    EXPECT_EQ(database.UpdateFolders(), QStringList{u"/Ordner"_s});
    EXPECT_FALSE(database.Modified());
}

TEST_P(OldRecordsTest, UnsetValuesKeepWhatTheAudioFileSaysAndListsComeFromTheFileOrAreCounted) {
    TMusicDatabase database;
    int inserted = 0;
    database.OnOverviewInsert = [&](TMusicDatabase&, TOVType, int, const QString&, int) { ++inserted; };
    ASSERT_TRUE(Load(database, {OldRecord(song_, Stored(), GetParam())}));
    TID3Tag expected = Fresh();
    EXPECT_GT(expected.Length, 0);
    expected.AddTime = database.Song(0).AddTime;
    EXPECT_EQ(database.Song(0), expected);
    ASSERT_EQ(database.Artists().Count(), 1);
    const bool fromFile = GetParam() == 2;
    EXPECT_EQ(database.Artists().At(0).Text, fromFile ? u"Liste"_s : u"Gruppe"_s);
    EXPECT_EQ(database.Artists().At(0).Number, fromFile ? 3 : 1);
    EXPECT_EQ(inserted, fromFile ? 0 : 4);
    EXPECT_TRUE(dialogs_.Messages.isEmpty());
}

TEST_P(OldRecordsTest, ASongWithoutItsFileGoesUnlessLostSongsAreKeptAndTheUserIsTold) {
    const QString gone = folder_.Path(u"weg/Band - Lied.mp3"_s);
    const QString unreadable = folder_.Path(u"Ordner.mp3"_s);
    ASSERT_TRUE(QDir().mkpath(unreadable));
    const std::vector<Bytes> records = {OldRecord(gone, Stored{90, 2, 1, 7}, GetParam()),
                                        OldRecord(unreadable, Stored{200, 3, 1, 4}, GetParam()),
                                        OldRecord(song_, Stored(), GetParam()),
                                        OldRecord(u":0123ABCD:\\a.mp3"_s, Stored{60}, GetParam())};
    TMusicDatabase database;
    ASSERT_TRUE(Load(database, records));
    ASSERT_EQ(database.Count(), 3);
    EXPECT_EQ(database.Song(0).FileName, unreadable);
    EXPECT_EQ(database.Song(0).Length, 200);
    EXPECT_EQ(database.Song(0).PlayCount, 4u);
    EXPECT_EQ(database.Song(2).FileName, u":0123ABCD:\\a.mp3"_s);
    EXPECT_EQ(database.Song(2).Length, 60);
    // Songs that went are not counted, wherever the lists came from.
    EXPECT_EQ(database.Genres()[0], 2);
    EXPECT_EQ(database.Artists().IndexOf(u"Liste"), -1);
    ASSERT_EQ(dialogs_.Messages.size(), 1);
    EXPECT_TRUE(dialogs_.Messages[0].contains(u"\n1 Song(s) dieser Datenbank wurden nicht übernommen"_s));

    database.SetKeepLostSongs(true);
    ASSERT_TRUE(Load(database, records));
    ASSERT_EQ(database.Count(), 4);
    EXPECT_EQ(database.Song(0).FileName, gone);
    EXPECT_EQ(database.Song(0).Title, u"Lied"_s) << "as the file's name tells";
    EXPECT_EQ(database.Song(0).Length, 90);
    EXPECT_EQ(database.Song(0).PlayCount, 7u);
    ASSERT_EQ(dialogs_.Messages.size(), 2);
    EXPECT_TRUE(dialogs_.Messages[1].startsWith(u"Die Musikdateien von 3 Song(s)"_s));
}

TEST_P(OldRecordsTest, BannedSongsAreRefusedWhereSongsAreChecked) {
    TMusicDatabase database;
    database.BannList().Insert(u"Gruppe - Lied"_s);
    ASSERT_TRUE(Load(database, {OldRecord(song_, Stored(), GetParam())}));
    EXPECT_EQ(database.Count(), GetParam() == 2 ? 1 : 0);
}

INSTANTIATE_TEST_SUITE_P(Versions, OldRecordsTest, testing::Values(0, 1, 2));
