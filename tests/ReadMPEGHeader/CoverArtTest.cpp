#include "ReadMPEGHeader/id3v2/CoverArt.h"

#include <gtest/gtest.h>

#include <string>

#include "tests/ReadMPEGHeader/Builders.h"

namespace {

using std::string_literals::operator""s;

// Encoding 0, type, front cover, an empty description.
const std::string kHead = "\0image/jpeg\0\3\0"s;

std::optional<std::string> CoverOf(ByteSpan bytes) {
    MemorySource source(bytes);
    const auto cover = ReadCoverArt(source);
    return cover ? std::optional(cover->toStdString()) : std::nullopt;
}

TEST(CoverArt, IsFoundInEveryVersion) {
    const std::string picture = "\xFF\xD8picture\0\xFF"s;
    EXPECT_EQ(CoverOf(Id3v2Builder(3).Text("TIT2", "Lied").Frame("APIC", kHead + picture).Build()), picture);
    EXPECT_EQ(CoverOf(Id3v2Builder(4).Frame("APIC", kHead + picture).Build()), picture);
    EXPECT_EQ(CoverOf(Id3v2Builder(2).Frame("PIC", "\0JPG\3\0"s + picture).Build()), picture);
    const std::string wide =
        "\1image/png\0\3\xFF\xFE"
        "V\0\0\0"s;
    EXPECT_EQ(CoverOf(Id3v2Builder(3).Frame("APIC", wide + picture).Build()), picture);
    EXPECT_EQ(CoverOf(Id3v2Builder(3, 0x80).Frame("APIC", kHead + "\xFFx").Unsynchronise().Build()), "\xFFx");
}

TEST(CoverArt, TheFirstPictureCounts) {
    const auto tag = Id3v2Builder()
                         .Frame("APIC", "\0-->\0\3\0http://example.org/a.jpg"s)
                         .Frame("APIC", kHead)
                         .Frame("APIC", kHead + "one")
                         .Frame("APIC", kHead + "two")
                         .Build();
    EXPECT_EQ(CoverOf(tag), "one");
}

TEST(CoverArt, NothingComesOfDamage) {
    const auto whole = Id3v2Builder().Frame("APIC", kHead + "picture").Build();
    for (std::size_t size = 0; size < whole.size(); ++size)
        EXPECT_EQ(CoverOf(ByteSpan(whole).first(size)), std::nullopt) << size;
    EXPECT_EQ(CoverOf(Id3v2Builder().Frame("APIC", "\0image/jpeg\0\3without an end"s).Build()), std::nullopt);
    EXPECT_EQ(CoverOf(Id3v2Builder().SizedFrame("APIC", 0x7FFFFFFF, kHead + "x").Build()), std::nullopt);
    EXPECT_EQ(CoverOf(Id3v2Builder(5).Frame("APIC", kHead + "x").Build()), std::nullopt);
    EXPECT_EQ(CoverOf(Mp3Builder().Frames(3).Data()), std::nullopt);
}

TEST(CoverArt, OnlySoMuchOfATagIsRead) {
    const std::string body = kHead + std::string(17 * 1024 * 1024, 'x');
    EXPECT_EQ(CoverOf(Id3v2Builder().Frame("APIC", body).Build()), std::nullopt);
}

}  // namespace
