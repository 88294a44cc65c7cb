// Every engine plays every type of file that its row of the table names.

#include <gtest/gtest.h>

#include <QTemporaryDir>

#include "tests/PrintQt.h"
#include "tests/playback/engines/EngineRigs.h"
#include "tests/playback/engines/TypeFiles.h"

using namespace Qt::StringLiterals;

// GLib gives up its table of names on purpose when it grows, so that it can be read without a lock. What Qt
// has queued for its own thread of the bus is lost when the program ends before it is delivered. An object of
// ours that is lost is still told: it is not made within Qt.
extern "C" const char* __lsan_default_suppressions();   // NOLINT(bugprone-reserved-identifier)
extern "C" const char* __lsan_default_suppressions() {  // NOLINT(bugprone-reserved-identifier)
    return "leak:libglib-2.0.so\nleak:libQt6Core.so";
}

namespace {

constexpr quint32 kSeekTolerance = 60;  // ms
// The system's player goes on while it is asked.
constexpr quint32 kLate = 700;

struct TypeCase {
    TEngine engine;
    const char* extension;
};

class AllTypes : public testing::TestWithParam<TypeCase> {
 protected:
    void SetUp() override {
        ASSERT_TRUE(folder_.isValid());
        path_ = folder_.filePath(u"Töne #1 100 %."_s + QLatin1StringView(GetParam().extension));
        ASSERT_EQ(ChooseEngine(path_, Only(GetParam().engine)), GetParam().engine) << "not in its table";
        type_.Write(path_);
        sound_ = rig_->Open(path_);
    }

    bool Reaches(quint32 position) {
        return rig_->Await(*sound_, [&] { return sound_->GetPosition() >= position; });
    }
    // Between the places that a seek can reach.
    quint32 SeekStep() const { return GetParam().engine == TEngine::FMOD ? type_.rowsLength : 0; }

    const FileType& type_ = FileTypeOf(QLatin1StringView(GetParam().extension));
    QTemporaryDir folder_;
    QString path_;
    std::unique_ptr<EngineRig> rig_ = MakeRig(GetParam().engine);
    std::unique_ptr<TPlaySoundContainer> sound_;
};

TEST_P(AllTypes, SongOpensAndPlaysWithItsLength) {
    EXPECT_EQ(sound_->GetStatus(), psStopped);
    EXPECT_EQ(sound_->GetPosition(), 0U);
    sound_->Play();
    EXPECT_EQ(sound_->GetStatus(), psPlaying);
    ASSERT_TRUE(Reaches(144));
    EXPECT_EQ(sound_->GetStatus(), psPlaying);
    // The player of the system has to play some files for a moment before it can tell.
    ASSERT_TRUE(rig_->Await(*sound_, [&] { return sound_->GetLength() > 0; }));
    EXPECT_NEAR(sound_->GetLength(), type_.length, type_.tolerance);

    sound_->PauseResume();
    EXPECT_EQ(sound_->GetStatus(), psPaused);
    sound_->PauseResume();
    EXPECT_EQ(sound_->GetStatus(), psPlaying);
    sound_->Stop();
    EXPECT_EQ(sound_->GetStatus(), psStopped);
    EXPECT_EQ(sound_->GetPosition(), 0U);
    sound_->Close();
    EXPECT_EQ(sound_->GetStatus(), psClosed);
    EXPECT_EQ(sound_->GetPosition() + sound_->GetLength(), 0U);
}

TEST_P(AllTypes, SeekLandsAndTheEndIsReached) {
    sound_->Play();
    const quint32 half = type_.length / 2;
    sound_->SetPosition(half);
    const quint32 landed = sound_->GetPosition();
    EXPECT_GE(landed + SeekStep() + kSeekTolerance, half);
    EXPECT_LE(landed, half + (GetParam().engine == TEngine::MCI ? kLate : kSeekTolerance));
    ASSERT_TRUE(Reaches(landed + 1));

    sound_->SetPosition(sound_->GetLength() - 50);
    ASSERT_TRUE(rig_->Await(*sound_, [&] { return sound_->GetStatus() == psStopped; }));
    EXPECT_GE(sound_->GetPosition() + kSeekTolerance, sound_->GetLength());
    EXPECT_NEAR(sound_->GetLength(), type_.length, type_.tolerance);
    sound_->Play();
    EXPECT_EQ(sound_->GetStatus(), psPlaying);
    EXPECT_LT(sound_->GetPosition(), half);
}

std::vector<TypeCase> Cases(TEngine engine, std::initializer_list<const char*> extensions) {
    std::vector<TypeCase> cases;
    for (const char* extension : extensions)
        cases.push_back({engine, extension});
    return cases;
}

const auto kNameOf = [](const auto& type) { return std::string(type.param.extension); };

INSTANTIATE_TEST_SUITE_P(FMOD, AllTypes,
                         testing::ValuesIn(Cases(TEngine::FMOD,
                                                 {"mp3", "mp2", "wma", "wav", "mid", "rmi", "raw", "asf",
                                                  "ogg", "mod", "s3m", "xm", "it"})),
                         kNameOf);
INSTANTIATE_TEST_SUITE_P(EldoS, AllTypes,
                         testing::ValuesIn(Cases(TEngine::EldoS, {"mp3", "mp2", "wma", "wav"})), kNameOf);
INSTANTIATE_TEST_SUITE_P(MCI, AllTypes,
                         testing::ValuesIn(Cases(TEngine::MCI,
                                                 {"mp3", "mp2", "wma", "wav", "mid", "rmi", "avi"})),
                         kNameOf);

}  // namespace
