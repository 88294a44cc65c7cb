#include "MusicManagment/playlist/LinkFolder.h"

#include <gtest/gtest.h>

#include "tests/playlist/Playing.h"

using namespace Qt::StringLiterals;

class LinkFolderTest : public PlayingTest {
 protected:
    QString Target(const QString& link) const { return QFile::symLinkTarget(links_ + u'/' + link); }
    QStringList Links() const { return QDir(links_).entryList(QDir::Files | QDir::System); }

    QString links_ = folder_.Path(u"neu/links"_s);
};

TEST_F(LinkFolderTest, EachSongGetsALinkThatOpensIt) {
    Add(u"ab"_s);
    list_.Insert(0, {.Name = folder_.Add(u"sub/a.wav"_s)});
    list_.Insert(0, {.Name = u"http://radio.example/live.mp3"_s});
    list_.Insert(0, {.Name = u":00000001:\\c.mp3"_s});
    list_.ExportAsLinks(links_);
    EXPECT_EQ(Links(), (QStringList{u"a (2).wav"_s, u"a.wav"_s, u"b.wav"_s}));
    EXPECT_EQ(Target(u"a.wav"_s), folder_.Path(u"sub/a.wav"_s));
    EXPECT_EQ(Target(u"a (2).wav"_s), Path(u"a"_s));

    list_.Move({3}, 0);
    list_.ExportAsLinks(links_);  // once more changes nothing, in another order neither
    EXPECT_EQ(Links().size(), 3);
}

TEST_F(LinkFolderTest, NoFileIsReplacedByALink) {
    Add(u"ab"_s);
    folder_.Add(u"neu/links/a.wav"_s, 1);
    QFile::link(u"/nowhere"_s, links_ + u"/b.wav"_s);
    list_.ExportAsLinks(links_);
    EXPECT_TRUE(Target(u"a.wav"_s).isEmpty());
    EXPECT_EQ(Target(u"a (2).wav"_s), Path(u"a"_s));
    EXPECT_EQ(Target(u"b (2).wav"_s), Path(u"b"_s));
}

TEST_F(LinkFolderTest, AFolderThatCannotBeMadeIsSaid) {
    Add(u"a"_s);
    EXPECT_THROW(list_.ExportAsLinks(Path(u"a"_s) + u"/links"_s), EStreamError);
}
