#include "MusicManagment/playback/EngineChoice.h"

#include <gtest/gtest.h>

#include "MusicManagment/playback/backend/EngineErrors.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

EngineSettings Allow(const QString& letters) {
    EngineSettings settings;
    settings.UseFMOD = letters.contains(u'F');
    settings.UseEldoS = letters.contains(u'E');
    settings.UseMCI = letters.contains(u'M');
    settings.UseWinAmp = letters.contains(u'W');
    return settings;
}

struct ChoiceCase {
    QString Allowed;
    QString File;
    QString Engine;  // empty: none
};

class ChoiceTest : public testing::TestWithParam<ChoiceCase> {};

TEST_P(ChoiceTest, TakesTheFirstAllowedEngineForTheExtension) {
    const auto engine = ChooseEngine(GetParam().File, Allow(GetParam().Allowed));
    EXPECT_EQ(engine ? EngineName(*engine) : QString(), GetParam().Engine);
}

INSTANTIATE_TEST_SUITE_P(Table, ChoiceTest,
                         testing::Values(ChoiceCase{u"FEMW"_s, u"/m/a.mp3"_s, u"FMOD"_s},
                                         ChoiceCase{u"EMW"_s, u"/m/A.MP3"_s, u"EldoS"_s},
                                         ChoiceCase{u"MW"_s, u"/m/a.wma"_s, u"MCI"_s},
                                         ChoiceCase{u"W"_s, u"/m/a.wav"_s, u"WinAmp"_s},
                                         ChoiceCase{u"EMW"_s, u"/m/a.mid"_s, u"MCI"_s},
                                         ChoiceCase{u"FEMW"_s, u"/m/a.cda"_s, u"MCI"_s},
                                         ChoiceCase{u"EMW"_s, u"/m/a.ogg"_s, u"WinAmp"_s},
                                         ChoiceCase{u"EM"_s, u"/m/a.ogg"_s, QString()},
                                         ChoiceCase{u"FEMW"_s, u"/m/a.flac"_s, u"WinAmp"_s},
                                         ChoiceCase{u"FEM"_s, u"/m.mp3/song"_s, QString()},
                                         ChoiceCase{QString(), u"/m/a.mp3"_s, QString()}));

TEST(EnginesAfterTest, AreTheLaterOnesThatAreAllowedWhateverTheyTake) {
    using Engines = std::vector<TEngine>;
    EXPECT_EQ(EnginesAfter(TEngine::FMOD, Allow(u"FEMW"_s)),
              (Engines{TEngine::EldoS, TEngine::MCI, TEngine::WinAmp}));
    EXPECT_EQ(EnginesAfter(TEngine::EldoS, Allow(u"FEW"_s)), Engines{TEngine::WinAmp});
    EXPECT_TRUE(EnginesAfter(TEngine::MCI, Allow(u"FEM"_s)).empty());
}

TEST(EngineTableTest, WithoutAMakerThePlayerSaysSo) {
    EXPECT_THROW(EngineTable().Create(TEngine::MCI, {}), EPlaySoundException);
}

}  // namespace
