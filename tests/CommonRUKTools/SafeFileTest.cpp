#include "CommonRUKTools/SafeFile.h"

#include <gtest/gtest.h>

#include "CommonRUKTools/FileSource.h"
#include "tests/ErrorOf.h"
#include "tests/PrintQt.h"
#include "tests/database/SongFolder.h"

#ifndef Q_OS_WIN
#include <signal.h>
#include <sys/resource.h>
#include <sys/stat.h>
#endif

using namespace Qt::StringLiterals;

namespace {

class SafeFileTest : public testing::Test {
 protected:
    // The message that writing "new" ends with; empty when it succeeds.
    static QString ErrorOfWriting(const QString& target) {
        return ErrorOf<EStreamError>([&] {
            SafeFile file(target);
            file.Write(AsBytes("new"));
            file.Commit();
        });
    }
    QStringList Names() const {
        return QDir(folder_.Path()).entryList(QDir::Files | QDir::System | QDir::Hidden);
    }

    SongFolder folder_;
    QString target_ = folder_.Path(u"a"_s);
};

}  // namespace

TEST_F(SafeFileTest, TheOldFileStaysUntilTheCommitAndNobodyElsesIsTouched) {
    folder_.Put(u"a"_s, "old");
    folder_.Put(u"a.tmp"_s, "of the user");
    {
        SafeFile file(target_);
        file.Write(AsBytes("new"));
    }
    EXPECT_EQ(folder_.Get(u"a"_s), "old");
    EXPECT_EQ(ErrorOfWriting(target_), QString());
    EXPECT_EQ(folder_.Get(u"a"_s), "new");
    EXPECT_EQ(folder_.Get(u"a.tmp"_s), "of the user");
    EXPECT_EQ(Names(), (QStringList{u"a"_s, u"a.tmp"_s}));
}

TEST_F(SafeFileTest, AReadOnlyTargetAndALinkedOneAreReplaced) {
    folder_.Put(u"a"_s, "old");
    QFile::setPermissions(target_, QFile::ReadOwner | QFile::ReadGroup);
    ASSERT_TRUE(QFile::link(u"a"_s, folder_.Path(u"link"_s)));
    EXPECT_EQ(ErrorOfWriting(folder_.Path(u"link"_s)), QString());
    EXPECT_EQ(folder_.Get(u"a"_s), "new");
    EXPECT_FALSE(QFile::permissions(target_) & QFile::ReadOther) << "who may read it stays";
    EXPECT_TRUE(QFileInfo(folder_.Path(u"link"_s)).isSymLink());
}

TEST_F(SafeFileTest, AFolderEndsInTheMessageOfTheRenaming) {
    ASSERT_TRUE(QDir().mkdir(target_));
    EXPECT_EQ(ErrorOfWriting(target_),
              u"Fehler beim Speichern: Kann "_s + target_ + u".tmp nicht in "_s + target_ + u" umbenennen"_s);
    EXPECT_TRUE(Names().isEmpty());
}

#ifndef Q_OS_WIN

TEST_F(SafeFileTest, WhatIsNoFileIsNeverReplaced) {
    ASSERT_EQ(::mkfifo(QFile::encodeName(target_).constData(), 0600), 0);
    ASSERT_TRUE(QFile::link(u"a"_s, folder_.Path(u"link"_s)));
    for (const QString& path : {target_, folder_.Path(u"link"_s)})
        EXPECT_EQ(ErrorOfWriting(path),
                  u"Das ist keine gewöhnliche Datei und wird deshalb nicht ersetzt: "_s + path);
    struct stat status {};
    EXPECT_TRUE(::stat(QFile::encodeName(target_).constData(), &status) == 0 && S_ISFIFO(status.st_mode));
}

TEST_F(SafeFileTest, ADiskThatTakesNoMoreIsToldInGerman) {
    struct rlimit former {};
    ASSERT_EQ(::getrlimit(RLIMIT_FSIZE, &former), 0);
    const auto formerHandler = ::signal(SIGXFSZ, SIG_IGN);
    const struct rlimit two { 2, former.rlim_max };
    ASSERT_EQ(::setrlimit(RLIMIT_FSIZE, &two), 0);
    const QString message = ErrorOfWriting(target_);
    ::setrlimit(RLIMIT_FSIZE, &former);
    ::signal(SIGXFSZ, formerHandler);
    EXPECT_EQ(message, u"Kann die Datei nicht schreiben: "_s + target_ +
                           u": Die Datei ist zu groß für diesen Datenträger"_s);
    EXPECT_TRUE(Names().isEmpty());
}

#endif

TEST_F(SafeFileTest, AFileSourceRefusesFoldersAndMissingFiles) {
    EXPECT_THROW(FileSource source(folder_.Path()), EStreamError);
    EXPECT_THROW(FileSource source(folder_.Path(u"none"_s)), EStreamError);
    folder_.Put(u"a"_s, "0123456789");
    FileSource source(target_);
    EXPECT_EQ(source.Size(), 10);
    std::array<std::uint8_t, 8> buffer{};
    EXPECT_EQ(source.ReadAt(7, buffer), 3u);
    EXPECT_THROW(source.ReadExactly(8, 3), EStreamError);
    EXPECT_THROW(source.ReadExactly(0, std::size_t{1} << 60), EStreamError);
}
