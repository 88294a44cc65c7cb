#include "app/models/TagEdits.h"

#include <gtest/gtest.h>

#include "CommonRUKTools/Errors.h"
#include "app/models/TagPreview.h"
#include "tests/PrintQt.h"
#include "tests/app/Songs.h"

using namespace Qt::StringLiterals;

namespace {

using Id = SongFieldId;

// Three songs of one album.
class TagEditsTest : public testing::Test {
 protected:
    TagEditsTest() {
        database_.SetSortType(stTitle);
        database_.SetRenameInPlace(true);
        database_.SetRenameAndMoveMP3s(false);
        for (const QString& title : {u"Drei"_s, u"Eins"_s, u"Zwei"_s}) {
            TID3Tag song = CdSong(title);
            song.FileName = u"/musik/"_s + title + u".mp3"_s;
            song.Artist = u"Band"_s;
            song.Album = u"Sommer"_s;
            song.Genre = 17;
            songs_.push_back(
                database_.Songs().HandleOf(database_.AddEntry(song.FileName, song, AddAs::Returning)));
        }
        edits_.SetSongs(songs_);
    }

    const TID3Tag& Record(int song) {
        return *database_.Songs().Find(songs_[static_cast<std::size_t>(song)]);
    }
    void Change(int song, void (*change)(TID3Tag&)) {
        TID3Tag record = Record(song);
        change(record);
        database_.UpdateEntry(database_.Songs().PositionOf(songs_[static_cast<std::size_t>(song)]), record);
        edits_.Refresh();
    }
    QStringList Lines() {
        QStringList lines;
        const auto totalOf = [this](SongHandle song) { return edits_.TotalOf(song); };
        for (const TagPreviewRow& row : PreviewOf(database_, edits_.Updates(), totalOf).Rows)
            lines << PreviewLine(row);
        return lines;
    }

