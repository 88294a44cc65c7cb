#include <gtest/gtest.h>

#include "tests/PrintQt.h"
#include "tests/cli/CommandRunner.h"

using namespace Qt::StringLiterals;

namespace {

class PlaylistCommandTest : public CommandTest {
 protected:
    CommandResult Run(const QStringList& words) const { return RunWords(QStringList{u"playlist"_s} + words); }
    QByteArray BytesOf(const QString& name) const {
        QFile file(Path(name));
        return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
    }
    // A native list of one song with a record and one without.
    void PutNative() const {
        ByteWriter file;
        file.Raw("RUKPLYLST");
        file.U16Le(0x0100);
        const auto text = [&file](std::string_view value) {
            file.U16Le(static_cast<std::uint16_t>(value.size()));
            file.Raw(value);
        };
        text("/m/a.mp3");
        file.U8(255);
        file.U16Le(1993);
        file.U16Le(227);
        file.Zeros(35);
        for (const std::string_view value : {"/m/a.mp3", "Venus\tas a Boy", "Björk", "Debut", "", "MP3"})
            text(value);
        text("/m/b.mp3");
        file.U8(0);
        Put(Path(u"l.rukpl"_s), file.Bytes());
    }
};

}  // namespace

TEST_F(PlaylistCommandTest, AListIsShownAsTextAndAsJson) {
    PutNative();
    const auto text = Run({Path(u"l.rukpl"_s)});
    EXPECT_EQ(text.Status, esDone);
    EXPECT_EQ(text.Out, u"0\tBjörk\tVenus as a Boy\t3:47\t/m/a.mp3\n1\t\t\t\t/m/b.mp3\n"_s);
    const auto objects = Run({u"--json"_s, Path(u"l.rukpl"_s)}).Objects();
    ASSERT_EQ(objects.size(), 2u);
    EXPECT_EQ(objects[0][u"name"_s].toString(), u"/m/a.mp3"_s);
    EXPECT_EQ(objects[0][u"year"_s].toString(), u"1993"_s);
    EXPECT_EQ(objects[1][u"index"_s].toInt(), 1);
    EXPECT_EQ(objects[1].size(), 2);
}

TEST_F(PlaylistCommandTest, AListIsConvertedToTheFormatOfTheExtension) {
    PutNative();
    EXPECT_EQ(Run({Path(u"l.rukpl"_s), u"--out"_s, Path(u"l.m3u"_s)}).Status, esDone);
    EXPECT_EQ(BytesOf(u"l.m3u"_s),
              QByteArray("#EXTM3U\r\n#EXTINF:227,Björk - Venus\tas a Boy\r\n/m/a.mp3\r\n/m/b.mp3\r\n"));
    EXPECT_EQ(Run({Path(u"l.m3u"_s), u"--out"_s, Path(u"l.pls"_s)}).Status, esDone);
    EXPECT_EQ(
        BytesOf(u"l.pls"_s),
        QByteArray("[playlist]\r\nFile1=/m/a.mp3\r\nFile2=/m/b.mp3\r\nNumberOfEntries=2\r\nVersion=2\r\n"));
}

TEST_F(PlaylistCommandTest, WhatCannotBeReadOrMeantIsSaid) {
    PutNative();
    const QByteArray before = BytesOf(u"l.rukpl"_s);
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
    EXPECT_EQ(BytesOf(u"l.rukpl"_s), before);
}
