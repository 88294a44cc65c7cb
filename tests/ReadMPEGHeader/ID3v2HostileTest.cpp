#include <gtest/gtest.h>

#include <QByteArray>
#include <QLoggingCategory>
#include <random>

#include "ReadMPEGHeader/id3v2/ID3v2Reader.h"
#include "tests/ReadMPEGHeader/Id3v2Builder.h"

using namespace Qt::StringLiterals;
using namespace std::string_literals;

// Tags of all versions with every kind of frame, damaged in all ways: nothing may crash (under the
// sanitizers), run away, or read back more text than the file can hold.
namespace {

std::vector<std::uint8_t> RichTag(std::uint8_t version, std::uint8_t flags) {
    Id3v2Builder builder(version, flags);
    if ((flags & 0x40) != 0) builder.Raw("\0\0\0\6\0\0\0\0\0\0"s.substr(0, version == 3 ? 10 : 6));
    if (version == 2) {
        builder.Text("TT2", "Titel").Text("TRK", "3/12").Frame("COM", "\0deu\0Gut"s);
        builder.Frame("PIC", "\0JPG\3Bild\0xx"s).Frame("ULT", "\1deu\xFF\xFE\0\0\xFF\xFEx\0"s);
        return builder.Padding(9).Build();
    }
    const std::uint8_t packing = version == 3 ? 0x80 : 0x09;
    builder.Text("TIT2", "Titel").Text("TPE1", "A\0B"s).Text("TRCK", "3/12").Text("TCON", "(17)Rock (RX)");
    builder.Frame("TALB", "\1\xFF\xFE\xF6\0"s).Frame("COMM", "\0deu\0Gut"s).Text("TMED", "(MC/4/II)");
    builder.Frame("TPE2", qCompress("\0Orchester", 10).toStdString(), packing);
    builder.Frame("SYLT", "\0deu\2\1x\0Das\0\0\0\0\1"s)
        .Frame("ETCO", "\2\1\0\0\0\1"s)
        .Frame("RVAD", "\1\x10\1\0\0\2"s);
    builder.Frame("EQUA", "\x10\x80\1\0\1"s)
        .Frame("APIC", "\0image/png\0\1Logo\0data"s)
        .Frame("GEOB", "\0a\0b\0c\0d"s);
    builder.Frame("POPM", "a\0\x80\0\0\0\7"s)
        .Frame("LINK", "TIT2http://a.de\0x"s)
        .Frame("POSS", "\2\0\0\1\0"s);
    builder.Frame("OWNE", "\0E9\00020020131L"s)
        .Frame("COMR", "\0E5\00020031224u\0\3L\0i\0"s)
        .Frame("PRIV", "abc");
    builder.Frame("WXXX", "\0d\0http://a.de"s).Frame("PCNT", "\0\0\0\5"s);
    builder.Frame("XRUK", XrukBody("Wave"));
    return builder.Padding(25).Build();
}

std::vector<std::vector<std::uint8_t>> RichTags() {
    return {RichTag(2, 0), RichTag(3, 0), RichTag(3, 0xC0), RichTag(4, 0), RichTag(4, 0xD0)};
}

void ReadBoth(const std::vector<std::uint8_t>& bytes) {
    for (Id3v2ReadFunction* read : {&ReadID3v2, &ReadID3v2Modern}) {
        const auto outcome = ReadWith(*read, bytes);
        EXPECT_LE(outcome.Reports.size(), bytes.size() / 6);
        EXPECT_LT(outcome.Tag.Comment.size(), static_cast<qsizetype>(2 * bytes.size() + 100));
    }
}

}  // namespace

TEST(ID3v2Hostile, EveryPrefixIsSurvived) {
    for (const auto& tag : RichTags())
        for (std::size_t size = 0; size <= tag.size(); ++size)
            ReadBoth({tag.begin(), tag.begin() + static_cast<std::ptrdiff_t>(size)});
}

TEST(ID3v2Hostile, RandomDamageIsSurvived) {
    QLoggingCategory::setFilterRules(u"default.warning=false"_s);  // the decompressor's complaints
    std::mt19937 random(20040501);                                 // fixed, so that a failure comes again
    const auto below = [&](std::size_t bound) { return static_cast<std::size_t>(random()) % bound; };
    for (const auto& tag : RichTags()) {
        for (int round = 0; round < 1000; ++round) {
            auto damaged = tag;
            for (std::size_t changes = 1 + below(6); changes > 0; --changes) {
                constexpr std::uint8_t kEvil[] = {0x00, 0xFF, 0x7F, 0x80, 0x01, 0xFE};
                damaged[below(damaged.size())] =
                    below(2) == 0 ? kEvil[below(6)] : static_cast<std::uint8_t>(below(256));
            }
            ReadBoth(damaged);
        }
    }
    QLoggingCategory::setFilterRules(QString());
}
