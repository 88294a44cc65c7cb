#include "CommonRUKTools/FoldedText.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

TEST(FoldedText, IsFoundAsAReaderWouldExpect) {
    struct Case {
        QString Text;
        QString Typed;
        bool Found;
    };
    const Case cases[] = {{u"Mötley Crüe"_s, u"motley crue"_s, true},
                          {u"Motley Crue"_s, u"MÖTLEY"_s, true},
                          {u"Straße"_s, u"strasse"_s, true},
                          {u"Strasse"_s, u"Straße"_s, true},
                          {u"Mo\u0308tley"_s, u"mötl"_s, true},  // decomposed, as some systems name files
                          {u"ΣΟΦΙΑ"_s, u"σοφια"_s, true},
                          {u"ABBA"_s, u"abbas"_s, false},
                          {u""_s, u"a"_s, false},
                          {u"aab"_s, u"ab"_s, true},
                          {u"x\U0001F3B5y"_s, u"\U0001F3B5Y"_s, true}};
    for (const Case& each : cases)
        EXPECT_EQ(ContainsFolded(each.Text, FoldText(each.Typed)), each.Found) << each.Text.toStdString();
}
