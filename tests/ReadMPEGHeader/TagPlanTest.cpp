#include <gtest/gtest.h>

#include "ReadMPEGHeader/id3v1/ID3v1.h"
#include "ReadMPEGHeader/id3v2/CoverArt.h"
#include "ReadMPEGHeader/writing/TagBytes.h"
#include "tests/ErrorOf.h"
#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/AsfBuilder.h"
#include "tests/ReadMPEGHeader/TagFiles.h"

using namespace Qt::StringLiterals;
using namespace std::string_literals;

namespace {

const Bytes kSound = Mp3Builder().Frames(20).Data();
constexpr std::size_t kOld = 128;  // bytes of an ID3v1 tag

Bytes Joined(std::initializer_list<ByteSpan> parts) {
    ByteWriter all;
    for (const ByteSpan part : parts)
        all.Raw(part);
    return all.Bytes();
}

// An MPEG file with this tag, every text of which is as the record has it.
Bytes WithTag(const Id3v2Builder& tag) {
    return Joined({tag.Build(), kSound});
}

const auto kNewAlbum = [](TagEdit& edit) { edit.Record.Album = u"Neu"_s; };

// The frames that become of a tag when the album changes, without those that are new in it.
FrameList FramesAfter(const Id3v2Builder& tag, ReadProfile profile = ReadProfile::Modern) {
    const Bytes file = WithTag(tag);
    auto frames = WithoutTechnical(FramesOfTag(Tagged(file, EditOf(file, kNewAlbum, profile), profile)));
    std::erase_if(frames, [](const auto& frame) { return frame.first == "TALB"; });
    return frames;
}

bool EndsWith(ByteSpan bytes, ByteSpan end) {
    return bytes.size() >= end.size() && std::ranges::equal(bytes.last(end.size()), end);
}

Bytes ApeTag() {
    ByteWriter tag;
    for (const std::uint32_t flags : {0xA0000000u, 0x80000000u}) {
        if (tag.Size() > 0) tag.Raw("items...");
        tag.Raw("APETAGEX");
        for (const std::uint32_t number : {2000u, 40u, 1u, flags, 0u, 0u})
            tag.U32Le(number);
    }
    return tag.Bytes();
}

Bytes WaveFile() {
    auto file = WaveBuilder().Format().Chunk("data", 400).Zeros(400).Data();
    file[4] = static_cast<std::uint8_t>((file.size() - 8) & 0xFF);
    file[5] = static_cast<std::uint8_t>((file.size() - 8) >> 8);
    return file;
}

Bytes WmaFile() {
    return AsfBuilder().Content(u"Lied"_s, u"Band"_s, {}).Build();
}

}  // namespace

// What a person did not change, and what this program knows nothing of, stays byte for byte.
TEST(TagPlan, WhatDoesNotChangeKeepsItsBytesAndItsPlace) {
    const FrameList frames = {
        {"APIC", "\0image/png\0\3\0picture"s},
        {"TIT2", "\1\xFE\xFF\0T"s},
        {"TPE1", "\0B\xC3\xA4nd\0"s},
        {"XYZW", "nobody knows"},
        {"TYER", '\0' + "2004-05-01"s},
        {"TCON", "\0Viking Metal"s},
        {"TRCK", '\0' + "03/12"s},
        {"COMM", "\0engiTunNORM\0 0001"s},
        {"COMM", "\0deu\0Gut"s},
        {"PRIV", "owner\0data"s},
        {"PRIV", "just words"},
        {"WXXX", "\0a[b]\0http://a.example"s},
        {"POPM", "me\0\xFF\0\0\0\7"s},
        {"PCNT", "\0\0\0\0\7"s},
        {"USLT", "\3deu\0lyrics"s},
    };
    Id3v2Builder tag;
    for (const auto& [id, body] : frames)
        tag.Frame(id, body);
    EXPECT_EQ(FramesAfter(tag), frames);

    // The length is as exact as it was.
    const auto withLength = Id3v2Builder().Text("TIT2", "T").Text("TPE1", "B").Text("TLEN", "00123");
    const Bytes file = WithTag(withLength);
    const auto after = FramesOfTag(Tagged(file, EditOf(file, kNewAlbum)));
    EXPECT_EQ(after[2], (std::pair{"TLEN"s, '\0' + "00123"s}));
    // Nothing changes, nothing is written; a tag of another version is no reason either.
    const Bytes known = Tagged(file, EditOf(file, kNewAlbum));
    for (const std::uint8_t version : {std::uint8_t{3}, std::uint8_t{4}}) {
        Id3v2Builder same(version);
        for (const auto& [id, body] : FramesOfTag(known))
            same.Frame(id, body);
        const Bytes again = WithTag(same);
        EXPECT_TRUE(PlanOf(again, EditOf(again, [](TagEdit&) {})).ChangesNothing(std::ssize(again)));
    }
}

