#include <gtest/gtest.h>

#include "MusicManagment/playlist/PlayListFiles.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

TID3Tag Song(const QString& title) {
    TID3Tag song;
    song.FileName = u"/musik/"_s + title + u".mp3"_s;
    song.Title = title;
    song.Artist = u"Björk"_s;
    song.Album = u"Début"_s;
    song.Comment = u"mit\r\nZeilenende"_s;
    song.MPEGLayer = u"MPEG 1.0 Layer III"_s;
    song.Year = u"1993"_s;
    song.Length = 227;
    song.Genre = 17;
    song.PlayCount = 70'000;
    song.Flags = 5;
    song.MainGenre = 19;
    song.Remix = true;
    song.AddTime = 34'000.25;
    return song;
}

std::vector<std::uint8_t> FileOf(const std::vector<PlayListEntry>& entries) {
    std::vector<EntryToSave> toSave;
    for (const PlayListEntry& entry : entries)
        toSave.push_back({&entry, QString()});
    ByteWriter file;
    WriteNativeList(file, toSave);
    return file.Bytes();
}

std::vector<PlayListEntry> Parsed(ByteSpan file) {
    return kClassicLists.Parse(file, {});
}

const std::vector<PlayListEntry> kEntries = {
    {.Name = u"/musik/a.mp3"_s, .Record = Song(u"a"_s)},
    {.Name = u":0A1B2C3D:\\Ordner\\ä.mp3"_s},
    {.Name = u"\uFEFFmit Marke"_s},
    {.Name = u"/musik/Null\0Zeichen"_s},
    {.Name = u"/musik/zwei\nZeilen.mp3"_s, .Record = Song(u"日本"_s)},
};

}  // namespace

TEST(NativeList, WhatIsSavedIsLoadedWithTheYearAsANumber) {
    EXPECT_EQ(Parsed(FileOf(kEntries)), kEntries);
    EXPECT_TRUE(Parsed(FileOf({})).empty());
    std::vector<PlayListEntry> entries = {{.Name = u"/a"_s, .Record = Song(u"a"_s)}};
    entries[0].Record->Year = u"um 1990"_s;
    EXPECT_EQ(Parsed(FileOf(entries))[0].Record->Year, u"0"_s);
}

TEST(NativeList, TheBytesAreThoseOfTheFormat) {
    const auto file = FileOf({{.Name = u"ä"_s}, {.Name = u"/b"_s, .Record = Song(u"t"_s)}});
    const std::string_view head("RUKPLYLST\x00\x01\x02\x00\xC3\xA4\x00\x02\x00/b\xFF\xC9\x07\xE3\x00\x11",
                                26);
    EXPECT_EQ(AsText(file).substr(0, 26), head);
    // Behind the 39 bytes come the six texts, each after its length.
    const std::string_view texts(
        "\x0C\x00/musik/t.mp3\x01\x00t\x06\x00"
        "Bj\xC3\xB6rk\x06\x00"
        "D\xC3\xA9"
        "but",
        33);
    EXPECT_EQ(AsText(file).substr(21 + 39, 33), texts);
}

TEST(NativeList, ATextThatIsTooLongIsCutBetweenCharacters) {
    const QString name(40'000, u'ä');
    const auto entries = Parsed(FileOf({{.Name = name}, {.Name = u"/b"_s}}));
    ASSERT_EQ(entries.size(), 2u);
    EXPECT_EQ(entries[0].Name, QString(32'767, u'ä'));
}

TEST(NativeList, AnotherVersionIsRefused) {
    auto file = FileOf(kEntries);
    file[9] = 1;
    for (const std::size_t size : {file.size(), std::size_t{9}, std::size_t{10}})
        EXPECT_THROW(Parsed(ByteSpan(file).first(size)), EUnknownPlayListVersion);
}

TEST(NativeList, CutAnywhereBetweenEntriesItIsShorterAndWithinOneDamaged) {
    const auto file = FileOf(kEntries);
    std::vector<std::size_t> ends;
    for (std::size_t count = 0; count <= kEntries.size(); ++count)
        ends.push_back(
            FileOf({kEntries.begin(), kEntries.begin() + static_cast<std::ptrdiff_t>(count)}).size());
    for (std::size_t size = 11; size < file.size(); ++size) {
        const auto end = std::ranges::find(ends, size);
        if (end == ends.end())
            EXPECT_THROW(Parsed(ByteSpan(file).first(size)), EPlayListException) << size;
        else
            EXPECT_EQ(Parsed(ByteSpan(file).first(size)).size(),
                      static_cast<std::size_t>(end - ends.begin()));
    }
}
