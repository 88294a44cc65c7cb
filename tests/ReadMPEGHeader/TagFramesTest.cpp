#include <gtest/gtest.h>

#include <random>

#include "CommonRUKTools/CodePage.h"
#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/TagFiles.h"

using namespace Qt::StringLiterals;
using namespace std::string_literals;

namespace {

TID3Tag Example() {
    TID3Tag record;
    record.Title = u"Titel €"_s;
    record.Artist = u"Ännie"_s;
    record.Album = u"Album"_s;
    record.Year = u"1999"_s;
    record.Comment = u"Gut\nPrivate Angaben:\nabc\ndef\nURL:(Seite [1]) http://a.example/ä"_s;
    record.MPEGLayer = u"MPEG 1/2 Layer III"_s;
    record.Length = 245;
    record.Genre = 17;
    record.MainGenre = 3;
    record.Remix = true;
    record.Track = 3;
    record.PlayCount = 0x0102;
    return record;
}

FrameList FramesOf(const TID3Tag& record, int total = 0, ReadProfile profile = ReadProfile::Classic) {
    ByteWriter stream;
    WriteID3v2Frames(stream, total, record, profile);
    return FramesIn(stream.Bytes());
}

template <typename Change>
std::string FrameWith(const std::string& id, ReadProfile profile, Change change, int total = 0) {
    TID3Tag record = Example();
    change(record);
    for (const auto& [name, body] : FramesOf(record, total, profile))
        if (name == id) return body;
    return "none";
}

const std::string kMark = "\xFF\xFE"s;

}  // namespace

TEST(TagFrames, ClassicTagIsWrittenByteForByte) {
    TID3Tag record = Example();
    record.BitRate = 0x1234;
    record.SampleRate = 44100;
    record.ChannelMode = 3;
    record.Original = true;
    record.FrameSize = 417;
    record.Reserved = 0x0506;
    record.Flags = 9;
    record.AddTime = 1.5;
    const FrameList expected = {
        {"TIT2", "\0Titel \x80"s},
        {"TPE1", "\0\xC4nnie"s},
        {"TALB", "\0Album"s},
        {"TYER", '\0' + "1999"s},
        {"COMM", "\0\0\0\0\0Gut"s},
        {"PRIV", "abc def"s},
        {"WXXX", "\0Seite (1)\0http://a.example/\xE4"s},
        {"TFLT", "\0/3"s},
        {"TLEN", '\0' + "245000"s},
        {"TCON", "\0(17)German Rock (RX)"s},
        {"TRCK", '\0' + "3/12"s},
        {"PCNT", "\2\1\0\0"s},
    };
    FrameList frames = FramesOf(record, 12);
    const auto own = frames.back();
    frames.pop_back();
    EXPECT_EQ(frames, expected);
    EXPECT_EQ(own.first, "XRUK");
    ASSERT_EQ(own.second.size(), 273u + 18u);
    EXPECT_EQ(own.second.substr(242),
              "\0MPEG 1/2 Layer III\0\x34\x12\x44\xAC\3\0\0\0\0\1\0\xA1\1\6\5\x9\0\0\0\3"
              "\1\0\0\0\0\0\0\xF8\x3F"s);
}

