#include "app/views/VisPlaySound.h"

#include <gtest/gtest.h>

#include <QComboBox>
#include <QLabel>
#include <QTest>
#include <QToolButton>

#include "CommonRUKTools/RWReg.h"
#include "MusicManagment/playback/PlaySoundMenu.h"
#include "app/views/SeekSlider.h"
#include "app/views/VolumeSlider.h"
#include "tests/PrintQt.h"
#include "tests/app/ScriptedBackend.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

class VisPlaySoundTest : public testing::Test {
 protected:
    VisPlaySoundTest() {
        player_.SetPlayList(&list_);
        for (const QString& name : {u"a.mp3"_s, u"b.mp3"_s})
            list_.Insert(list_.Count(), {.Name = folder_.Put(name, QByteArray())});
        panel_.resize(900, 60);
        panel_.show();
    }

    QString Text(const QString& name) const { return panel_.findChild<QLabel*>(name)->text(); }
    QToolButton* Button(int command) const {
        return panel_.findChild<QToolButton*>(u"player%1"_s.arg(command));
    }
    SeekSlider* Slider() const { return panel_.findChild<SeekSlider*>(u"position"_s); }
    void TickAt(quint32 position) {
        song_.Position = position;
        player_.Tick();
    }

    SongFolder folder_;
    ScriptedSong song_;
    TPlayList list_;
    TPlaySound player_{ScriptedEngines(song_)};
    TVisPlaySound panel_{player_, list_};
};

TEST_F(VisPlaySoundTest, TheVolumeIsToldAndKept) {
    VolumeSlider& volume = panel_.Volume();
    float gain = -1;
    volume.Follow([&gain](float set) { gain = set; });
    EXPECT_EQ(gain, 1);
    volume.setValue(50);
    EXPECT_EQ(gain, 0.25F);
    TRWReg settings(u"Test"_s, folder_.Path(u"settings"_s));
    volume.SaveSettings(settings);
    QTest::keyClick(&volume, Qt::Key_Home);
    EXPECT_EQ(gain, 0);
    volume.LoadSettings(settings);
    EXPECT_EQ(volume.value(), 50);
}

TEST_F(VisPlaySoundTest, ShowsTheSongAndItsTimes) {
    EXPECT_EQ(Text(u"songTitle"_s), u"Kein Lied"_s);
    EXPECT_FALSE(Slider()->isEnabled());
    ASSERT_TRUE(list_.PlayEntry(0));
    TickAt(65'400);
    EXPECT_EQ(Text(u"songTitle"_s), u"a"_s);
    EXPECT_EQ(Text(u"elapsed"_s), u"1:05"_s);
    EXPECT_EQ(Text(u"remaining"_s), u"−2:54 / 4:00"_s);
    EXPECT_EQ(Slider()->value(), 65'400);
    TickAt(250'000);  // a length that was told wrong
    EXPECT_EQ(Text(u"remaining"_s), u"−0:00 / 4:00"_s);

    player_.SetFileName(QString());
    EXPECT_EQ(Text(u"songTitle"_s), u"Kein Lied"_s);
    EXPECT_EQ(Text(u"elapsed"_s), QString());
    EXPECT_FALSE(Slider()->isEnabled());
}

TEST_F(VisPlaySoundTest, OneButtonPlaysAndPauses) {
    ASSERT_TRUE(list_.PlayEntry(0));
    EXPECT_EQ(Button(plPlay)->accessibleName(), u"Pause"_s);
    EXPECT_TRUE(Button(plStop)->isEnabled());
    Button(plPlay)->click();
    EXPECT_EQ(song_.Status, psPaused);
    EXPECT_EQ(Button(plPlay)->accessibleName(), u"Play"_s);
    Button(plPlay)->click();
    EXPECT_EQ(song_.Status, psPlaying);
    Button(plStop)->click();
    EXPECT_FALSE(Button(plStop)->isEnabled());
}

// --- The position ---

TEST_F(VisPlaySoundTest, DraggingShowsTheTimeAndGoesThereAtItsEnd) {
    ASSERT_TRUE(list_.PlayEntry(0));
    TickAt(10'000);
    const QPoint middle = Slider()->rect().center();
    QTest::mousePress(Slider(), Qt::LeftButton, {}, middle - QPoint(100, 0));
    QTest::mouseMove(Slider(), middle);
    TickAt(11'000);
    EXPECT_EQ(song_.Position, 11'000u);
    EXPECT_NEAR(Slider()->value(), 120'000, 3'000);
    EXPECT_TRUE(Text(u"elapsed"_s).startsWith(u"2:0"_s) || Text(u"elapsed"_s).startsWith(u"1:5"_s));
    QTest::mouseRelease(Slider(), Qt::LeftButton, {}, middle);
    EXPECT_NEAR(song_.Position, 120'000, 3'000);
}

// --- Cross-fading ---

TEST_F(VisPlaySoundTest, ThePlayerAsksHereWhenToFade) {
    EXPECT_EQ(player_.Crossover(), coAutoChange);
    auto* modes = panel_.findChild<QComboBox*>(u"crossover"_s);
    QTest::keyClick(modes, Qt::Key_End);
    EXPECT_EQ(player_.Crossover(), coAlways);
    panel_.SetCrossover(coNone);
    EXPECT_EQ(modes->currentText(), u"Kein Überblenden"_s);
}

}  // namespace
