#include "MusicManagment/playlist/PlayListFiles.h"

#include <gtest/gtest.h>

#include <QDir>

#include "MusicManagment/playlist/ListBuilder.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

std::vector<PlayListEntry> Modern(std::string_view file, const QString& name = u"/l/x.m3u"_s) {
    return kModernLists.Parse(AsBytes(file), {.FileName = name});
}

QString Joined(const std::vector<PlayListEntry>& entries) {
    QStringList names;
    for (const PlayListEntry& entry : entries)
        names << entry.Name;
    return names.join(u'|');
}

QString ClassicNames(std::string_view file) {
    return Joined(kClassicLists.Parse(AsBytes(file), {}));
}

QString InCurrentFolder(const QString& name) {
    return QDir::currentPath() + u'/' + name;
}

PlayListEntry Listed(const QString& artist, const QString& title, quint16 seconds) {
    PlayListEntry entry{.Name = u"as listed"_s, .Record = TID3Tag()};
    entry.Record->Artist = artist;
    entry.Record->Title = title;
    entry.Record->Length = seconds;
    return entry;
}

struct Case {
    std::string_view File;
    QString Names;
};

}  // namespace

TEST(PlayListFiles, TheClassicRulesKnowAFormatByTheFirstNineBytes) {
    const Case cases[] = {
        {"#EXTM3U\r\n#EXTINF:3,A - B\r\n/a\r\n\r\n/b\r/c\n\n/d", u"/a|/b|/c|/d"_s},
        {"#extm3u\r\n/a.mp3", u"/a.mp3"_s},
        {"[PlayList]\r\nNumberOfEntries=1\r\nFile1=/a.mp3\r\n", u"/a.mp3"_s},
        // Everything else loses its first nine bytes, an M3U list with other line ends too.
        {"#EXTM3U\n#/a.mp3\n", u"/a.mp3"_s},
        {"/musik/a./b.mp3", u"/b.mp3"_s},
        {"rukplylst/a.mp3", u"/a.mp3"_s},
        // Shorter than nine bytes it is read whole.
        {"/abc.mp3", u"/abc.mp3"_s},
        {"", u""_s},
        // A byte-order mark is no part of the list.
        {"\xEF\xBB\xBF#EXTM3U\r\n/a.mp3\r\n", u"/a.mp3"_s},
        {"\xEF\xBB\xBF/abc.mp3", u"/abc.mp3"_s},
        {"[playlist]\r\nFile2=/b.mp3\r\nfile1 = \"/a,1\\2.mp3\" \r\nTitle1=x\r\nFILE3=\r\nFile04=/0.mp3\r\n"
         "File5=/e.mp3\r\nFile0=/0.mp3\r\nFile-1=/m.mp3\r\nFile2=/again.mp3\r\n;File4=/d.mp3\r\n"
         "NumberOfEntries=4\r\n[other]\r\nFile4=/x.mp3\r\n",
         u"/a,1\\2.mp3|/b.mp3"_s},
        {"[playlist]\r\nFile1=/a.mp3\r\nNumberOfEntries=viele\r\n", u""_s},
        {"[playlist]\r\nFile2147483647=/a.mp3\r\nNumberOfEntries=2147483647\r\n", u"/a.mp3"_s},
    };
    for (const auto& [file, names] : cases)
        EXPECT_EQ(ClassicNames(file), names) << file;
}

