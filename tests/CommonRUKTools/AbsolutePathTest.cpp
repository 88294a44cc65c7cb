#include "CommonRUKTools/AbsolutePath.h"

#include <gtest/gtest.h>

#include <QDir>
#include <QFileInfo>
#include <QTemporaryDir>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

TEST(AbsolutePathTest, EachSpellingOfAPathBecomesTheSame) {
    for (const QString& path :
         {u"/no/such/x.mp3"_s, u"/no//such/x.mp3"_s, u"/no/./such/x.mp3"_s, u"//no/such/x.mp3"_s,
          u"/no/such/x.mp3/"_s, u"/no/other/../such/x.mp3"_s, u"/../no/such/./././x.mp3"_s})
        EXPECT_EQ(AbsolutePath(path), u"/no/such/x.mp3"_s);
    EXPECT_EQ(AbsolutePath(u"x/./y.mp3"_s), QDir::currentPath() + u"/x/y.mp3"_s);
    EXPECT_EQ(AbsolutePath(u"."_s), QDir::currentPath());
    EXPECT_EQ(AbsolutePath(u"/"_s), u"/"_s);
    EXPECT_EQ(AbsolutePath(u""_s), u""_s);
}

TEST(AbsolutePathTest, NamesThatBeginWithDotsStay) {
    for (const QString& path : {u"/a/.hidden/...And Justice.mp3"_s, u"/a/..b/x"_s, u"/a/b../x"_s})
        EXPECT_EQ(AbsolutePath(path), path);
}

TEST(AbsolutePathTest, LinksStayExceptInFrontOfAStepUp) {
    QTemporaryDir temporary;
    const QString root = QFileInfo(temporary.path()).canonicalFilePath();
    QDir(root).mkpath(u"real/deep"_s);
    QFile::link(root + u"/real/deep"_s, root + u"/link"_s);
    EXPECT_EQ(AbsolutePath(root + u"/link//x.mp3"_s), root + u"/link/x.mp3"_s);
    EXPECT_EQ(AbsolutePath(root + u"/link/../x.mp3"_s), root + u"/real/x.mp3"_s);
    EXPECT_EQ(AbsolutePath(root + u"/link/.."_s), root + u"/real"_s);
}
