#include <gtest/gtest.h>

#include <QJsonArray>

#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/Builders.h"
#include "tests/cli/CommandRunner.h"

using namespace Qt::StringLiterals;

namespace {

class InfoTest : public CommandTest {};

// A leading ID3v2.3 tag with one text frame; no audio behind it.
std::vector<std::uint8_t> TaggedFile(std::string_view title) {
    return Mp3Builder().Raw(Id3v2Builder().Text("TIT2", title).Build()).Zeros(200).Data();
}

}  // namespace

TEST_F(InfoTest, TheObjectHasItsKeysInTheirOrder) {
    const auto result = RunWords({u"info"_s, u"--json"_s, PutWave(u"Wer - Was.wav"_s, 3)});
    EXPECT_EQ(result.Status, esDone);
    const QStringList keys = {
        u"fileName"_s,  u"title"_s,    u"artist"_s,    u"album"_s,       u"year"_s,       u"comment"_s,
        u"format"_s,    u"length"_s,   u"genre"_s,     u"bitRate"_s,     u"sampleRate"_s, u"channelMode"_s,
        u"emphasis"_s,  u"private"_s,  u"protected"_s, u"copyrighted"_s, u"original"_s,   u"padding"_s,
        u"frameSize"_s, u"track"_s,    u"playCount"_s, u"reserved"_s,    u"flags"_s,      u"mainGenre"_s,
        u"remix"_s,     u"fileTime"_s, u"error"_s,     u"vbr"_s,         u"frameCount"_s};
    qsizetype at = 0;
    for (const auto& key : keys) {
        const auto next = result.Out.indexOf(u"\"%1\":"_s.arg(key), at);
        EXPECT_GT(next, at - 1) << key.toStdString();
        at = next;
    }
    const auto objects = result.Objects();
    ASSERT_EQ(objects.size(), 1u);
    const QJsonObject& info = objects[0];
    EXPECT_EQ(info.keys().size(), keys.size());
    EXPECT_EQ(info[u"fileName"_s], Path(u"Wer - Was.wav"_s));
    EXPECT_EQ(info[u"artist"_s], u"Wer"_s);
    EXPECT_EQ(info[u"title"_s], u"Was"_s);
    EXPECT_EQ(info[u"format"_s], u"Wave"_s);
    EXPECT_EQ(info[u"length"_s], 3);
    EXPECT_EQ(info[u"sampleRate"_s], 1000);
    EXPECT_EQ(info[u"remix"_s], QJsonValue(false));
    EXPECT_TRUE(info[u"error"_s].isNull());
    EXPECT_EQ(info[u"vbr"_s], QString());
}

TEST_F(InfoTest, AMissingFileIsReportedAndTheOthersAreShown) {
    const auto result = RunWords({u"info"_s, u"--json"_s, Path(u"nix.mp3"_s), PutWave(u"a.wav"_s)});
    EXPECT_EQ(result.Status, esFailed);
    EXPECT_TRUE(result.Err.contains(u"nix.mp3: Datei nicht gefunden"_s));
    const auto objects = result.Objects();
    ASSERT_EQ(objects.size(), 2u);
    EXPECT_EQ(objects[0][u"error"_s], u"Datei nicht gefunden"_s);
    EXPECT_EQ(objects[0][u"fileName"_s], Path(u"nix.mp3"_s));
    EXPECT_TRUE(objects[1][u"error"_s].isNull());
}

TEST_F(InfoTest, FramesAreListedInBothProfiles) {
    Put(Path(u"a.mp3"_s), TaggedFile("T\xFCr"));
    for (const QStringList& profile : {QStringList(), QStringList{u"--classic"_s}}) {
        const auto objects =
            RunWords(QStringList{u"info"_s, u"--json"_s, u"--frames"_s, Path(u"a.mp3"_s)} + profile)
                .Objects();
        ASSERT_EQ(objects.size(), 1u);
        const auto frames = objects[0][u"frames"_s].toArray();
        ASSERT_GE(frames.size(), 1);
        EXPECT_EQ(frames[0][u"id"_s], u"TIT2"_s);
        EXPECT_EQ(frames[0][u"text"_s], u"Tür"_s);
        EXPECT_TRUE(frames[0].toObject().contains(u"number"_s));
    }
}

TEST_F(InfoTest, TheSheetShowsNoControlCharactersOfATag) {
    Put(Path(u"a.mp3"_s), TaggedFile("a\x1B[2Jb\nc"));
    const auto result = RunWords({u"info"_s, u"--frames"_s, Path(u"a.mp3"_s)});
    EXPECT_FALSE(result.Out.contains(QChar(0x1B)));
    EXPECT_TRUE(result.Out.contains(u"a [2Jb c"_s)) << result.Out.toStdString();
}
