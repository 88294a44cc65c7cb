#include "app/views/DSPDraw.h"

#include <gtest/gtest.h>

#include <QAction>
#include <QCoreApplication>
#include <QPainter>
#include <QTemporaryDir>
#include <QTest>

#include "CommonRUKTools/RWReg.h"
#include "app/views/SpectrumForm.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

SpectrumColumns OneColumn(std::size_t column, float height) {
    SpectrumColumns columns;
    columns.Heights[column] = height;
    columns.Peaks[column] = height;
    return columns;
}

const SpectrumColors kColors = {Qt::black, Qt::green, Qt::red};

// How much of the picture is not background, left and right of its middle.
std::pair<int, int> Painted(TSpectrumStyle style, const SpectrumColumns& columns) {
    QImage picture(200, 100, QImage::Format_RGB32);
    QPainter painter(&picture);
    PaintSpectrum(painter, picture.size(), columns, style, kColors);
    painter.end();
    std::pair<int, int> count;
    for (int x = 0; x < 200; ++x)
        for (int y = 0; y < 98; ++y)
            if (picture.pixelColor(x, y) != Qt::black) ++(x < 100 ? count.first : count.second);
    return count;
}

}  // namespace

TEST(SpectrumPainterTest, LoudTonesFillTheirPlace) {
    for (const TSpectrumStyle style : {ssBars, ssLine, ssCircle}) {
        const auto quiet = Painted(style, {});
        const auto low = Painted(style, OneColumn(3, 1.0F));
        const auto high = Painted(style, OneColumn(35, 1.0F));
        EXPECT_GT(low.first, quiet.first + 20);
        EXPECT_GT(high.second, quiet.second + 20);
        if (style == ssCircle) {
            EXPECT_NEAR(low.first, low.second, 20);
            continue;
        }
        EXPECT_EQ(low.second, quiet.second);
        EXPECT_EQ(high.first, quiet.first);
    }
}

TEST(DSPDrawTest, DrawsWhileItCanBeSeenAndRestsWhileHidden) {
    const QString key = u"RUK DSP draw test %1"_s.arg(QCoreApplication::applicationPid());
    SpectrumBlock player(key);
    ASSERT_TRUE(player.Open());
    TDSPDraw draw(key);
    QList<bool> told;
    draw.OnDrawing = [&](bool drawing) { told << drawing; };
    draw.resize(200, 100);
    EXPECT_FALSE(draw.IsDrawing());
    draw.show();
    EXPECT_TRUE(draw.IsDrawing());
    SpectrumBands bands;
    bands.fill(0.5F);
    player.Write(bands);
    EXPECT_TRUE(QTest::qWaitFor([&] { return draw.Frames() > 1; }));

    // While the window is blocked, one picture waits for it.
    int frames = draw.Frames();
    const std::uint32_t looks = player.Looks();
    while (player.Looks() < looks + 8)
        player.Write(bands);
    QCoreApplication::sendPostedEvents();
    EXPECT_LE(draw.Frames(), frames + 2);

    draw.hide();
    EXPECT_FALSE(draw.IsDrawing());
    QCoreApplication::processEvents();
    frames = draw.Frames();
    player.Write(bands);
    QCoreApplication::processEvents();
    EXPECT_EQ(draw.Frames(), frames);
    draw.show();
    EXPECT_EQ(told, QList<bool>({true, false, true}));
}

TEST(SpectrumFormTest, TheStyleIsChosenInTheMenuAndRemembered) {
    const QTemporaryDir folder;
    TRWReg settings(u"\\Software\\RUK\\Tunestead3"_s, folder.filePath(u"s.ini"_s));
    TSpectrumForm form;
    EXPECT_EQ(form.Draw().Style(), ssBars);
    for (QAction* action : form.Draw().actions())
        if (action->text() == u"&Kreis"_s) action->trigger();
    EXPECT_EQ(form.Draw().Style(), ssCircle);
    form.SaveSettings(settings);

    TSpectrumForm next;
    next.LoadSettings(settings);
    EXPECT_EQ(next.Draw().Style(), ssCircle);
    settings.WriteInteger(u"SpectrumStyle"_s, 7);
    next.LoadSettings(settings);
    EXPECT_EQ(next.Draw().Style(), ssCircle);
}
