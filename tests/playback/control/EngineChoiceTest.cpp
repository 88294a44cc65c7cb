#include "MusicManagment/playback/EngineChoice.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

// By the letters of the engines that are allowed.
QString Chosen(const QString& letters, const QString& file) {
    EngineSettings settings;
    settings.UseFMOD = letters.contains(u'F');
    settings.UseEldoS = letters.contains(u'E');
    settings.UseMCI = letters.contains(u'M');
    settings.UseWinAmp = letters.contains(u'W');
    const auto engine = ChooseEngine(file, settings);
    return engine ? EngineName(*engine) : QString();
}

TEST(EngineChoiceTest, TakesTheFirstAllowedEngineForTheExtension) {
    EXPECT_EQ(Chosen(u"EMW"_s, u"/m/A.MP3"_s), u"EldoS"_s);
    EXPECT_EQ(Chosen(u"EMW"_s, u"/m/a.mid"_s), u"MCI"_s);
    EXPECT_EQ(Chosen(u"FEMW"_s, u"/m/a.cda"_s), u"MCI"_s);
    EXPECT_EQ(Chosen(u"EMW"_s, u"/m/a.ogg"_s), u"WinAmp"_s);
    EXPECT_EQ(Chosen(u"EM"_s, u"/m/a.ogg"_s), QString());
    EXPECT_EQ(Chosen(u"FEMW"_s, u"/m/a.flac"_s), u"WinAmp"_s);
    EXPECT_EQ(Chosen(u"FEM"_s, u"/m.mp3/song"_s), QString());
}

}  // namespace
