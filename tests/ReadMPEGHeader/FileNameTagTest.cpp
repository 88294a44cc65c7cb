#include "ReadMPEGHeader/FileNameTag.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

TEST(FileNameTag, NamesAreDividedAtTheFirstSeparatorOfTheList) {
    struct Case {
        QString Path;
        QString Artist;
        QString Title;
    };
    const std::array cases = {
        Case{u"/m/ABBA/ABBA - Waterloo.mp3"_s, u"ABBA"_s, u"Waterloo"_s},
        // " - " before "-", wherever they stand.
        Case{u"/m/a-ha - Take on me.mp3"_s, u"a-ha"_s, u"Take on me"_s},
        Case{u"/m/a-ha.mp3"_s, u"a"_s, u"ha"_s},
        Case{u"/m/A - B - C.mp3"_s, u"A"_s, u"B - C"_s},
        Case{u"- B.x.mp3"_s, u""_s, u"B.x"_s},
        // Numbers of copies.
        Case{u"/m/A - B (2).mp3"_s, u"A"_s, u"B"_s},
        Case{u"/m/A - B (1.2).mp3"_s, u"A"_s, u"B"_s},
        Case{u"/m/A - B (x)(2).mp3"_s, u"A"_s, u"B (x)"_s},
        Case{u"/m/A - B (Live).mp3"_s, u"A"_s, u"B (Live)"_s},
        Case{u"/m/A - B 2).mp3"_s, u"A"_s, u"B 2)"_s},
        // Without a separator the folder is the artist.
        Case{u"/m/ABBA/ Waterloo (2).mp3"_s, u"ABBA"_s, u"Waterloo (2)"_s},
        Case{u"/m/Neue Musik/Waterloo.mp3"_s, u""_s, u"Waterloo"_s},
        Case{u"/Waterloo.mp3"_s, u""_s, u"Waterloo"_s},
        Case{u"Waterloo"_s, u""_s, u"Waterloo"_s},
        Case{u"A/.mp3"_s, u"A"_s, u".mp3"_s},
    };
    for (const auto& [path, artist, title] : cases) {
        const auto tag = TagFromFileName(path, {u"NEUE MUSIK"_s});
        SCOPED_TRACE(path.toStdString());
        EXPECT_EQ(tag.Artist, artist);
        EXPECT_EQ(tag.Title, title);
        EXPECT_EQ(tag.FileName, path);
        EXPECT_EQ(tag.Year, u"0000"_s);
    }
}
