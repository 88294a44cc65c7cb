#include "MusicManagment/playback/mci/GstMci.h"

#include <gtest/gtest.h>

#include <QThread>

#include "CommonRUKTools/Clock.h"
#include "MusicManagment/playback/backend/EngineErrors.h"
#include "MusicManagment/playback/mci/MCIPlaySound.h"
#include "tests/PrintQt.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

// GLib gives up its table of names on purpose when it grows, so that it can be read without a lock.
extern "C" const char* __lsan_default_suppressions();   // NOLINT(bugprone-reserved-identifier)
extern "C" const char* __lsan_default_suppressions() {  // NOLINT(bugprone-reserved-identifier)
    return "leak:libglib-2.0.so";
}

namespace {

class GstMciTest : public testing::Test {
 protected:
    void SetUp() override {
        for (const char* part : {"playbin", "wavparse"})
            if (!GstMci::HasPart(part)) GTEST_SKIP() << "GStreamer has no " << part;
    }

    void Open(const QString& path) {
        sound_.SetBackendFile(path);
        sound_.Open();
    }
    // Until the sound has come that far or stopped; a player that hangs fails.
    void PlayTo(quint32 milliseconds) {
        const qint64 deadline = CurrentClock().Ticks() + 10'000;
        while (sound_.GetPosition() < milliseconds && sound_.GetStatus() == psPlaying) {
            ASSERT_LT(CurrentClock().Ticks(), deadline);
            QThread::msleep(5);
        }
    }

    SongFolder folder_;
    GstMci mci_{MciSound::Silent};
    TMCIPlaySound sound_{mci_, folder_.Path(u"settings.conf"_s)};
};

TEST_F(GstMciTest, SongPlaysPausesSeeksAndEnds) {
    Open(folder_.Add(u"a b%20ü.wav"_s, 3));
    EXPECT_EQ(sound_.GetStatus(), psStopped);
    EXPECT_EQ(sound_.GetLength(), 3000U);
    EXPECT_EQ(sound_.GetPosition(), 0U);

    sound_.Play();
    sound_.SetGain(0.5F);
    EXPECT_EQ(sound_.GetStatus(), psPlaying);
    PlayTo(50);
    sound_.PauseResume();
    EXPECT_EQ(sound_.GetStatus(), psPaused);
    EXPECT_GE(sound_.GetPosition(), 50U);

    sound_.SetPosition(2900);
    EXPECT_EQ(sound_.GetStatus(), psPlaying);
    EXPECT_GE(sound_.GetPosition(), 2899U);
    PlayTo(UINT32_MAX);
    EXPECT_EQ(sound_.GetStatus(), psStopped);
    EXPECT_EQ(sound_.GetPosition(), sound_.GetLength());
    EXPECT_NEAR(sound_.GetLength(), 3000, 10);

    sound_.Play();  // once more from the start
    EXPECT_EQ(sound_.GetStatus(), psPlaying);
    EXPECT_LT(sound_.GetPosition(), 1000U);
    sound_.Stop();
    EXPECT_EQ(sound_.GetStatus(), psStopped);
    EXPECT_EQ(sound_.GetPosition(), 0U);
    EXPECT_EQ(sound_.GetLength(), 3000U);
    sound_.PauseResume();
    EXPECT_EQ(sound_.GetStatus(), psStopped);
}

TEST_F(GstMciTest, TwoSongsAreDevicesOfTheirOwn) {
    Open(folder_.Add(u"a.wav"_s, 3));
    TMCIPlaySound other(mci_, folder_.Path(u"settings.conf"_s));
    other.SetBackendFile(folder_.Add(u"b.wav"_s, 2));
    other.Open();
    other.Play();
    EXPECT_EQ(sound_.GetStatus(), psStopped);
    EXPECT_EQ(sound_.GetLength() - other.GetLength(), 1000U);
}

TEST_F(GstMciTest, DamagedFilesAreRefusedWithAReason) {
    const QString path = folder_.Path(u"damaged.mp3"_s);
    QFile file(path);
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    file.write(QByteArray(5000, '\x11'));
    file.close();
    for (const QString& name : {path, folder_.Path(u"missing.mp3"_s)}) {
        try {
            Open(name);
            ADD_FAILURE() << "opened " << name.toStdString();
        } catch (const EMCIException& error) {
            EXPECT_TRUE(error.Message().startsWith(u"Fehler bei mciSendCommand mit MCI_OPEN.\r\n"_s));
            EXPECT_GT(error.Message().size(), 50);
        }
        EXPECT_EQ(sound_.GetStatus(), psClosed);
    }
    EXPECT_THROW(sound_.Play(), EMCIException);
}

}  // namespace
