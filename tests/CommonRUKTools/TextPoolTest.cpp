#include "CommonRUKTools/TextPool.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

TEST(TextPool, EqualTextsShareTheirCharacters) {
    TextPool pool;
    const QString first = pool.Get(AsBytes("M\xC3\xB6tley"));
    const QString second = pool.Get(AsBytes("M\xC3\xB6tley"));
    EXPECT_EQ(first, u"Mötley"_s);
    EXPECT_EQ(first.constData(), second.constData());
    EXPECT_EQ(pool.Get(AsBytes("M\xF6tley")), u"Mötley"_s);
    EXPECT_EQ(pool.Get({}), QString());
}

TEST(TextPool, TextsStayRightWhenItForgets) {
    TextPool pool;
    const std::string large(1 << 20, 'x');
    const QString kept = pool.Get(AsBytes("kept"));
    for (char i = 0; i < 40; ++i)
        EXPECT_EQ(pool.Get(AsBytes(large + i)).back(), QChar(static_cast<char16_t>(i)));
    EXPECT_EQ(pool.Get(AsBytes("kept")), kept);
    EXPECT_NE(pool.Get(AsBytes("kept")).constData(), kept.constData());
}
