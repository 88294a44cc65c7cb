#include "app/desktop/Arrangement.h"

#include <gtest/gtest.h>

#include "tests/ErrorOf.h"
#include "tests/PrintQt.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

const QString kName = u"fenster.df"_s;

class ArrangementTest : public testing::Test {
 protected:
    QString Path() const { return folder_.Path(kName); }
    bool IsRefused(const QByteArray& text) const {
        folder_.Put(kName, text);
        return !ErrorOf<EStreamError>([&] { ReadArrangement(Path()); }).isEmpty();
    }

    const Arrangement arrangement_{QByteArray("\0\n=a", 4), QByteArray("\xff\xfe"), "columns"};
    SongFolder folder_;
};

TEST_F(ArrangementTest, ComesBackAsItWasSavedAndDamagedIsRefused) {
    WriteArrangement(Path(), arrangement_);
    const Arrangement read = ReadArrangement(Path());
    EXPECT_EQ(read.Placement, arrangement_.Placement);
    EXPECT_EQ(read.Docks, arrangement_.Docks);
    EXPECT_EQ(read.Columns, arrangement_.Columns);
    const QByteArray sound = folder_.Get(kName);
    EXPECT_FALSE(IsRefused(QByteArray(sound).replace("\n", "\r\n")));
    EXPECT_TRUE(IsRefused("Filesystem 1K-blocks Used Available\n"));
    EXPECT_TRUE(IsRefused(QByteArray(sound).replace("Version=1", "Version=2")));
    EXPECT_TRUE(IsRefused(QByteArray(sound).replace("MainFormState=", "MainFormState=*")));
    EXPECT_TRUE(IsRefused(sound.first(sound.indexOf("SongList"))));
    EXPECT_TRUE(IsRefused(sound + QByteArray(2 << 20, 'x')));
}

}  // namespace
