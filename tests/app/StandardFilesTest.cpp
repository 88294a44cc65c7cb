#include "app/desktop/StandardFiles.h"

#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

class StandardFilesTest : public testing::Test {
 protected:
    QString Located() const { return LocateStandardFiles(program_.path(), data_.path()).Folder; }
    void PutBesideProgram(const QString& name) const {
        QFile file(program_.filePath(name));
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    }

    QTemporaryDir program_;
    QTemporaryDir data_;
};

TEST_F(StandardFilesTest, LieInTheDataFolderUnlessOneIsBesideTheProgram) {
    EXPECT_EQ(Located(), data_.path());
    PutBesideProgram(u"other.txt"_s);
    EXPECT_EQ(Located(), data_.path());
    PutBesideProgram(u"Tunestead3_BannList.str"_s);
    EXPECT_EQ(Located(), program_.path());
}

TEST_F(StandardFilesTest, AProgramFolderThatCannotBeWrittenIsPassedOver) {
    PutBesideProgram(u"Tunestead3_Database.tsdb"_s);
    ASSERT_EQ(Located(), program_.path());
    QFile::setPermissions(program_.path(), QFile::ReadOwner | QFile::ExeOwner);
    if (QFileInfo(program_.path()).isWritable())
        GTEST_SKIP() << "the system's administrator may write anywhere";
    EXPECT_EQ(Located(), data_.path());
}

}  // namespace
