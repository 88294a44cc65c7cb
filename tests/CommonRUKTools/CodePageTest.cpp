#include "CommonRUKTools/CodePage.h"

#include <gtest/gtest.h>

#include "CommonRUKTools/Errors.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

TEST(CodePage, ValidUtf8IsUtf8AndAnythingElseIsLegacy) {
    EXPECT_EQ(CodePage::FromLegacy(AsBytes("M\xC3\xB6tley")), u"Mötley"_s);
    EXPECT_EQ(CodePage::FromLegacy(AsBytes("M\xF6tley")), u"Mötley"_s);
    EXPECT_EQ(CodePage::FromLegacy(AsBytes("\x80 5")), u"€ 5"_s);
    // Overlong, surrogate, cut and too large sequences are no UTF-8.
    for (const char* bad :
         {"\xC0\xAF", "\xED\xA0\x80", "\xE2\x82", "\xF5\x80\x80\x80", "\xF4\x90\x80\x80", "\xE0\x80\xAF"})
        EXPECT_FALSE(CodePage::IsValidUtf8(AsBytes(bad)));
    EXPECT_TRUE(CodePage::IsValidUtf8(AsBytes("\xF0\x9F\x8E\xB5 \xE2\x82\xAC")));
}

TEST(CodePage, WritingKeepsWhatFitsAndTransliteratesTheRest) {
    EXPECT_TRUE(CodePage::FitsLegacy(u"Für Elise – 5 €"));
    EXPECT_FALSE(CodePage::FitsLegacy(u"Dvořák"));
    EXPECT_EQ(CodePage::ToLegacy(u"Dvořák €"), QByteArray("Dvor\xE1k \x80"));
    EXPECT_EQ(CodePage::ToLegacy(u"日本"), QByteArray("??"));
    EXPECT_EQ(CodePage::ToLegacy(u"\U0001F3B5!"), QByteArray("?!"));
}

TEST(CodePage, AnotherLegacyPageCanBeSet) {
    CodePage::SetLegacyName(u"windows-1250"_s);
    EXPECT_EQ(CodePage::FromLegacy(AsBytes("Dvo\xF8\xE1k")), u"Dvořák"_s);
    EXPECT_EQ(CodePage::ToLegacy(u"Dvořák"), QByteArray("Dvo\xF8\xE1k"));
    EXPECT_THROW(CodePage::SetLegacyName(u"keine-solche"_s), ERukException);
    CodePage::SetLegacyName(u"windows-1252"_s);
}

TEST(CodePage, ACutNeverSplitsACharacter) {
    EXPECT_EQ(CodePage::CutSystem("a\xC3\xB6", 2), QByteArray("a"));
    EXPECT_EQ(CodePage::CutSystem("a\xC3\xB6", 3), QByteArray("a\xC3\xB6"));
    EXPECT_EQ(CodePage::CutSystem("\xF0\x9F\x8E\xB5", 3), QByteArray(""));
}

TEST(CodePage, ManyTextsAreEncodedLikeOne) {
    CodePage::SystemEncoder encoder;
    // The second ends in half a surrogate pair, which must not wait for the next text.
    for (const QString& text : {u"Für Elise 🎵"_s, QString(QChar(0xD83C)), u"abc"_s, QString()}) {
        std::vector<std::uint8_t> bytes(encoder.Space(text.size()));
        const std::size_t size = encoder.Write(text, bytes);
        EXPECT_EQ(QByteArrayView(bytes.data(), static_cast<qsizetype>(size)), CodePage::ToSystem(text));
    }
}
