#include "CommonRUKTools/StandardFiles.h"

#include <gtest/gtest.h>

#include <QCoreApplication>

#include "CommonRUKTools/FileLock.h"
#include "CommonRUKTools/MusicFolder.h"
#include "tests/PrintQt.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

// Where the program finds its own files and the user's, and who may write them.

TEST(StandardFilesTest, LieInTheDataFolderUnlessOneIsBesideAProgramWhoseFolderCanBeWritten) {
    const SongFolder folder;
    const QString program = folder.Path(u"program"_s);
    const auto located = [&] { return LocateStandardFiles(program, folder.Path(u"data"_s)).Folder; };
    folder.Put(u"program/other.txt"_s, "");
    EXPECT_EQ(located(), folder.Path(u"data"_s));
    folder.Put(u"program/Tunestead3_BannList.str"_s, "");
    EXPECT_EQ(located(), program);
    QFile::setPermissions(program, QFile::ReadOwner | QFile::ExeOwner);
    const bool mayWriteAnywhere = QFileInfo(program).isWritable();
    EXPECT_EQ(located(), mayWriteAnywhere ? program : folder.Path(u"data"_s));
    QFile::setPermissions(program, QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
}

TEST(MusicFolderTest, IsFoundWhateverItsName) {
    const SongFolder home;
    const auto found = [&](const QString& named) { return MusicFolder(named, home.Path()); };
    EXPECT_EQ(found(home.Path(u"Klänge"_s)), home.Path(u"Klänge"_s)) << "nothing is there yet";
    EXPECT_EQ(found(home.Path() + u'/'), home.Path(u"Musik"_s)) << "the system names none";
    home.Put(u"music/a.mp3"_s, "");
    EXPECT_EQ(found(home.Path(u"Klänge"_s)), home.Path(u"music"_s));
    QDir(home.Path()).mkdir(u"Klänge"_s);
    EXPECT_EQ(found(home.Path(u"Klänge"_s)), home.Path(u"music"_s)) << "an empty one comes last";
    home.Put(u"Klänge/b.mp3"_s, "");
    EXPECT_EQ(found(home.Path(u"Klänge"_s)), home.Path(u"Klänge"_s));
}

TEST(FileLockTest, AFileHasOneWriterByWhateverPath) {
    const SongFolder folder;
    const QString path = folder.Put(u"real/a.tsdb"_s, "x");
    QFile::link(folder.Path(u"real"_s), folder.Path(u"link"_s));
    {
        const FileLock first(path);
        EXPECT_TRUE(first.IsTaken());
        EXPECT_TRUE(first.IsOf(folder.Path(u"link/a.tsdb"_s)));
        const FileLock second(folder.Path(u"link/a.tsdb"_s));
        EXPECT_FALSE(second.IsTaken());
        EXPECT_TRUE(second.Holder().contains(QString::number(QCoreApplication::applicationPid())))
            << second.Holder().toStdString();
        EXPECT_TRUE(FileLock(folder.Path(u"real/b.tsdb"_s)).IsTaken());
    }
    EXPECT_TRUE(FileLock(path).IsTaken());
    // What a killed program leaves behind is no lock.
    folder.Put(u"real/.a.tsdb.lock"_s, "tunestead\n1\nhere\n");
    EXPECT_TRUE(FileLock(path).IsTaken());
    EXPECT_EQ(QDir(folder.Path(u"real"_s)).entryList(QDir::Files | QDir::Hidden), QStringList{u"a.tsdb"_s});
}