TEST(TagFrames, OddValuesAreWrittenAsEachSetOfRulesHasThem) {
    constexpr auto kClassic = ReadProfile::Classic;
    constexpr auto kModern = ReadProfile::Modern;
    const auto comment = [](const QString& text) { return [text](TID3Tag& r) { r.Comment = text; }; };
    const auto title = [](const QString& text) { return [text](TID3Tag& r) { r.Title = text; }; };
    const auto genre = [](quint8 number, quint8 main, bool remix) {
        return [=](TID3Tag& r) { r.Genre = number, r.MainGenre = main, r.Remix = remix; };
    };
    const auto track = [](quint8 number) { return [=](TID3Tag& r) { r.Track = number; }; };

    EXPECT_EQ(FrameWith("TIT2", kClassic, title(u"Ã¤"_s)), "\0\xC3\xA4"s);
    EXPECT_EQ(FrameWith("TIT2", kModern, title(u"Ã¤"_s)), "\1"s + kMark + "\xC3\0\xA4\0"s);
    EXPECT_EQ(FrameWith("TIT2", kClassic, title(u"Ω"_s)), "\1"s + kMark + "\xA9\x03"s);
    EXPECT_EQ(FrameWith("TIT2", kModern, title(u"€"_s)), "\1"s + kMark + "\xAC\x20"s);
    EXPECT_EQ(FrameWith("TIT2", kModern, title(u"ä"_s)), "\0\xE4"s);
    EXPECT_EQ(FrameWith("TIT2", kModern, title(u"a\0b"_s)), "\0a"s);

    EXPECT_EQ(FrameWith("COMM", kClassic, comment(u"Gut\r\nPrivate Angaben:abc"_s)), "\0\0\0\0\0Gut"s);
    EXPECT_EQ(FrameWith("PRIV", kClassic, comment(u"Gut\r\nPrivate Angaben:abc"_s)), "abc");
    EXPECT_EQ(FrameWith("PRIV", kClassic, comment(u"Private Angaben:Ω"_s)), "\xCE\xA9");
    EXPECT_EQ(FrameWith("PRIV", kModern, comment(u"Private Angaben:\na\nb"_s)), "a\nb");
    EXPECT_EQ(FrameWith("WXXX", kClassic, comment(u"URL:http://b.example\nGut"_s)), "\0\0http://b.example"s);
    EXPECT_EQ(FrameWith("COMM", kClassic, comment(u"URL:http://b.example\nGut"_s)), "\0\0\0\0\0Gut"s);
    EXPECT_EQ(FrameWith("COMM", kModern, comment(u"Ω"_s)),
              "\1\0\0\0"s + kMark + "\0\0"s + kMark + "\xA9\x03"s);
    // What would not read back as it stands is not taken apart.
    EXPECT_EQ(FrameWith("COMM", kModern, comment(u"Siehe URL:x"_s)), "\0\0\0\0\0Siehe URL:x"s);
    EXPECT_EQ(FrameWith("WXXX", kModern, comment(u"Siehe URL:x"_s)), "none");

    EXPECT_EQ(FrameWith("TCON", kClassic, genre(255, 0, false)), "\0(255)?"s);
    EXPECT_EQ(FrameWith("TCON", kModern, genre(255, 0, false)), "none");
    EXPECT_EQ(FrameWith("TCON", kModern, genre(255, 0, true)), "\0(RX)"s);
    EXPECT_EQ(FrameWith("TCON", kModern, genre(17, 0, false)), "\0(17)"s);
    EXPECT_EQ(FrameWith("TCON", kModern, genre(255, 8, false)), "\0(255)Rock/Pop"s);
    EXPECT_EQ(FrameWith("TCON", kModern, genre(255, 2, false)), "\0(255)"s);

    EXPECT_EQ(FrameWith("TRCK", kClassic, track(13), 12), '\0' + "13"s);
    EXPECT_EQ(FrameWith("TRCK", kClassic, track(0), 12), '\0' + "0/12"s);
    EXPECT_EQ(FrameWith("TRCK", kClassic, track(0)), '\0' + "0"s);
    EXPECT_EQ(FrameWith("TRCK", kModern, track(0)), "none");

    EXPECT_EQ(FrameWith("PCNT", kModern, [](TID3Tag&) {}), "\0\0\1\2"s);
}