    TMusicDatabase database_;
    std::vector<SongHandle> songs_;
    TagEdits edits_{database_};
};

TEST_F(TagEditsTest, OnlyTouchedFieldsChangeWhateverHappensToTheSongsMeanwhile) {
    EXPECT_EQ(edits_.Shown(Id::Title), std::nullopt);
    EXPECT_EQ(edits_.Shown(Id::Album), u"Sommer"_s);
    edits_.Edit(Id::Album, u"Winter"_s);
    edits_.Edit(Id::Title, u"Lied"_s);
    edits_.Restore(Id::Title);
    edits_.Edit(Id::Artist, u"Andere"_s);
    edits_.Edit(Id::Artist, u"Band"_s);  // as it was
    EXPECT_FALSE(edits_.Touched(Id::Artist));
    Change(0, [](TID3Tag& song) { song.Artist = u"Neu"_s; });
    EXPECT_EQ(edits_.Shown(Id::Artist), std::nullopt);

    const auto updates = edits_.Updates();
    ASSERT_EQ(updates.size(), 3U);
    for (int i = 0; i < 3; ++i) {
        TID3Tag wanted = Record(i);
        wanted.Album = u"Winter"_s;
        EXPECT_EQ(updates[static_cast<std::size_t>(i)].Record, wanted);
        EXPECT_FALSE(updates[static_cast<std::size_t>(i)].TrackTotal.has_value());
    }

    Change(1, [](TID3Tag& song) { song.Album = u"Winter"_s; });
    EXPECT_EQ(edits_.Updates().size(), 2U);
    database_.RemoveEntry(database_.Songs().PositionOf(songs_[2]));
    EXPECT_TRUE(edits_.Refresh());
    EXPECT_EQ(edits_.Updates().size(), 1U);
    database_.Clear();
    edits_.Refresh();
    EXPECT_FALSE(edits_.Touched());
}

TEST_F(TagEditsTest, AnEmptiedFieldOfDifferentSongsIsTouched) {
    edits_.Edit(Id::Title, QString());
    EXPECT_TRUE(edits_.Touched(Id::Title));
    EXPECT_EQ(edits_.Updates().size(), 3U);
}

TEST_F(TagEditsTest, EachFlagIsTouchedForItself) {
    Change(0, [](TID3Tag& song) { song.Flags = sfBurned | sfDamaged | 0x100; });
    EXPECT_EQ(edits_.Flag(sfBurned), std::nullopt);
    EXPECT_EQ(edits_.Flag(sfRemixed), false);
    edits_.SetFlag(sfBurned, true);
    edits_.SetFlag(sfRemixed, false);
    EXPECT_FALSE(edits_.FlagTouched(sfRemixed));
    const auto updates = edits_.Updates();
    ASSERT_EQ(updates.size(), 2U);  // the first has it
    EXPECT_EQ(updates[0].Record.Flags, quint32{sfBurned});
    edits_.SetFlag(sfBurned, false);
    EXPECT_EQ(edits_.Updates().front().Record.Flags, quint32{sfDamaged | 0x100});
}

TEST_F(TagEditsTest, NumberingFollowsTheGivenOrderAndClosesGaps) {
    FileTags files;
    files.TrackTotals = {3, 0, std::nullopt};
    edits_.TakeFileTags(files);
    EXPECT_EQ(edits_.ShownTotal(), std::nullopt);
    edits_.Number();
    EXPECT_EQ(Lines(), QStringList({u"Drei.mp3"_s, u"Track: (leer) → 1"_s, u"Eins.mp3"_s,
                                    u"Track: (leer) → 2"_s, u"Tracks: (leer) → 3"_s, u"Zwei.mp3"_s,
                                    u"Track: (leer) → 3"_s, u"Tracks: ? → 3"_s}));
    edits_.Reorder({songs_[1], songs_[2], songs_[0]});
    EXPECT_EQ(edits_.Updates()[2].Record.Title, u"Drei"_s);
    database_.RemoveEntry(database_.Songs().PositionOf(songs_[1]));
    edits_.Refresh();
    EXPECT_EQ(edits_.Updates()[1].Record.Track, 2);
    edits_.Edit(Id::Track, u"7"_s);
    EXPECT_FALSE(edits_.Numbered());
    EXPECT_EQ(edits_.Updates()[1].Record.Track, 7);

    std::vector<SongHandle> many;
    for (int i = 0; i < 256; ++i)
        many.push_back(database_.Songs().HandleOf(AddSong(database_, u"Lied %1"_s.arg(i))));
    edits_.SetSongs(many);
    EXPECT_THROW(edits_.Number(), ERukException);
}

TEST_F(TagEditsTest, WhatAFieldCannotHoldIsNamedBeforeAnythingHappens) {
    const std::pair<Id, QString> faults[] = {{Id::Year, u"99"_s},
                                             {Id::Track, u"256"_s},
                                             {Id::Track, u"3/12"_s},
                                             {Id::Genre, u"Krautig"_s},
                                             {Id::PlayCount, u"-1"_s}};
    for (const auto& [field, text] : faults) {
        edits_.Edit(field, text);
        ASSERT_TRUE(edits_.Fault().has_value()) << text.toStdString();
        EXPECT_TRUE(edits_.Fault()->contains(QString::fromUtf16(FieldOf(field).Caption)));
        edits_.Restore(field);
    }
    edits_.Edit(Id::Genre, u"hard rock"_s);
    edits_.Edit(Id::Year, u"1987"_s);
    edits_.Edit(Id::Track, QString());
    EXPECT_FALSE(edits_.Fault().has_value());
    EXPECT_EQ(edits_.Updates().front().Record.Genre, 79);
    edits_.EditTotal(u"viele"_s);
    EXPECT_TRUE(edits_.TotalFaulty());
}

TEST_F(TagEditsTest, ThePreviewNamesFieldsNamesAndWhatIsInTheWay) {
    database_.SetRenameAndMoveMP3s(true);
    database_.SetMP3NamePattern(u"%TITLE%"_s);
    edits_.SetSongs({songs_[1]});
    edits_.Edit(Id::Title, u"Fünf"_s);
    edits_.Edit(Id::Genre, QString());
    edits_.SetCover(CoverRemoval());
    EXPECT_EQ(Lines(), QStringList({u"Eins.mp3"_s, u"Titel: Eins → Fünf"_s, u"Genre: Rock → (leer)"_s,
                                    u"Cover: (wird entfernt)"_s, u"Name: Eins.mp3 → Fünf.mp3"_s}));
    edits_.Edit(Id::Title, u"Zwei"_s);
    EXPECT_EQ(Lines().back(), u"Name: Eins.mp3 → Zwei.mp3 (gibt es schon)"_s);
    database_.SetMoveMP3sAfterGenreChange(true);
    database_.SetMP3MoveRootDir(u"/genres"_s);
    edits_.Edit(Id::MainGenre, u"Jazz/Blues/Latine/Reggae"_s);
    EXPECT_TRUE(Lines().back().startsWith(u"Ort: /musik/Eins.mp3 → /genres/"_s))
        << Lines().back().toStdString();
    database_.SetRenameAndMoveMP3s(false);
    EXPECT_TRUE(Lines().filter(u"Eins.mp3 →"_s).isEmpty());
}

}  // namespace
