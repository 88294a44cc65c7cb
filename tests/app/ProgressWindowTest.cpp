#include "app/dialogs/ProgressWindow.h"

#include <gtest/gtest.h>

#include <QLabel>
#include <QProgressBar>
#include <QPushButton>
#include <QTest>

#include "tests/HandClock.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

class ProgressWindowTest : public testing::Test {
 protected:
    ProgressWindowTest() { window_.Start(); }

    QString Text(const QString& name) const { return window_.findChild<QLabel*>(name)->text(); }
    QProgressBar& Bar(const QString& name) const { return *window_.findChild<QProgressBar*>(name); }

    HandClock clock_;
    TPrgForm window_{nullptr};
};

TEST_F(ProgressWindowTest, ShowsBothBarsTheirTextsAndTheTitle) {
    EXPECT_TRUE(window_.isVisible());
    EXPECT_EQ(window_.windowTitle(), u"Tunestead"_s);
    window_.ShowPoint({3, 12, 1, 2, ptAddSongs, u"/Musik/Lied.mp3"_s}, 25);
    EXPECT_EQ(Text(u"heading"_s), u"Nehme Songs in die Datenbank auf"_s);
    EXPECT_EQ(Text(u"mainLabel"_s), u"3 von 12 - /Musik/Lied.mp3"_s);
    EXPECT_EQ(Text(u"subLabel"_s), u"1 von 2"_s);
    EXPECT_EQ(Bar(u"mainBar"_s).value(), 3);
    EXPECT_EQ(Bar(u"mainBar"_s).maximum(), 12);
    EXPECT_EQ(Bar(u"subBar"_s).maximum(), 2);
    EXPECT_EQ(window_.windowTitle(), u"Tunestead - 25 %"_s);

    window_.ShowPoint({4, 12, 0, 0, ptOther, QString()}, 33);
    EXPECT_EQ(Text(u"mainLabel"_s), u"4 von 12"_s);
    EXPECT_FALSE(Bar(u"subBar"_s).isVisible());

    window_.Finish();
    EXPECT_FALSE(window_.isVisible());
    EXPECT_EQ(window_.windowTitle(), u"Tunestead"_s);
}

TEST_F(ProgressWindowTest, PointsInQuickSuccessionAreNotAllPaintedButTheLastIs) {
    window_.ShowPoint({1, 12, 0, 0, ptAddSongs, QString()}, 8);
    window_.ShowPoint({2, 12, 0, 0, ptAddSongs, QString()}, 16);
    EXPECT_EQ(Text(u"mainLabel"_s), u"1 von 12"_s);
    window_.ShowPoint({12, 12, 0, 0, ptAddSongs, QString()}, 100);
    EXPECT_EQ(Text(u"mainLabel"_s), u"12 von 12"_s);
}

TEST_F(ProgressWindowTest, NumbersBeyondABarKeepTheirProportion) {
    window_.ShowPoint({3'000'000'000, 6'000'000'000, 0, 0, ptCopySongs, QString()}, 50);
    const QProgressBar& bar = Bar(u"mainBar"_s);
    EXPECT_NEAR(static_cast<double>(bar.value()) / bar.maximum(), 0.5, 0.01);
}

TEST_F(ProgressWindowTest, TheRemainingTimeComesAfterTwoSecondsAndStartsAnewWithEachStage) {
    const auto remainingAt = [&](qint64 milliseconds, qint64 current, qint64 maximum) {
        clock_.Milliseconds = 1'000'000 + milliseconds;
        window_.ShowPoint({current, maximum, 0, 0, ptAddSongs, QString()}, 0);
        return Text(u"remaining"_s);
    };
    EXPECT_EQ(remainingAt(0, 0, 100), QString());
    EXPECT_EQ(remainingAt(1999, 10, 100), QString());
    EXPECT_EQ(remainingAt(4000, 10, 100), u"Verbleibende Zeit: 0:36"_s);
    EXPECT_EQ(remainingAt(6000, 60, 100), u"Verbleibende Zeit: 0:04"_s);
    EXPECT_EQ(remainingAt(7000, 60, 0), QString());
    EXPECT_EQ(remainingAt(8000, 1000, 2000), QString());
    EXPECT_EQ(remainingAt(18000, 1500, 2000), u"Verbleibende Zeit: 0:10"_s);
}

TEST_F(ProgressWindowTest, ButtonEscapeAndClosingAskToStopOnceAndLeaveTheWindow) {
    int stops = 0;
    window_.OnStop = [&] { ++stops; };
    auto* button = window_.findChild<QPushButton*>(u"stop"_s);
    QTest::mouseClick(button, Qt::LeftButton);
    EXPECT_EQ(stops, 1);
    EXPECT_FALSE(button->isEnabled());
    QTest::keyClick(&window_, Qt::Key_Escape);
    EXPECT_EQ(stops, 1);

    window_.Start();
    QTest::keyClick(&window_, Qt::Key_Escape);
    window_.Start();
    window_.close();
    EXPECT_EQ(stops, 3);
    EXPECT_TRUE(window_.isVisible());
}

}  // namespace