TEST(TagFrames, WholeTagsStandBeforeOrBehindTheSound) {
    ByteWriter leading;
    leading.Raw("sound");
    WriteID3v2Tag(leading, Example(), TagPlace::Leading);
    MemorySource source(leading.Bytes());
    std::int64_t end = 0;
    TID3Tag tag;
    ASSERT_TRUE(ReadID3v2(source, 0, end, tag, {}));
    EXPECT_EQ(end + 5, source.Size());
    const ByteSpan bytes(leading.Bytes());
    EXPECT_TRUE(StartsWith(bytes, "ID3\3\0\0"s));
    EXPECT_EQ(AsText(bytes.last(5)), "sound");
    EXPECT_EQ(AsText(bytes.last(1024 + 5).first(1024)), std::string(1024, '\0'));

    ByteWriter behind;
    behind.Raw("sound");
    WriteID3v2Tag(behind, Example(), TagPlace::BehindAudio);
    EXPECT_TRUE(StartsWith(ByteSpan(behind.Bytes()), "soundID3"));
    EXPECT_EQ(AsText(ByteSpan(behind.Bytes()).last(8)), "ID32\5\0\0\0"s);
}

// A count that was written from the other end is known by the program's own frame and its size.
TEST(TagFrames, PlayCountsOfBothRulesAreRead) {
    const auto count = [](const std::string& body, bool own, Id3v2ReadFunction& read = ReadID3v2Modern) {
        Id3v2Builder builder;
        builder.Frame("PCNT", body);
        if (own) builder.Frame("XRUK", XrukBody(WaveRecord()));
        return ReadWith(read, builder.Build()).Tag.PlayCount;
    };
    EXPECT_EQ(count("\7\0\0\0"s, true), 7u);
    EXPECT_EQ(count("\0\1\0\0"s, true), 256u);
    EXPECT_EQ(count("\0\0\1\0"s, true), 256u);
    EXPECT_EQ(count("\7\0\0\0"s, false), 0x07000000u);
    EXPECT_EQ(count("\0\7\0\0\0"s, true), 0x07000000u);
    EXPECT_EQ(count("\1\2\3\4"s, true), 0x01020304u);
    EXPECT_EQ(count("\7\0\0\0"s, true, ReadID3v2), 0x07000000u);
    EXPECT_EQ(FrameWith("PCNT", ReadProfile::Modern, [](TID3Tag& r) { r.PlayCount = 0x07000000; }),
              "\0\7\0\0\0"s);
}

namespace {

QString AsReadInSingleBytes(const QString& text) {
    const QByteArray bytes = CodePage::ToLegacy(text);
    return CodePage::FromLegacy(AsBytes({bytes.constData(), static_cast<std::size_t>(bytes.size())}));
}

class RecordGenerator {
 public:
    explicit RecordGenerator(bool legacyOnly) : legacyOnly_(legacyOnly) {}

    TID3Tag Next() {
        TID3Tag record;
        record.Title = Text();
        record.Artist = Text();
        record.Album = Text();
        record.Year = Below(4) == 0 ? u"0000"_s : QString::number(1900 + Below(130));
        record.Comment = Comment();
        record.MPEGLayer = Below(3) == 0 ? u"MPEG 1/2 Layer III"_s : u"MPEG 1.0 Layer III"_s;
        record.Length = static_cast<quint16>(Below(65536));
        record.Genre = static_cast<quint8>(Below(3) == 0 ? 255 : Below(256));
        record.MainGenre = static_cast<quint8>(Below(20));
        record.Remix = Below(3) == 0;
        record.Track = static_cast<quint8>(Below(256));
        record.PlayCount = static_cast<quint32>(Below(3) == 0 ? Below(1 << 30) : Below(1000));
        record.BitRate = static_cast<quint16>(Below(65536));
        record.SampleRate = static_cast<quint16>(Below(65536));
        record.ChannelMode = static_cast<quint8>(Below(8));
        record.Emphasis = static_cast<quint8>(Below(5));
        record.Private = Below(2) == 0;
        record.Protected = Below(2) == 0;
        record.Copyrighted = Below(2) == 0;
        record.Original = Below(2) == 0;
        record.Padding = Below(2) == 0;
        record.FrameSize = static_cast<quint16>(Below(65536));
        record.Reserved = static_cast<quint16>(Below(65536));
        record.Flags = static_cast<quint32>(Below(1 << 30));
        record.AddTime = 30000 + Below(20000) / 7.0;
        return record;
    }

 private:
    int Below(int bound) { return static_cast<int>(random_() % static_cast<unsigned>(bound)); }

