#include "tests/PrintQt.h"
#include "tests/cli/CommandRunner.h"

using namespace Qt::StringLiterals;

TEST_F(CommandTest, ConvertTellsOfEachFileAndFailsWhereOneDoes) {
    const QString good = PutWave(u"Band - Lied.wav"_s);
    const QString missing = Path(u"fehlt.wav"_s);
    const auto result = RunWords({u"convert"_s, u"--to"_s, u"mp3"_s, u"--quality"_s, u"64"_s, u"--out"_s,
                                  Path(u"neu"_s), u"--json"_s, good, missing});
    EXPECT_EQ(result.Status, esFailed);
    const auto objects = result.Objects();
    ASSERT_EQ(objects.size(), 2U);
    EXPECT_EQ(objects[0][u"source"_s].toString(), good);
    EXPECT_EQ(objects[0][u"target"_s].toString(), Path(u"neu/Band - Lied.mp3"_s));
    EXPECT_TRUE(objects[0][u"error"_s].isNull());
    EXPECT_EQ(objects[1][u"source"_s].toString(), missing);
    EXPECT_TRUE(objects[1][u"target"_s].isNull() && !objects[1][u"error"_s].toString().isEmpty());
    const auto info = RunWords({u"info"_s, u"--json"_s, Path(u"neu/Band - Lied.mp3"_s)}).Objects();
    EXPECT_EQ(info[0][u"title"_s].toString(), u"Lied"_s);
    EXPECT_EQ(info[0][u"bitRate"_s].toInt(), 64);

    for (const auto& [format, quality] :
         {std::pair{u"mp3"_s, u"V10"_s}, {u"mp3"_s, u"abr"_s}, {u"wav"_s, u"8"_s}, {u"wma"_s, u"V2"_s}})
        EXPECT_EQ(RunWords({u"convert"_s, u"--to"_s, format, u"--quality"_s, quality, good}).Status,
                  esWrongUsage);
}
