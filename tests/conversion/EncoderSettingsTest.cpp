#include "MusicManagment/conversion/EncoderSettings.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

TEST(EncoderSettings, RecordsComeBackAndDamagedOnesStandForTheDefaults) {
    const EncoderSettings chosen{
        .Mp3 = {.Bits = Mp3Settings::Method::Average,
                .Quality = 9,
                .BitRate = 320,
                .Effort = 0,
                .Sides = Mp3Settings::Channels::Mono,
                .Rate = 32000},
        .Wav = {.Bits = 24, .Sides = WavSettings::Channels::Stereo, .Rate = 192000, .Dither = false},
        .Wma = {.BitRate = 768, .Rate = 8000, .TimeLimit = std::chrono::hours(2)},
        .Script = u"/opt/enc"_s,
        .ScriptArguments = u"-x %TARGET%"_s};
    ConversionSettings stored;
    EXPECT_EQ(ReadEncoderSettings(stored), EncoderSettings());  // nothing was ever chosen
    StoreEncoderSettings(chosen, stored);
    EXPECT_EQ(stored.Mp3, QByteArray::fromHex("01 02 09 00 03 4001 007D0000 00"));
    EXPECT_EQ(stored.Wav, QByteArray::fromHex("01 18 01 00 00EE0200 00000000"));
    EXPECT_EQ(stored.Wma, QByteArray::fromHex("01 0003 401F0000 201C 00"));
    EXPECT_EQ(ReadEncoderSettings(stored), chosen);

    const ConversionSettings whole = stored;
    for (QByteArray ConversionSettings::*record :
         {&ConversionSettings::Mp3, &ConversionSettings::Wav, &ConversionSettings::Wma}) {
        const QByteArray good = whole.*record;
        for (const QByteArray& bad : {good.chopped(1), good + '\0', QByteArray(),
                                      QByteArray(good.size(), '\xFF'), '\2' + good.mid(1)}) {
            stored = whole;
            stored.*record = bad;
            EXPECT_NE(ReadEncoderSettings(stored), chosen) << bad.toHex().constData();
        }
    }
}

TEST(EncoderSettings, ARateThatTheFormatDoesNotHaveIsTheNextOne) {
    const EncoderSettings settings;
    for (const auto& [source, target] : {std::pair{44100, 44100},
                                         {11000, 11025},
                                         {96000, 48000},
                                         {88200, 44100},
                                         {4000, 8000},
                                         {44101, 48000}}) {
        EXPECT_EQ(TargetRate(MusicFormat::Mp3, settings, source), target);
        EXPECT_EQ(TargetRate(MusicFormat::Wma, settings, source), target);
        EXPECT_EQ(TargetRate(MusicFormat::Wav, settings, source), source);
    }
}