TEST(TagPlan, TheCommentIsReplacedWhereItStands) {
    const auto base = Id3v2Builder()
                          .Text("TIT2", "T")
                          .Text("TPE1", "B")
                          .Frame("COMM", "\0engX\0foreign"s)
                          .Frame("COMM", "\0deu\0Gut"s)
                          .Frame("PRIV", "abc")
                          .Frame("PRIV", "owner\0\1"s)
                          .Frame("WXXX", "\0d\0http://a.example"s);
    const Bytes file = WithTag(base);
    const auto after = [&file](const QString& comment) {
        const auto edit = EditOf(file, [&](TagEdit& e) { e.Record.Comment = comment; });
        auto frames = WithoutTechnical(FramesOfTag(Tagged(file, edit)));
        frames.erase(frames.begin(), frames.begin() + 2);
        return frames;
    };
    const std::pair foreign{"COMM"s, "\0engX\0foreign"s};
    const std::pair data{"PRIV"s, "owner\0\1"s};
    const std::pair priv{"PRIV"s, "abc"s};
    const std::pair url{"WXXX"s, "\0d\0http://a.example"s};
    ASSERT_EQ(ReadModern(file).Comment, u"Gut\nPrivate Angaben:\nabc\nURL:(d) http://a.example"_s);
    EXPECT_EQ(
        after(u"Ω URL:\nPrivate Angaben:\nabc\nURL:(d) http://a.example"_s),
        (FrameList{foreign, {"COMM", "\1deu\xFF\xFE\0\0\xFF\xFE\xA9\3 \0U\0R\0L\0:\0"s}, priv, data, url}));
    EXPECT_EQ(after(u"Gut\nPrivate Angaben:\nneu\nURL:(d) http://a.example"_s),
              (FrameList{foreign, {"COMM", "\0deu\0Gut"s}, {"PRIV", "neu"}, data, url}));
    EXPECT_EQ(after(u"Gut"_s), (FrameList{foreign, {"COMM", "\0deu\0Gut"s}, data}));
}

