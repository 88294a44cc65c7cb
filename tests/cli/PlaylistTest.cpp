#include <gtest/gtest.h>

#include "tests/PrintQt.h"
#include "tests/cli/CommandRunner.h"

using namespace Qt::StringLiterals;

namespace {

class PlaylistCommandTest : public CommandTest {
 protected:
    CommandResult Run(const QStringList& words) const { return RunWords(QStringList{u"playlist"_s} + words); }
    QString List() const {
        Put(Path(u"l.m3u"_s), AsBytes("#EXTM3U\n#EXTINF:227,Björk - Venus\tas a Boy\n/m/a.mp3\nb.mp3\n"));
        return Path(u"l.m3u"_s);
    }
};

}  // namespace

TEST_F(PlaylistCommandTest, AListIsShownAsTextAndAsJson) {
    const auto text = Run({List()});
    EXPECT_EQ(text.Status, esDone);
    EXPECT_EQ(text.Out, u"0\tBjörk\tVenus as a Boy\t3:47\t/m/a.mp3\n1\t\t\t\t"_s + Path(u"b.mp3"_s) + u'\n');
    const auto objects = Run({u"--json"_s, List()}).Objects();
    ASSERT_EQ(objects.size(), 2u);
    EXPECT_EQ(objects[0][u"name"_s].toString(), u"/m/a.mp3"_s);
    EXPECT_EQ(objects[0][u"artist"_s].toString(), u"Björk"_s);
    EXPECT_EQ(objects[1][u"index"_s].toInt(), 1);
    EXPECT_EQ(objects[1].size(), 2);
    EXPECT_TRUE(Run({u"--classic"_s, List()}).Out.contains(u"/EXTINF:227,"_s));
}

TEST_F(PlaylistCommandTest, AListIsConvertedToTheFormatOfTheExtension) {
    const QString native = Path(u"l.rukpl"_s);
    EXPECT_EQ(Run({List(), u"--out"_s, native}).Status, esDone);
    EXPECT_EQ(Run({native, u"--out"_s, Path(u"l.pls"_s)}).Status, esDone);
    EXPECT_EQ(folder_.Get(u"l.pls"_s),
              "[playlist]\r\nFile1=/m/a.mp3\r\nTitle1=Björk - Venus\tas a Boy\r\nLength1=227\r\nFile2=" +
                  Path(u"b.mp3"_s).toUtf8() + "\r\nNumberOfEntries=2\r\nVersion=2\r\n");
}

TEST_F(PlaylistCommandTest, WhatCannotBeReadOrMeantIsSaid) {
    Run({List(), u"--out"_s, Path(u"l.rukpl"_s)});
    const QByteArray before = folder_.Get(u"l.rukpl"_s);
    Put(Path(u"cut.rukpl"_s), AsBytes({before.constData(), 60}));
    struct Case {
        QStringList Words;
        int Status;
        QString Message;
    };
    const Case cases[] = {
        {{Path(u"cut.rukpl"_s), u"--out"_s, Path(u"l.rukpl"_s)}, esFailed, u"beschädigt"_s},
        {{Path(u"none.m3u"_s)}, esFailed, u"none.m3u"_s},
        {{}, esWrongUsage, u"DATEI fehlt."_s},
        {{u"a"_s, u"b"_s}, esWrongUsage, u"Überzähliges Argument: b"_s},
        {{u"a"_s, u"--json"_s, u"--out"_s, u"b"_s}, esWrongUsage, u"schließen sich aus"_s},
    };
    for (const Case& test : cases) {
        const auto result = Run(test.Words);
        EXPECT_EQ(result.Status, test.Status);
        EXPECT_TRUE(result.Err.contains(test.Message)) << result.Err.toStdString();
        EXPECT_EQ(result.Out, QString());
    }
    EXPECT_EQ(folder_.Get(u"l.rukpl"_s), before);
}
