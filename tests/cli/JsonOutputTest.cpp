#include "cli/JsonOutput.h"

#include <gtest/gtest.h>

#include <QJsonDocument>
#include <QJsonObject>
#include <limits>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

// The line of an object with one member "v".
template <typename Write>
QByteArray LineOf(const Write& write) {
    JsonLine line;
    line.Begin();
    write(line);
    return line.End().toByteArray();
}
QByteArray TextLine(const QString& text) {
    return LineOf([&](JsonLine& line) { line.Text("v", text); });
}
QByteArray RealLine(double value) {
    return LineOf([&](JsonLine& line) { line.Real("v", value); });
}

}  // namespace

TEST(JsonOutput, TextsReadBackAsTheyWereAndHalfAPairIsReplaced) {
    QString all;
    for (char16_t c = 1; c < 0x3000; ++c)
        all += QChar(c);
    for (const QString& text : {all + u"😀\uFFFE\U0010FFFF"_s, QString(), QString(QChar(u'\0'))}) {
        const QByteArray line = TextLine(text);
        EXPECT_EQ(line.count('\n'), 1);
        EXPECT_EQ(QJsonDocument::fromJson(line).object()[u"v"_s].toString(), text);
    }
    const QChar high(0xD83D);
    const QChar low(0xDE00);
    const QByteArray replacement = "\xEF\xBF\xBD";
    EXPECT_EQ(TextLine(QString(low) + high + u'x'), "{\"v\":\"" + replacement + replacement + "x\"}\n");
    EXPECT_EQ(TextLine(QString(high) + high + low), "{\"v\":\"" + replacement + "😀\"}\n");
}

TEST(JsonOutput, RealsAreShortAndReadBackExactly) {
    EXPECT_EQ(RealLine(0.1), "{\"v\":0.1}\n");
    EXPECT_EQ(RealLine(std::numeric_limits<double>::quiet_NaN()), "{\"v\":null}\n");
    for (const double value : {46347.336632418985, -1.5e-300, 1.7976931348623157e308, 5e-324})
        EXPECT_EQ(QJsonDocument::fromJson(RealLine(value)).object()[u"v"_s].toDouble(), value);
}

TEST(JsonOutput, ArraysAndObjectsNest) {
    JsonLine line;
    for (int round = 0; round < 2; ++round) {  // the second line starts anew
        line.Begin();
        line.BeginArray("a");
        line.BeginItem();
        line.Number("n", -5);
        line.Null("z");
        line.EndItem();
        line.BeginItem();
        line.EndItem();
        line.EndArray();
        line.Texts("t", {u"x"_s, u"y"_s});
        line.Flag("f", true);
        EXPECT_EQ(line.End().toByteArray(),
                  "{\"a\":[{\"n\":-5,\"z\":null},{}],\"t\":[\"x\",\"y\"],\"f\":true}\n");
    }
}
