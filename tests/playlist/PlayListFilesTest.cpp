#include "MusicManagment/playlist/PlayListFiles.h"

#include <gtest/gtest.h>

#include <QDir>

#include "MusicManagment/playlist/ListRecognition.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

QStringList NamesIn(std::string_view file) {
    QStringList names;
    for (const PlayListEntry& entry : ParsePlayList(AsBytes(file)))
        names << entry.Name;
    return names;
}

QString InCurrentFolder(const QString& name) {
    return QDir::currentPath() + u'/' + name;
}

using Writer = void (*)(ByteWriter&, std::span<const EntryToSave>);

std::string Written(Writer write, const std::vector<EntryToSave>& entries) {
    ByteWriter file;
    write(file, entries);
    return std::string(AsText(file.Bytes()));
}

PlayListEntry Listed(const QString& artist, const QString& title, quint16 seconds) {
    PlayListEntry entry{.Name = u"as listed"_s, .Record = TID3Tag()};
    entry.Record->Artist = artist;
    entry.Record->Title = title;
    entry.Record->Length = seconds;
    return entry;
}

}  // namespace

TEST(PlayListFiles, TheFormatIsKnownByTheFirstNineBytes) {
    EXPECT_EQ(NamesIn("#EXTM3U\r\n/a.mp3\r\n"), QStringList{u"/a.mp3"_s});
    EXPECT_EQ(NamesIn("#extm3u\r\n/a.mp3"), QStringList{u"/a.mp3"_s});
    EXPECT_EQ(NamesIn("[PlayList]\r\nNumberOfEntries=1\r\nFile1=/a.mp3\r\n"), QStringList{u"/a.mp3"_s});
    // Everything else loses its first nine bytes, an M3U list with other line ends too.
    EXPECT_EQ(NamesIn("#EXTM3U\n#/a.mp3\n"), QStringList{u"/a.mp3"_s});
    EXPECT_EQ(NamesIn("/lost.mp3\r\n/b.mp3\r\n"), QStringList{u"/b.mp3"_s});
    EXPECT_EQ(NamesIn("/musik/a./b.mp3"), QStringList{u"/b.mp3"_s});
    EXPECT_EQ(NamesIn("rukplylst/a.mp3"), QStringList{u"/a.mp3"_s});
    // Shorter than nine bytes it is read whole.
    EXPECT_EQ(NamesIn("/abc.mp3"), QStringList{u"/abc.mp3"_s});
    EXPECT_EQ(NamesIn(""), QStringList());
}

TEST(PlayListFiles, AByteOrderMarkIsNoPartOfTheList) {
    EXPECT_EQ(NamesIn("\xEF\xBB\xBF#EXTM3U\r\n/a.mp3\r\n"), QStringList{u"/a.mp3"_s});
    EXPECT_EQ(NamesIn("\xEF\xBB\xBF/abc.mp3"), QStringList{u"/abc.mp3"_s});
    EXPECT_EQ(NamesIn("\xEF\xBB\xBF[playlist]\nNumberOfEntries=1\nFile1=/a.mp3"), QStringList{u"/a.mp3"_s});
}

TEST(PlayListFiles, NamesAreMadeAbsolute) {
    struct Case {
        std::string_view Line;
        QString Name;
    };
    const Case cases[] = {
        {"ab", InCurrentFolder(u"ab"_s)},
        {"a", u"a"_s},
        {"sub/a, b & c.mp3", InCurrentFolder(u"sub/a, b & c.mp3"_s)},
        {"./x/../a.mp3", InCurrentFolder(u"a.mp3"_s)},
        {"/musik//a.mp3", u"/musik/a.mp3"_s},
        {"C:\\Musik\\a.mp3", u"C:\\Musik\\a.mp3"_s},
        {":0a1B2C3d:\\a.mp3", u":0a1B2C3d:\\a.mp3"_s},
        {":0a1B2C3x:\\a.mp3", InCurrentFolder(u":0a1B2C3x:\\a.mp3"_s)},
        {"file:///musik/a%20b%C3%A4.mp3", u"/musik/a bä.mp3"_s},
        {"file:///musik/%E4.mp3", u"/musik/ä.mp3"_s},  // legacy bytes
        {"FILE://localhost/a.mp3", u"/a.mp3"_s},
        {"file:/a#1?.mp3", u"/a#1?.mp3"_s},
        {"file:///100%.mp3", u"/100%.mp3"_s},
        {"file:///a%00b.mp3", u"file:///a%00b.mp3"_s},
        {"file://server/a.mp3", u"file://server/a.mp3"_s},
        {"http://radio.example/a b", u"http://radio.example/a b"_s},
        {"/musik/\xE4.mp3", u"/musik/ä.mp3"_s},
        {"/musik/\xC3\xA4.mp3", u"/musik/ä.mp3"_s},
        {" x ", InCurrentFolder(u" x "_s)},
        {"#EXTGRP:Rock", InCurrentFolder(u"#EXTGRP:Rock"_s)},
    };
    for (const Case& test : cases) {
        const auto names = NamesIn("#EXTM3U\r\n" + std::string(test.Line));
        EXPECT_EQ(names, QStringList{test.Name}) << test.Line;
    }
}