TEST(TagPlan, TagsOfOtherVersionsAreConverted) {
    const auto two = Id3v2Builder(2)
                         .Text("TT2", "T")
                         .Text("TP1", "B")
                         .Frame("PIC", "\0JPG\3\0xx"s)
                         .Frame("XYZ", "odd")
                         .Frame("TCP", '\0' + "1"s);
    EXPECT_EQ(FramesAfter(two), (FrameList{{"TIT2", "\0T"s},
                                           {"TPE1", "\0B"s},
                                           {"APIC", "\0image/jpeg\0\3\0xx"s},
                                           {"TCMP", '\0' + "1"s},
                                           {"XYZ\0"s, "odd"}}));

    const auto four = Id3v2Builder(4)
                          .Frame("TIT2", "\3\xC3\xA4"s)
                          .Frame("TPE1", "\3A\0\xCE\xA9"s)
                          .Frame("TPE2", "\3A\0B\0"s)
                          .Frame("TDRC", '\3' + "2004-05-01T12:30:10"s)
                          .Text("TDAT", "3112")
                          .Frame("TDOR", '\3' + "1999-01"s)
                          .Frame("TIPL", "\3mix\0Ann"s)
                          .Frame("TMCL", "\3drum\0\xCE\xA9\0"s)
                          .Frame("TCON", "\3Rock\0Metal"s)
                          .Frame("TXXX", "\3d\0\xCE\xA9"s)
                          .Frame("TSOP", "\0sort"s)
                          .Frame("RVA2", "\3\0\2"s)
                          .Frame("APIC", "\3image/png\0\3\xC3\xA4\0\xFF\xE0"s)
                          .Frame("UFID", "g\1u\xFF\0\xE0"s, 0x42)
                          .Frame("GEOB", "g\x80\0\0\0\2secret"s, 0x45);
    const auto wide = [](const std::string& text) { return "\xFF\xFE"s + text; };
    EXPECT_EQ(FramesAfter(four), (FrameList{{"TIT2", "\0\xE4"s},
                                            {"TPE1", "\1"s + wide("A\0,\0 \0\xA9\3"s)},
                                            {"TPE2", "\0A/B"s},
                                            {"TYER", '\0' + "2004"s},
                                            {"TDAT", '\0' + "0105"s},
                                            {"TIME", '\0' + "1230"s},
                                            {"TORY", '\0' + "1999"s},
                                            {"TCON", "\0(17)Rock/Metal"s},
                                            {"TXXX", "\1"s + wide("d\0\0\0"s) + wide("\xA9\3"s)},
                                            {"TSOP", "\0sort"s},
                                            {"RVA2", "\3\0\2"s},
                                            {"APIC", "\0image/png\0\3\xE4\0\xFF\xE0"s},
                                            {"UFID", "\1u\xFF\xE0"s},
                                            {"GEOB", "\x80gsecret"s},
                                            {"IPLS", "\1"s + wide("m\0i\0x\0\0\0"s) + wide("A\0n\0n\0\0\0"s) +
                                                         wide("d\0r\0u\0m\0\0\0"s) + wide("\xA9\3"s)}}));

    const auto unsynchronised =
        Id3v2Builder(3, 0x80).Text("TIT2", "T").Text("TPE1", "B").Frame("UFID", "\xFF\xE0"s).Unsynchronise();
    EXPECT_EQ(FramesAfter(unsynchronised).back(), (std::pair{"UFID"s, "\xFF\xE0"s}));
    // Coded frames of 2.3 stay as they are.
    const auto coded = Id3v2Builder().Text("TIT2", "T").Text("TPE1", "B").Frame("UFID", "\x80secret", 0x40);
    EXPECT_EQ(FramesAfter(coded).back().second, "\x80secret");
}

TEST(TagPlan, SeveralTagsBecomeOne) {
    const auto first = TitledTag("T", "B").Frame("APIC", "\0image/png\0\3\0one"s).Padding(9).Build();
    const auto second = TitledTag("other", "x", 4)
                            .Text("TCOM", "C")
                            .Frame("APIC", "\0image/png\0\3\0one"s)
                            .Frame("APIC", "\0image/png\0\4\0two"s)
                            .Build();
    const FrameList expected = {{"TIT2", "\0T"s},
                                {"TPE1", "\0B"s},
                                {"APIC", "\0image/png\0\3\0one"s},
                                {"TCOM", "\0C"s},
                                {"APIC", "\0image/png\0\4\0two"s},
                                {"TALB", "\0Neu"s}};
    const Bytes stacked = Joined({first, second, kSound});
    Mp3Builder trailing;
    trailing.Raw(second).Raw(kSound).TrailingTag(first);
    for (const Bytes& file : {stacked, trailing.Data()}) {
        const auto edit = EditOf(file, kNewAlbum);
        const Bytes after = Tagged(file, edit);
        EXPECT_EQ(WithoutTechnical(FramesOfTag(after)), expected);
        EXPECT_TRUE(EndsWith(ByteSpan(after).first(after.size() - kOld), kSound));
        EXPECT_TRUE(PlanOf(after, edit).ChangesNothing(std::ssize(after)));
        EXPECT_EQ(ReadModern(after).Title, u"T"_s);
    }
}

