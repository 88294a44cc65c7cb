#include "CommonRUKTools/RWReg.h"

#include <gtest/gtest.h>

#include <QTemporaryDir>

#include "CommonRUKTools/Errors.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

const QString kKey = u"\\Software\\RUK\\Tunestead3"_s;

class RWRegTest : public testing::Test {
 protected:
    QString File() const { return folder_.filePath(u"sub/settings.conf"_s); }
    QTemporaryDir folder_;
};

}  // namespace

TEST_F(RWRegTest, ValuesComeBackWithTheirTypeAfterReopening) {
    const QByteArray bytes("\0\x01\xFF,;\"\\", 7);
    const QString text = u"Zeile 1\nZeile 2; \"x\", %TITLE% = ä\\€ 日本"_s;
    {
        TRWReg settings(kKey, File());
        settings.WriteInteger(u"Number"_s, -2147483647 - 1);
        settings.WriteBool(u"Yes"_s, true);
        settings.WriteString(u"Text"_s, text);
        settings.WriteString(u"Empty"_s, QString());
        settings.WriteString(u"LooksLikeANumber"_s, u"7"_s);
        settings.WriteBinary(u"Bytes"_s, bytes);
        settings.Flush();
    }
    const TRWReg settings(kKey, File());
    EXPECT_EQ(settings.ReadInteger(u"Number"_s), -2147483647 - 1);
    EXPECT_EQ(settings.ReadBool(u"Yes"_s), true);
    EXPECT_EQ(settings.ReadString(u"Text"_s), text);
    EXPECT_EQ(settings.ReadString(u"Empty"_s), QString());
    EXPECT_EQ(settings.ReadBinary(u"Bytes"_s), bytes);
    EXPECT_EQ(settings.ReadInteger(u"LooksLikeANumber"_s), std::nullopt);
    EXPECT_EQ(settings.ReadString(u"Yes"_s), std::nullopt);
    EXPECT_EQ(settings.ReadBool(u"Missing"_s), std::nullopt);
}

TEST_F(RWRegTest, KeysDoNotMix) {
    TRWReg settings(kKey, File());
    EXPECT_TRUE(settings.IsEmpty());
    settings.WriteBool(u"Yes"_s, true);
    EXPECT_FALSE(settings.IsEmpty());
    EXPECT_TRUE(TRWReg(u"\\Software\\RUK\\Other"_s, File()).IsEmpty());
}

TEST_F(RWRegTest, AFileThatCannotBeWrittenIsAnError) {
    TRWReg settings(kKey, u"/proc/settings.conf"_s);
    settings.WriteInteger(u"Number"_s, 1);
    EXPECT_THROW(settings.Flush(), EStreamError);
}