TEST(PlayListFiles, TheModernRulesReadWhatOtherProgramsWrite) {
    const Case cases[] = {
        {"#EXTM3U\n#EXTINF:3,A - B\na.mp3\n# Bemerkung\n../b.mp3\n  \n", u"/l/a.mp3|/b.mp3"_s},
        {"\xEF\xBB\xBF#EXTM3U\n\xC3\xA4.mp3", u"/l/ä.mp3"_s},
        {"\xE4.mp3\rsub\\b.mp3\rC:\\c.mp3", u"/l/ä.mp3|/l/sub/b.mp3|C:\\c.mp3"_s},
        {"[playlist]\nFile1=a.mp3\nFile3=c.mp3\n", u"/l/a.mp3|/l/c.mp3"_s},
        {"\n[Playlist]\nFile1=a.mp3\nFile2=b.mp3\nNumberOfEntries=1\n", u"/l/a.mp3|/l/b.mp3"_s},
        {"file:///x%20y.mp3\nhttp://h/x\n", u"/x y.mp3|http://h/x"_s},
    };
    for (const auto& [file, names] : cases)
        EXPECT_EQ(Joined(Modern(file)), names) << file;
    // Without a head it is the name that tells.
    EXPECT_EQ(Joined(Modern("a.mp3\n#b.mp3\n", u"/l/x.m3u8"_s)), u"/l/a.mp3"_s);
    EXPECT_EQ(Joined(Modern("a.mp3\n#b.mp3\n", u"/l/x.txt"_s)), u"/l/a.mp3|/l/#b.mp3"_s);
    EXPECT_EQ(Joined(Modern("#EXTINF:1,x\na.mp3\n", u"/l/x.txt"_s)), u"/l/a.mp3"_s);
    EXPECT_EQ(Joined(Modern("RUKPLYLST://radio\r\n/b.mp3\r\n", u"/l/x.pl"_s)), u"RUKPLYLST://radio|/b.mp3"_s);
    for (const auto& [file, name] :
         {std::pair("RUKPLYLST\x01\x01", u"/l/x.pl"_s), {"RUKPLYLST??", u"/l/x.rpl"_s}})
        EXPECT_THROW(Modern(file, name), EUnknownPlayListVersion);
}

TEST(PlayListFiles, TitlesAndLengthsAreThoseOfTheListUntilTheCollectionKnowsBetter) {
    TID3Tag known;
    known.Title = u"Aus der Sammlung"_s;
    const ListOrigin origin{.FileName = u"/l/x.m3u"_s, .Known = [&](const QString& name) {
                                return name == u"/l/k.mp3"_s ? &known : nullptr;
                            }};
    const auto texts = [&](std::string_view file) {
        QString all;
        for (const PlayListEntry& entry : kModernLists.Parse(AsBytes(file), origin))
            all +=
                entry.Record
                    ? u"%1/%2/%3|"_s.arg(entry.Record->Artist, entry.Record->Title).arg(entry.Record->Length)
                    : u"-|"_s;
        return all;
    };
    EXPECT_EQ(texts("#EXTM3U\n#EXTINF:227,Björk - Venus - Live\na.mp3\nb.mp3\n#EXTINF:9,x\nk.mp3\n"
                    "#EXTINF:-1 logo=\"a,b\",Radio\nc.mp3\n#EXTINF:1e9,\nd.mp3\n#EXTINF:\ne.mp3"),
              u"Björk/Venus - Live/227|-|/Aus der Sammlung/0|/Radio/0|//65535|-|"_s);
    EXPECT_EQ(texts("[playlist]\nLength1=61.7\nTitle1=A - B\nFile1=a.mp3\nFile2=k.mp3\nFile3=c.mp3\n"),
              u"A/B/61|/Aus der Sammlung/0|-|"_s);
}

TEST(PlayListFiles, NamesAreMadeAbsolute) {
    const Case cases[] = {
        {"ab", InCurrentFolder(u"ab"_s)},
        {"a", u"a"_s},
        {"./x/../a, b & c.mp3", InCurrentFolder(u"a, b & c.mp3"_s)},
        {"/musik//a.mp3", u"/musik/a.mp3"_s},
        {":0a1B2C3d:\\a.mp3", u":0a1B2C3d:\\a.mp3"_s},
        {":0a1B2C3x:\\a.mp3", InCurrentFolder(u":0a1B2C3x:\\a.mp3"_s)},
        {"file:///musik/a%20b%C3%A4.mp3", u"/musik/a bä.mp3"_s},
        {"file:///musik/%E4.mp3", u"/musik/ä.mp3"_s},  // legacy bytes
        {"file:/a#1?.mp3", u"/a#1?.mp3"_s},
        {"file:///a%00b.mp3", u"file:///a%00b.mp3"_s},
        {"file://server/a.mp3", u"file://server/a.mp3"_s},
        {"/musik/\xE4\xC3.mp3", u"/musik/äÃ.mp3"_s},
        {" x ", InCurrentFolder(u" x "_s)},
        {"#EXTGRP:Rock", InCurrentFolder(u"#EXTGRP:Rock"_s)},
    };
    for (const auto& [line, name] : cases)
        EXPECT_EQ(ClassicNames("#EXTM3U\r\n" + std::string(line)), name) << line;
}