TEST(TagPlan, AnMpegFileIsWrittenOverWhereTheTagFits) {
    const Bytes ape = ApeTag();
    const auto old = Id3v1Bytes("T", "B", "", "", "", 255);
    const Bytes file = Joined({TitledTag("T", "B").Padding(600).Build(), kSound, ape, old});
    const auto begin = file.size() - kSound.size() - ape.size() - kOld;
    const Bytes behind = Joined({kSound, ape});

    const auto edit = EditOf(file, kNewAlbum);
    const FilePatch patch = PlanOf(file, edit);
    const Bytes after = Patched(file, patch);
    EXPECT_TRUE(patch.FitsInPlace());
    ASSERT_EQ(after.size(), file.size());
    EXPECT_TRUE(std::ranges::equal(ByteSpan(after).subspan(begin, behind.size()), behind));
    EXPECT_EQ(AsText(ByteSpan(after).last(kOld).subspan(63, 4)), "Neu\0"s);
    // What stood in front of the change is not written again.
    EXPECT_LT(patch.InsertedBytes(), static_cast<std::int64_t>(begin + kOld - 20));
    MemorySource oldFile(file);
    EXPECT_EQ(Patched(after, patch.Inverse(oldFile)), file);

    // One byte more than there is room for, and exactly as much.
    const auto used = FramesOfTag(after);
    std::size_t size = 10;
    for (const auto& frame : used)
        size += 10 + frame.second.size();
    for (const std::size_t room : {begin - size, begin - size + 1}) {
        const auto longer = EditOf(
            file, [&](TagEdit& e) { e.Record.Album = QString(static_cast<qsizetype>(3 + room), u'x'); });
        const FilePatch grown = PlanOf(file, longer);
        const Bytes result = Patched(file, grown);
        EXPECT_EQ(grown.FitsInPlace(), room == begin - size);
        EXPECT_EQ(result.size(), file.size() + (room == begin - size ? 0 : 1024 + 1));
        EXPECT_TRUE(EndsWith(ByteSpan(result).first(result.size() - kOld), behind));
        EXPECT_EQ(ReadModern(result).Album, longer.Record.Album);
    }

    // Whatever the order was, the old tag comes last, and only once.
    const Bytes odd = Joined({kSound, old, old, ape});
    const Bytes sorted = Tagged(odd, EditOf(odd, kNewAlbum));
    EXPECT_TRUE(EndsWith(ByteSpan(sorted).first(sorted.size() - kOld), behind));
}

TEST(TagPlan, OtherFilesGetTheirTagBehindTheSound) {
    const auto old = Id3v1Bytes("T", "B", "", "", "", 255);
    for (const Bytes& sound : {WaveFile(), WmaFile()}) {
        Bytes file = Joined({sound, old});
        for (const qsizetype length : {5, 500, 3}) {
            const auto edit = EditOf(file, [&](TagEdit& e) {
                e.Record.Title = u"Titel"_s;
                e.Record.Artist = u"Band"_s;
                e.Record.Album = QString(length, u'x');
                e.Cover = CoverPicture{"picture", u"image/png"_s};
            });
            const FilePatch patch = PlanOf(file, edit);
            EXPECT_TRUE(patch.FitsInPlace());
            file = Patched(file, patch);
            EXPECT_TRUE(StartsWith(file, AsText(sound)));
            EXPECT_TRUE(StartsWith(ByteSpan(file).subspan(sound.size()), "ID3\3"));
            EXPECT_EQ(ReadModern(file).Album, edit.Record.Album);
            EXPECT_TRUE(PlanOf(file, edit).ChangesNothing(std::ssize(file)));
            MemorySource source(file);
            EXPECT_EQ(ReadCoverArt(source), "picture");
        }
        MemorySource source(file);
        EXPECT_EQ(Patched(file, PlanTagRemoval(source, kTagPath)), sound);
    }
    // Bytes of the sound may look like an old tag.
    Bytes sound = WaveFile();
    std::ranges::copy(old, sound.end() - static_cast<std::ptrdiff_t>(kOld));
    EXPECT_TRUE(StartsWith(Tagged(sound, EditOf(sound, kNewAlbum)), AsText(sound)));
}

TEST(TagPlan, RemovalLeavesSoundAndApeTag) {
    const Bytes ape = ApeTag();
    const auto tag = TitledTag("T", "B").Padding(100).Build();
    Mp3Builder file;
    file.Raw(tag).Raw(TitledTag("x", "y", 4).Build()).Raw(kSound).Raw(ape);
    file.Id3v1("T", "B").TrailingTag(tag);
    // The tag in front came later: the trailer leads astray until that goes.
    const Bytes hidden = Joined({tag, Mp3Builder().Raw(kSound).Raw(ape).TrailingTag(tag).Data()});
    for (const Bytes& each : {file.Data(), hidden}) {
        MemorySource source(each);
        const Bytes bare = Patched(each, PlanTagRemoval(source, kTagPath));
        EXPECT_EQ(bare, Joined({kSound, ape}));
        MemorySource again(bare);
        EXPECT_TRUE(PlanTagRemoval(again, kTagPath).ChangesNothing(std::ssize(bare)));
    }
}