TEST(PlayListFiles, LinesEndInAnyWayAndRemarksAreSkipped) {
    EXPECT_EQ(NamesIn("#EXTM3U\r\n#EXTINF:3,A - B\r\n/a\r\n\r\n/b\r/c\n\n/d"),
              (QStringList{u"/a"_s, u"/b"_s, u"/c"_s, u"/d"_s}));
}

TEST(PlayListFiles, PlsKeysCountByTheirNumbers) {
    EXPECT_EQ(NamesIn("[playlist]\r\nFile2=/b.mp3\r\nfile1 = \"/a,1\\2.mp3\" \r\nTitle1=x\r\nFILE3=\r\n"
                      "File5=/e.mp3\r\nFile0=/0.mp3\r\nFile-1=/m.mp3\r\nFile2=/again.mp3\r\n;File4=/d.mp3\r\n"
                      "NumberOfEntries=4\r\n[other]\r\nFile4=/x.mp3\r\n"),
              (QStringList{u"/a,1\\2.mp3"_s, u"/b.mp3"_s}));
    EXPECT_EQ(NamesIn("[playlist]\r\nFile1=/a.mp3\r\n"), QStringList());
    EXPECT_EQ(NamesIn("[playlist]\r\nFile1=/a.mp3\r\nNumberOfEntries=viele\r\n"), QStringList());
    EXPECT_EQ(NamesIn("[playlist]\r\nFile2147483647=/a.mp3\r\nNumberOfEntries=2147483647\r\n"),
              QStringList{u"/a.mp3"_s});
}

TEST(PlayListFiles, TheFormatsForOthersNameTheSongsThatAreThere) {
    const PlayListEntry first = Listed(u"Björk"_s, u"Zeile\r\nzwei"_s, 227);
    const PlayListEntry gone = Listed(u"x"_s, u"y"_s, 1);
    const PlayListEntry bare{.Name = u"as listed"_s};
    const std::vector<EntryToSave> entries = {
        {&first, u"/musik/ä.mp3"_s}, {&gone, QString()}, {&bare, u"/b\n .mp3 "_s}};
    EXPECT_EQ(Written(WriteM3uList, entries),
              "#EXTM3U\r\n#EXTINF:227,Björk - Zeile  zwei\r\n/musik/ä.mp3\r\n"
              "file:///b%0A%20.mp3%20\r\n");
    EXPECT_EQ(Written(WritePlsList, entries),
              "[playlist]\r\nFile1=/musik/ä.mp3\r\nTitle1=Björk - Zeile  zwei\r\nLength1=227\r\n"
              "File2=file:///b%0A%20.mp3%20\r\nNumberOfEntries=2\r\nVersion=2\r\n");
    EXPECT_EQ(Written(WritePlainList, entries), "/musik/ä.mp3\r\nfile:///b%0A%20.mp3%20\r\n");

    const QStringList names{u"/musik/ä.mp3"_s, u"/b\n .mp3 "_s};
    EXPECT_EQ(NamesIn(Written(WriteM3uList, entries)), names);
    EXPECT_EQ(NamesIn(Written(WritePlsList, entries)), names);
}

TEST(PlayListFiles, TheExtensionChoosesTheFormatOnSaving) {
    for (const QString& name : {u"a.rukpl"_s, u"A.RPL"_s})
        EXPECT_EQ(FormatOfName(name), PlayListFormat::Native);
    for (const QString& name : {u"a.m3u"_s, u"/x.pls/a.ExtPl"_s})
        EXPECT_EQ(FormatOfName(name), PlayListFormat::M3u);
    for (const QString& name : {u"a.pls"_s, u"a.inipl"_s})
        EXPECT_EQ(FormatOfName(name), PlayListFormat::Pls);
    for (const QString& name : {u"a.pl"_s, u"a.txtpl"_s, u"a"_s, u"a.mp3"_s})
        EXPECT_EQ(FormatOfName(name), PlayListFormat::Plain);
    EXPECT_TRUE(IsPlayListName(u"a.txtpl"_s));
    EXPECT_FALSE(IsPlayListName(u"a.mp3"_s));
}

TEST(PlayListFiles, AHostileListHasTooManyEntries) {
    std::string file = "#EXTM3U\r\n";
    for (std::size_t i = 0; i <= kMostListEntries; ++i)
        file += "a\n";
    EXPECT_THROW(NamesIn(file), EPlayListException);
}