TEST(PlayListFiles, TheFormatsForOthersNameTheSongsThatAreThereAndReadBack) {
    const PlayListEntry first = Listed(u"Björk"_s, u"Zeile\r\nzwei"_s, 227);
    const PlayListEntry gone = Listed(u"x"_s, u"y"_s, 1);
    const PlayListEntry bare{.Name = u"as listed"_s};
    const std::vector<EntryToSave> entries = {{&first, u"/musik/ä.mp3"_s},
                                              {&gone, QString()},
                                              {&bare, u"/b\n .mp3 "_s},
                                              {&bare, u"http://h/x "_s},
                                              {&bare, u"http://h/\nx"_s}};
    const std::string lines = "file:///b%0A%20.mp3%20\r\nhttp://h/x \r\nhttp://h/%0Ax\r\n";
    const std::tuple<PlayListFormat, QString, std::string> formats[] = {
        {PlayListFormat::M3u, u"/l/x.m3u"_s,
         "#EXTM3U\r\n#EXTINF:227,Björk - Zeile  zwei\r\n/musik/ä.mp3\r\n" + lines},
        {PlayListFormat::Pls, u"/l/x.pls"_s,
         "[playlist]\r\nFile1=/musik/ä.mp3\r\nTitle1=Björk - Zeile  zwei\r\nLength1=227\r\n"
         "File2=file:///b%0A%20.mp3%20\r\nFile3=\"http://h/x \"\r\nFile4=http://h/%0Ax\r\n"
         "NumberOfEntries=4\r\nVersion=2\r\n"},
        {PlayListFormat::Plain, u"/l/x.pl"_s, "/musik/ä.mp3\r\n" + lines},
    };
    for (const auto& [format, name, expected] : formats) {
        ByteWriter file;
        (format == PlayListFormat::M3u   ? WriteM3uList
         : format == PlayListFormat::Pls ? WritePlsList
                                         : WritePlainList)(file, entries);
        EXPECT_EQ(AsText(file.Bytes()), expected);
        EXPECT_EQ(Joined(Modern(expected, name)), u"/musik/ä.mp3|/b\n .mp3 |http://h/x |http://h/%0Ax"_s);
    }
}

TEST(PlayListFiles, TheExtensionChoosesTheFormatOnSaving) {
    const std::pair<QString, PlayListFormat> names[] = {{u"A.RPL"_s, PlayListFormat::Native},
                                                        {u"/x.pls/a.ExtPl"_s, PlayListFormat::M3u},
                                                        {u"a.inipl"_s, PlayListFormat::Pls},
                                                        {u"a"_s, PlayListFormat::Plain}};
    for (const auto& [name, format] : names)
        for (const ListRules* rules : {&kClassicLists, &kModernLists})
            EXPECT_EQ(rules->FormatOfName(name), format) << name.toStdString();
    EXPECT_EQ(kClassicLists.FormatOfName(u"a.m3u8"_s), PlayListFormat::Plain);
    EXPECT_EQ(kModernLists.FormatOfName(u"a.m3u8"_s), PlayListFormat::M3u8);
    EXPECT_TRUE(kModernLists.IsListName(u"a.M3U8"_s));
    EXPECT_FALSE(kModernLists.IsListName(u"a.mp3"_s));
}

TEST(PlayListFiles, AHostileListHasTooManyEntriesOrTooLongOnes) {
    std::string file = "#EXTM3U\r\n";
    for (std::size_t i = 0; i <= kMostListEntries; ++i)
        file += "a\n";
    EXPECT_THROW(ClassicNames(file), EPlayListException);
    ListBuilder list;
    const QString name(1 << 20, u'a');  // shared, so that only the count of them is large
    EXPECT_THROW(while (true) list.Add({.Name = name}), EPlayListException);
    EXPECT_LE(list.Count(), kMostListMemory >> 21);
}
