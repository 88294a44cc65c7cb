#include <gst/gst.h>
#include <gtest/gtest.h>

#include <QMutex>
#include <QTemporaryDir>

#include "MusicManagment/playback/backend/Glide.h"
#include "MusicManagment/playback/mci/GstMci.h"
#include "MusicManagment/playback/mci/MCIPlaySound.h"
#include "MusicManagment/playback/winamp/Waiting.h"
#include "tests/playback/SoundFiles.h"
#include "tests/playback/engines/Patience.h"

using namespace Qt::StringLiterals;

namespace {

constexpr Tone kLoud = {.frequency = 100, .amplitude = 0.999};
constexpr int kRate = 44100;

// What a device would have been given, written down by the threads of GStreamer.
class Heard {
 public:
    // A sink in the time of the clock.
    GstElement* MakeSink() {
        GstElement* sink = gst_element_factory_make("fakesink", nullptr);
        g_object_set(sink, "sync", TRUE, "signal-handoffs", TRUE, nullptr);
        g_signal_connect(sink, "handoff", G_CALLBACK(Write), this);
        return sink;
    }
    Samples All() const {
        const QMutexLocker lock(&mutex_);
        return samples_;
    }
    bool EndsSilent() const {
        const Samples all = All();
        return all.size() > 100 && std::count(all.end() - 100, all.end(), 0.0F) == 100;
    }

 private:
    static void Write(GstElement*, GstBuffer* buffer, GstPad*, gpointer self) {
        auto& heard = *static_cast<Heard*>(self);
        GstMapInfo map;
        gst_buffer_map(buffer, &map, GST_MAP_READ);
        const auto* samples = reinterpret_cast<const float*>(map.data);
        const QMutexLocker lock(&heard.mutex_);
        heard.samples_.insert(heard.samples_.end(), samples, samples + map.size / sizeof(float));
        gst_buffer_unmap(buffer, &map);
    }

    mutable QMutex mutex_;
    Samples samples_;
};

// Real time: the player of the system has no other.
TEST(MciGlideTest, WhateverIsDoneToASongNothingJumps) {
    const QTemporaryDir folder;
    Heard heard;
    auto mci = std::make_unique<GstMci>([&] { return heard.MakeSink(); });
    TMCIPlaySound sound(*mci, folder.filePath(u"settings.conf"_s));
    const auto passes = [&](quint32 position) {
        return WaitUntil([&] { return sound.GetPosition() > position; }, kPatience);
    };
    const auto fallsSilent = [&] { return WaitUntil([&] { return heard.EndsSilent(); }, kPatience); };
    sound.SetBackendFile(folder.filePath(u"a.wav"_s));
    WriteWav(sound.BackendFile(), Sine(kLoud, 8));
    sound.Open();
    sound.Play();
    ASSERT_TRUE(passes(100));
    sound.SetPosition(2345);
    EXPECT_EQ(sound.GetPosition(), 2345U);
    ASSERT_TRUE(passes(2400));
    sound.PauseResume();
    EXPECT_EQ(sound.GetStatus(), psPaused);
    ASSERT_TRUE(fallsSilent());
    sound.PauseResume();
    ASSERT_TRUE(passes(2600));
    sound.SetGain(0.5F);
    ASSERT_TRUE(passes(2800));
    sound.PauseResume();
    sound.PauseResume();
    EXPECT_EQ(sound.GetStatus(), psPlaying);
    ASSERT_TRUE(passes(3000));
    sound.Stop();
    ASSERT_TRUE(fallsSilent());
    sound.Play();
    ASSERT_TRUE(passes(100));
    const Samples played = heard.All();
    EXPECT_NEAR(*std::max_element(played.end() - 1000, played.end()), 0.5F, 0.01F);
    sound.Close();
    mci.reset();
    EXPECT_TRUE(heard.EndsSilent());

    const Samples all = heard.All();
    EXPECT_GT(*std::max_element(all.begin(), all.end()), 0.99F);
    EXPECT_LT(LargestStep(all), SteepestStep(kLoud) + 1.0 / static_cast<double>(GlideFrames(kRate)));
}

}  // namespace