    QString Character() {
        // Every character of the code page in turn; a zero is none.
        const auto byte = static_cast<std::uint8_t>(1 + next_++ % 255);
        if (legacyOnly_ || Below(3) != 0) return CodePage::FromLegacy({&byte, 1});
        static const QStringList others = {u"Ω"_s, u"\U0001F3B5"_s, u"Ã¤"_s, u"\uFEFF"_s, u"ń"_s, u"\n"_s};
        return others[Below(static_cast<int>(others.size()))];
    }

    QString Text() {
        QString text;
        for (int length = Below(5) == 0 ? 0 : Below(40); length > 0; --length)
            text += Character();
        return text;
    }

    // One that the classic rules read as it was, and that no line end divides from what follows.
    QString LegacyComment() {
        const QString text = Text().trimmed();
        return AsReadInSingleBytes(text) == text && !text.isEmpty() ? text : u"Gut"_s;
    }

    // Texts that can be read in a comment's parts: addresses hold nothing but letters.
    QString Comment() {
        QStringList parts;
        if (const QString text = legacyOnly_ ? LegacyComment() : Text(); Below(3) != 0) parts += text;
        if (Below(4) == 0) parts += u"Private Angaben:\n"_s + (legacyOnly_ ? u"äbc 1"_s : u"äbc\nΩ"_s);
        if (Below(4) == 0) parts += u"URL:(Ein [Ort]) http://a.example/%1"_s.arg(Below(1000));
        if (!legacyOnly_ && Below(5) == 0) parts += u"URL: Private Angaben:"_s + Text();
        return parts.join(u'\n');
    }

    bool legacyOnly_;
    std::mt19937 random_{4711};
    unsigned next_ = 0;
};

std::string TextsOf(const TID3Tag& tag) {
    const QStringList texts = {tag.Title, tag.Artist, tag.Album, tag.Year, tag.Comment, tag.MPEGLayer};
    return u"\n"_s.toStdString() + texts.join(u"|"_s).toStdString();
}

// The record as its tag alone tells it.
TID3Tag ReadBack(ByteSpan file, Id3v2ReadFunction& read) {
    auto outcome = ReadWith(read, file);
    EXPECT_TRUE(outcome.Read && outcome.Xruk);
    if (!outcome.Xruk) return {};
    outcome.Xruk->ApplyTechnicalFields(outcome.Tag);
    outcome.Tag.Remix = false;  // "TCON" must say so, too, but only where it exists
    outcome.Xruk->ApplyCollectionFields(outcome.Tag);
    return outcome.Tag;
}

}  // namespace

TEST(TagFrames, ThousandsOfRecordsReadBackAsTheyWereWritten) {
    const Bytes sound = Mp3Builder().Frames(3).Data();
    RecordGenerator any(false);
    RecordGenerator legacy(true);
    for (int i = 0; i < 2000; ++i) {
        const TagEdit edit{.Record = any.Next()};
        const Bytes file = Tagged(sound, edit);
        const TID3Tag back = ReadBack(file, ReadID3v2Modern);
        ASSERT_EQ(back, edit.Record) << i << TextsOf(back) << TextsOf(edit.Record);
        ASSERT_TRUE(PlanOf(file, edit).ChangesNothing(std::ssize(file))) << i;

        const TagEdit old{.Record = legacy.Next()};
        const Bytes oldFile = Tagged(sound, old, ReadProfile::Classic);
        TID3Tag expected = old.Record;
        TID3Tag read = ReadBack(oldFile, ReadID3v2);
        // The classic rules take what could be UTF-8 for it, and a count from the wrong end.
        read.PlayCount = expected.PlayCount = 0;
        for (QString* text : {&expected.Title, &expected.Artist, &expected.Album})
            *text = AsReadInSingleBytes(*text);
        ASSERT_EQ(read, expected) << i << TextsOf(read) << TextsOf(expected);
        ASSERT_TRUE(PlanOf(oldFile, old, ReadProfile::Classic).ChangesNothing(std::ssize(oldFile))) << i;
    }
}
