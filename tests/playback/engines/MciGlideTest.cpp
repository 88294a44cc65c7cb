#include <gst/gst.h>
#include <gtest/gtest.h>

#include <QMutex>
#include <QTemporaryDir>
#include <QThread>

#include "MusicManagment/playback/backend/Glide.h"
#include "MusicManagment/playback/mci/GstMci.h"
#include "MusicManagment/playback/mci/MCIPlaySound.h"
#include "tests/playback/SoundFiles.h"

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
        const QMutexLocker lock(&mutex_);
        return samples_.size() > 100 &&
               std::all_of(samples_.end() - 100, samples_.end(), [](float sample) { return sample == 0; });
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

class MciGlideTest : public testing::Test {
 protected:
    MciGlideTest() {
        const QString path = folder_.filePath(u"a.wav"_s);
        WriteWav(path, Sine(kLoud, 8));
        sound_.SetBackendFile(path);
        sound_.Open();
    }
    // Half a minute at most.
    bool Await(const std::function<bool()>& condition) {
        for (int i = 0; i < 1500 && !condition(); ++i) {
            QThread::msleep(20);
            sound_.GetStatus();
        }
        return condition();
    }
    bool Passes(quint32 position) {
        return Await([&] { return sound_.GetPosition() > position; });
    }
    bool FallsSilent() {
        return Await([&] { return heard_.EndsSilent(); });
    }

    QTemporaryDir folder_;
    Heard heard_;
    std::unique_ptr<GstMci> mci_ = std::make_unique<GstMci>([this] { return heard_.MakeSink(); });
    TMCIPlaySound sound_{*mci_, folder_.filePath(u"settings.conf"_s)};
};

TEST_F(MciGlideTest, WhateverIsDoneToASongNothingJumps) {
    sound_.Play();
    ASSERT_TRUE(Passes(100));
    sound_.SetPosition(2345);
    EXPECT_EQ(sound_.GetPosition(), 2345U);
    ASSERT_TRUE(Passes(2400));
    sound_.PauseResume();
    EXPECT_EQ(sound_.GetStatus(), psPaused);
    ASSERT_TRUE(FallsSilent());
    sound_.PauseResume();
    ASSERT_TRUE(Passes(2600));
    sound_.SetGain(0.5F);
    ASSERT_TRUE(Passes(2800));
    sound_.PauseResume();
    sound_.PauseResume();
    EXPECT_EQ(sound_.GetStatus(), psPlaying);
    ASSERT_TRUE(Passes(3000));
    sound_.Stop();
    ASSERT_TRUE(FallsSilent());
    sound_.Play();
    ASSERT_TRUE(Passes(100));
    sound_.Close();
    mci_.reset();
    EXPECT_TRUE(heard_.EndsSilent());

    const Samples heard = heard_.All();
    EXPECT_GT(*std::max_element(heard.begin(), heard.end()), 0.99F);
    EXPECT_LT(LargestStep(heard), SteepestStep(kLoud) + 1.0 / static_cast<double>(GlideFrames(kRate)));
}

}  // namespace
