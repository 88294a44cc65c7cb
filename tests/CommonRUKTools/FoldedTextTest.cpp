#include "CommonRUKTools/FoldedText.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

struct FoldCase {
    QString Text;
    QString Typed;
    bool Found;
};

class FoldedTextTest : public testing::TestWithParam<FoldCase> {};

}  // namespace

TEST_P(FoldedTextTest, IsFoundAsAReaderWouldExpect) {
    EXPECT_EQ(ContainsFolded(GetParam().Text, FoldText(GetParam().Typed)), GetParam().Found)
        << GetParam().Text.toStdString() << " / " << GetParam().Typed.toStdString();
}

INSTANTIATE_TEST_SUITE_P(
    Texts, FoldedTextTest,
    testing::Values(FoldCase{u"Mötley Crüe"_s, u"motley crue"_s, true},
                    FoldCase{u"Motley Crue"_s, u"MÖTLEY"_s, true}, FoldCase{u"Straße"_s, u"strasse"_s, true},
                    FoldCase{u"Strasse"_s, u"Straße"_s, true},
                    FoldCase{u"Mo\u0308tley"_s, u"mötl"_s, true},  // decomposed, as some systems name files
                    FoldCase{u"Sigur Rós"_s, u"ros"_s, true}, FoldCase{u"ΣΟΦΙΑ"_s, u"σοφια"_s, true},
                    FoldCase{u"ABBA"_s, u"abbas"_s, false}, FoldCase{u""_s, u"a"_s, false},
                    FoldCase{u"x\U0001F3B5y"_s, u"\U0001F3B5Y"_s, true}, FoldCase{u"aab"_s, u"ab"_s, true}));
