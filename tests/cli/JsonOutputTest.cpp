#include "cli/JsonOutput.h"

#include <gtest/gtest.h>

#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <limits>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

QByteArray TextLine(const QString& text) {
    JsonLine line;
    line.Begin();
    line.Text("t", text);
    return line.End().toByteArray();
}

QByteArray RealLine(double value) {
    JsonLine line;
    line.Begin();
    line.Real("r", value);
    return line.End().toByteArray();
}

}  // namespace

TEST(JsonOutput, TextsReadBackAsTheyWere) {
    QString all;
    for (char16_t c = 1; c < 0x3000; ++c)
        all += QChar(c);
    all += u"😀\uFFFE\U0010FFFF"_s;
    for (const QString& text : {all, QString(), QString(QChar(u'\0')), u"\"\\/\r\n\t"_s}) {
        const QByteArray line = TextLine(text);
        EXPECT_EQ(line.count('\n'), 1);
        EXPECT_EQ(QJsonDocument::fromJson(line).object()[u"t"_s].toString(), text);
    }
    EXPECT_EQ(TextLine(u"Ö"_s), "{\"t\":\"Ö\"}\n");
}

TEST(JsonOutput, HalfAPairIsReplaced) {
    const QChar high(0xD83D);
    const QChar low(0xDE00);
    const QByteArray replacement = "\xEF\xBF\xBD";
    EXPECT_EQ(TextLine(QString(high)), "{\"t\":\"" + replacement + "\"}\n");
    EXPECT_EQ(TextLine(QString(low) + high + u'x'), "{\"t\":\"" + replacement + replacement + "x\"}\n");
    EXPECT_EQ(TextLine(QString(high) + high + low), "{\"t\":\"" + replacement + "😀\"}\n");
}

TEST(JsonOutput, RealsAreShortAndReadBackExactly) {
    EXPECT_EQ(RealLine(45000), "{\"r\":45000}\n");
    EXPECT_EQ(RealLine(0.1), "{\"r\":0.1}\n");
    EXPECT_EQ(RealLine(std::numeric_limits<double>::infinity()), "{\"r\":null}\n");
    EXPECT_EQ(RealLine(std::numeric_limits<double>::quiet_NaN()), "{\"r\":null}\n");
    for (const double value : {46347.336632418985, -1.5e-300, 1.7976931348623157e308, 5e-324})
        EXPECT_EQ(QJsonDocument::fromJson(RealLine(value)).object()[u"r"_s].toDouble(), value);
}

TEST(JsonOutput, ArraysAndObjectsNest) {
    JsonLine line;
    for (int round = 0; round < 2; ++round) {  // the second line starts anew
        line.Begin();
        line.BeginArray("empty");
        line.EndArray();
        line.BeginArray("a");
        line.Item(u"x");
        line.BeginItem();
        line.Number("n", -5);
        line.Null("z");
        line.EndItem();
        line.BeginItem();
        line.EndItem();
        line.EndArray();
        line.Flag("f", true);
        EXPECT_EQ(line.End().toByteArray(),
                  "{\"empty\":[],\"a\":[\"x\",{\"n\":-5,\"z\":null},{}],\"f\":true}\n");
    }
}