TEST(TagPlan, TheFrontCoverIsReplacedAndOthersStay) {
    const std::pair back{"APIC"s, "\0image/png\0\4\0back"s};
    const Bytes file = WithTag(TitledTag("T", "B")
                                   .Frame("APIC", back.second)
                                   .Frame("APIC", "\0image/png\0\3x\0one"s)
                                   .Text("TCOM", "C")
                                   .Frame("APIC", "\0image/png\0\3y\0two"s));
    const auto after = [&file](const CoverChange& change) {
        const auto edit = EditOf(file, [&](TagEdit& e) { e.Cover = change; });
        const Bytes changed = Tagged(file, edit);
        EXPECT_TRUE(PlanOf(changed, edit).ChangesNothing(std::ssize(changed)));
        auto frames = WithoutTechnical(FramesOfTag(changed));
        frames.erase(frames.begin(), frames.begin() + 2);
        return frames;
    };
    EXPECT_EQ(after(CoverRemoval{}), (FrameList{back, {"TCOM", "\0C"s}}));
    EXPECT_EQ(after(CoverPicture{"new", u"image/jpeg"_s}),
              (FrameList{back, {"APIC", "\0image/jpeg\0\3\0new"s}, {"TCOM", "\0C"s}}));
    MemorySource source(file);
    EXPECT_EQ(ReadCoverArt(source), "one");
}

TEST(TagPlan, TrackTotalsStayUntilTheyAreChanged) {
    const Bytes file = WithTag(TitledTag("T", "B").Text("TRCK", "3/12"));
    const auto after = [&file](quint8 track, std::optional<int> total) {
        const auto edit = EditOf(file, [&](TagEdit& e) { e.Record.Track = track, e.TrackTotal = total; });
        return FramesOfTag(Tagged(file, edit))[2].second.substr(1);
    };
    EXPECT_EQ(after(4, {}), "4/12");
    EXPECT_EQ(after(13, {}), "13");
    EXPECT_EQ(after(3, 20), "3/20");
    EXPECT_EQ(after(3, 0), "3");
    MemorySource with(file);
    EXPECT_EQ(ReadTrackTotal(with), 12);
    MemorySource without(kSound);
    EXPECT_EQ(ReadTrackTotal(without), std::nullopt);
}

TEST(TagPlan, WhatIsNotUnderstoodIsNotTouched) {
    const auto titled = [](std::uint8_t version = 3) { return TitledTag("T", "B", version); };
    const std::vector<std::pair<Bytes, QString>> cases = {
        {{}, u"keine MPEG-"_s},
        {Mp3Builder().Raw(AsBytes("OggS")).Noise(200).Raw(kSound).Data(), u"keine MPEG-"_s},
        {titled().Build(), u"keine MPEG-"_s},
        {Joined({Id3v2Builder(5).Text("TIT2", "x").Build(), kSound}), u"unbekannte Version"_s},
        {Bytes(300, std::uint8_t{'x'}), u"keine MPEG-"_s},
        {WithTag(titled().Padding(9).Raw("rubbish")), u"beschädigt"_s},
        {WithTag(titled().SizedFrame("TALB", 4000, "x")), u"beschädigt"_s},
        {Joined({ByteSpan(titled().Padding(5000).Build()).first(4000)}), u"Ende der Datei"_s},
        {WithTag(Id3v2Builder(2).Text("TT2", "T").Frame("CRM", "secret")), u"verschlüsselt"_s},
        {WithTag(titled(4).Frame("UFID", "\0\0\0\7rubbish"s, 0x09)), u"nicht lesbar"_s},
    };
    for (const auto& [file, reason] : cases) {
        const QString message = ErrorOf<EStreamError>([&] { PlanOf(file, {}); });
        EXPECT_TRUE(message.contains(reason) && message.contains(kTagPath)) << message.toStdString();
    }
    ByteWriter tag;
    EXPECT_THROW(AppendTag(tag, {}, 10 + (std::int64_t{1} << 28)), EStreamError);
    EXPECT_THROW(AppendTrailer(tag, std::int64_t{1} << 32), EStreamError);
}
