#include "MusicManagment/playlist/SongCopies.h"

#include <gtest/gtest.h>

#include "tests/playlist/Playing.h"

using namespace Qt::StringLiterals;

namespace {

// A test whose temporary folder is its own.
class SongCopiesTest : public PlayingTest {
 protected:
    SongCopiesTest() : former_(qgetenv("TMPDIR")) {
        QDir().mkpath(temp_);
        qputenv("TMPDIR", QFile::encodeName(temp_));
    }
    ~SongCopiesTest() override { former_.isNull() ? qunsetenv("TMPDIR") : qputenv("TMPDIR", former_); }

    QString Copies() const { return temp_ + u"/Tunestead Song-Copies"_s; }
    static QStringList FilesIn(const QString& folder) {
        return QDir(folder).entryList(QDir::AllEntries | QDir::System | QDir::NoDotAndDotDot);
    }

    QByteArray former_;
    QString temp_ = folder_.Path(u"temp"_s);
};

}  // namespace

TEST_F(SongCopiesTest, EachSongIsPlayedFromACopyThatReplacesTheLast) {
    Add(u"ab"_s);
    list_.SetCopyMp3sBeforePlay(true);
    EXPECT_EQ(PlayOn(), u"ab"_s);
    EXPECT_EQ(list_.CurrentSong(), Path(u"b"_s));
    EXPECT_EQ(list_.CurrentFile(), Copies() + u"/b.wav"_s);
    EXPECT_EQ(player_.Files, (QStringList{Copies() + u"/a.wav"_s, Copies() + u"/b.wav"_s}));
    EXPECT_EQ(FilesIn(Copies()), QStringList{u"b.wav"_s});
    EXPECT_TRUE(QFile::exists(Path(u"a"_s)));
    EXPECT_EQ(QFile::permissions(Copies()) & ~(QFile::ReadUser | QFile::WriteUser | QFile::ExeUser),
              QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
}

TEST_F(SongCopiesTest, TheCopyThatPlaysStaysWhileAnotherIsFadedInOrCannotBe) {
    Add(u"a"_s);
    list_.Insert(1, {.Name = folder_.Add(u"sub/a.wav"_s)});
    list_.SetCopyMp3sBeforePlay(true);
    list_.PlayEntry(0);
    const QString playing = list_.CurrentFile();
    for (const bool canFade : {false, true}) {
        player_.CanFade = canFade;
        list_.StartNewRound();
        list_.PlayNext(SongChange::CrossFadeOnly);
        EXPECT_TRUE(QFile::exists(playing));
        EXPECT_EQ(list_.CurrentFile() != playing, canFade);
    }
    EXPECT_TRUE(QFile::exists(list_.CurrentFile()));
}

TEST_F(SongCopiesTest, EmptyingTouchesOnlyWhatLiesInTheFolder) {
    Add(u"abc"_s);
    QDir().mkpath(Copies() + u"/sub"_s);
    QFile::setPermissions(Copies(), QFile::Permissions(0x7777));
    QFile readOnly(Copies() + u"/old.mp3"_s);
    ASSERT_TRUE(readOnly.open(QIODevice::WriteOnly));
    readOnly.setPermissions(QFile::ReadOwner);
    QFile::setPermissions(Path(u"c"_s), QFile::ReadOwner);
    QFile::link(Path(u"c"_s), Copies() + u"/link.mp3"_s);
    QFile::link(u"/nowhere"_s, Copies() + u"/broken.mp3"_s);
    EXPECT_EQ(CopyForPlaying(Path(u"a"_s)), Copies() + u"/a.wav"_s);
    EXPECT_EQ(FilesIn(Copies()), (QStringList{u"a.wav"_s, u"sub"_s}));
    EXPECT_FALSE(QFile::permissions(Copies()) & (QFile::WriteOther | QFile::ReadOther));
    EXPECT_FALSE(QFile::permissions(Path(u"c"_s)) & QFile::WriteOwner);  // the link's target
}

TEST_F(SongCopiesTest, AFolderThatSomeonePlantedIsNotUsed) {
    Add(u"a"_s);
    const QString target = folder_.Path(u"target"_s);
    QDir().mkpath(target);
    folder_.Add(u"target/keep.wav"_s);
    ASSERT_TRUE(QFile::link(target, Copies()));
    EXPECT_EQ(CopyForPlaying(Path(u"a"_s)), Path(u"a"_s));
    EXPECT_EQ(FilesIn(target), QStringList{u"keep.wav"_s});

    QFile::remove(Copies());
    folder_.Add(u"temp/Tunestead Song-Copies"_s);  // a file
    EXPECT_EQ(CopyForPlaying(Path(u"a"_s)), Path(u"a"_s));
}

TEST_F(SongCopiesTest, ACopyThatIsListedItselfSurvives) {
    Add(u"a"_s);
    const QString copy = CopyForPlaying(Path(u"a"_s));
    EXPECT_EQ(CopyForPlaying(copy), copy);
    EXPECT_TRUE(QFile::exists(copy));
}
