#include "CommonRUKTools/SafeFile.h"

#include <gtest/gtest.h>

#include <QDir>
#include <QFileInfo>
#include <QTemporaryDir>

#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/FileSource.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

class SafeFileTest : public testing::Test {
 protected:
    QString Path(const QString& name) const { return folder_.filePath(name); }
    static void Put(const QString& path, const QByteArray& bytes) {
        QFile file(path);
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(bytes);
    }
    static QByteArray Get(const QString& path) {
        QFile file(path);
        return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray("unreadable");
    }
    QTemporaryDir folder_;
};

}  // namespace

TEST_F(SafeFileTest, WithoutCommitTheOldFileStaysAndNoTemporaryIsLeft) {
    Put(Path(u"a"_s), "old");
    {
        SafeFile file(Path(u"a"_s));
        file.Write(AsBytes("new"));
    }
    EXPECT_EQ(Get(Path(u"a"_s)), "old");
    EXPECT_EQ(QDir(folder_.path()).entryList(QDir::Files), QStringList{u"a"_s});
}

TEST_F(SafeFileTest, AReadOnlyTargetAndALinkedOneAreReplaced) {
    Put(Path(u"a"_s), "old");
    QFile::setPermissions(Path(u"a"_s), QFile::ReadOwner | QFile::ReadGroup);
    ASSERT_TRUE(QFile::link(u"a"_s, Path(u"link"_s)));
    SafeFile file(Path(u"link"_s));
    file.Write(AsBytes("new"));
    file.Commit();
    EXPECT_EQ(Get(Path(u"a"_s)), "new");
    EXPECT_TRUE(QFileInfo(Path(u"link"_s)).isSymLink());
}

TEST_F(SafeFileTest, ATargetThatIsAFolderEndsInTheMessageAndLeavesNoTemporary) {
    ASSERT_TRUE(QDir(folder_.path()).mkdir(u"a"_s));
    const QString path = Path(u"a"_s);
    try {
        SafeFile file(path);
        file.Write(AsBytes("new"));
        file.Commit();
        FAIL() << "nothing was thrown";
    } catch (const EStreamError& error) {
        EXPECT_EQ(error.Message(),
                  u"Fehler beim Speichern: Kann "_s + path + u".tmp nicht in "_s + path + u" umbenennen"_s);
    }
    EXPECT_FALSE(QFile::exists(path + u".tmp"_s));
}

TEST_F(SafeFileTest, AFileSourceRefusesFoldersAndMissingFiles) {
    EXPECT_THROW(FileSource source(folder_.path()), EStreamError);
    EXPECT_THROW(FileSource source(Path(u"none"_s)), EStreamError);
    Put(Path(u"a"_s), "0123456789");
    FileSource source(Path(u"a"_s));
    EXPECT_EQ(source.Size(), 10);
    std::array<std::uint8_t, 8> buffer{};
    EXPECT_EQ(source.ReadAt(7, buffer), 3u);
    EXPECT_THROW(source.ReadExactly(8, 3), EStreamError);
    EXPECT_THROW(source.ReadExactly(0, std::size_t{1} << 60), EStreamError);
}
