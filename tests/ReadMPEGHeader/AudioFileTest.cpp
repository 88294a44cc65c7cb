#include "ReadMPEGHeader/AudioFile.h"

#include <gtest/gtest.h>

#include <cmath>

#include "CommonRUKTools/Errors.h"
#include "ReadMPEGHeader/Genres.h"
#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/AsfBuilder.h"
#include "tests/ReadMPEGHeader/Builders.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::array kProfiles = {ReadProfile::Classic, ReadProfile::Modern};

Bytes TwoSeconds() {
    return WaveBuilder().Format(2, 1000).Chunk("data", 8000).Zeros(8000).Data();
}

class BrokenMedium : public ByteSource {
 public:
    std::int64_t Size() const override { return 100'000; }
    std::size_t ReadAt(std::int64_t position, std::span<std::uint8_t> target) override {
        if (position > 10'000) throw EMediumError(u"Lesefehler"_s);
        std::ranges::fill(target, std::uint8_t{0});
        return target.size();
    }
};

}  // namespace

TEST(AudioFile, RefusalsLeaveTheDefaultsAndErrorsAreThrown) {
    const auto options = InProfile(ReadProfile::Classic);
    TID3Tag tag;
    tag.Title = u"old"_s;
    TID3Tag fresh;
    ResetTag(false, fresh, 1);
    for (const auto& [path, refusal] :
         {std::pair(u""_s, u"Keine Datei angegeben"_s), {u":0123ABCD:\\a.mp3"_s, u"CD nicht eingelegt"_s}}) {
        EXPECT_EQ(ReadAudioFile(path, options, tag), refusal);
        EXPECT_EQ(tag, fresh);
    }
    EXPECT_THROW(ReadAudioFile(QDir::tempPath(), options, tag), EStreamError);
    BrokenMedium medium;
    EXPECT_EQ(ReadSong(medium, u"/m/x.mp3"_s, options).Error, u"Lesefehler"_s);
}

TEST(AudioFile, AMissingFileIsDescribedByItsName) {
    const SongFolder folder;
    folder.Put(u"f"_s, "");
    // Behind a file there is nothing, and the system would see the name that ends at a zero.
    for (const auto& name : {u"f/ABBA - Waterloo.mp3"_s, u"f\0/ABBA - Waterloo"_s}) {
        const auto path = folder.Path(name);
        const auto reading = ReadSong(path, InProfile(ReadProfile::Classic));
        EXPECT_EQ(reading.Refusal, u"Datei nicht gefunden"_s);
        EXPECT_EQ(reading.Tag.Artist, u"ABBA"_s);
        EXPECT_EQ(reading.Tag.Title, u"Waterloo"_s);
        EXPECT_EQ(reading.Tag.FileName, path);
        EXPECT_EQ(reading.Tag.MPEGLayer, u"MPEG ??? Layer ???"_s);
    }
}

TEST(AudioFile, AnOrdinarySongIsReadInBothProfiles) {
    const SongFolder folder;
    const auto tags = TitledTag("Waterloo", "ABBA")
                          .Text("TRCK", "3/12")
                          .Text("TLEN", "999000")
                          .Text("TCON", "(18)Techno (RX)");
    const Bytes song = Mp3Builder().Raw(tags.Build()).Frames(400).Id3v1("other", "other").Data();
    const auto path = folder.Put(u"x.mp3"_s, ByteSpan(song));
    for (const auto profile : kProfiles) {
        TID3Tag tag;
        EXPECT_EQ(ReadAudioFile(path, InProfile(profile), tag), u""_s);
        EXPECT_EQ(tag.Title, u"Waterloo"_s);
        EXPECT_EQ(tag.Track, 3);
        EXPECT_EQ(tag.Genre, 18);
        EXPECT_TRUE(tag.Remix);
        EXPECT_EQ(tag.MPEGLayer, u"MPEG 1.0 Layer III"_s);
        EXPECT_EQ(tag.BitRate, 128);
        EXPECT_EQ(tag.Length, 10);  // what was found in the sound stands before the tag
        EXPECT_EQ(tag.FileName, path);
        EXPECT_EQ(LastMpegResults().FrameSize, 417);
        // Where there is no sound the tag tells the length.
        EXPECT_EQ(Read(tags.Build(), InProfile(profile)).Length, 999);
        ReadAudioFile(u""_s, InProfile(profile), tag);
        EXPECT_EQ(LastMpegResults().FrameSize, -1);
    }
}

TEST(AudioFile, ExactlyOneSourceOfTagsCounts) {
    const auto complete = TitledTag("v2", "artist").Text("TALB", "album").Build();
    const auto incomplete = Id3v2Builder().Text("TIT2", "v2").Text("TALB", "album").Build();
    const auto frames = Mp3Builder().Frames(2).Data();
    const auto title = [&frames](ByteSpan tag, const char* v1) {
        Mp3Builder file;
        file.Raw(tag).Raw(frames);
        if (v1 != nullptr) file.Id3v1("v1", v1);
        const auto read = Read(file.Data());
        EXPECT_EQ(read.Album, read.Title == u"v2"_s ? u"album"_s : u""_s);
        return read.Title;
    };
    EXPECT_EQ(title(complete, "artist"), u"v2"_s);
    EXPECT_EQ(title(incomplete, "artist"), u"v1"_s);
    EXPECT_EQ(title(incomplete, ""), u"name"_s);
    EXPECT_EQ(title({}, "artist"), u"v1"_s);
    EXPECT_EQ(title({}, nullptr), u"name"_s);
}

TEST(AudioFile, SourcesAreCleanedBeforeOneIsChosen) {
    const auto junk = TitledTag("Track 7", "ABBA").Build();
    const auto file = Mp3Builder().Raw(junk).Frames(2).Id3v1("(7) Waterloo", "ABBA").Data();
    auto options = InProfile(ReadProfile::Classic);
    EXPECT_EQ(Read(file, options).Title, u"Track 7"_s);
    options.RemoveJunkTexts = true;
    options.TakeTrackNumbers = true;
    const auto tag = Read(file, options);
    EXPECT_EQ(tag.Title, u"Waterloo"_s);
    EXPECT_EQ(tag.Track, 7);
}

TEST(AudioFile, ShortFilesHaveNoRoomForTags) {
    for (const std::size_t size : {0u, 1u, 7u, 8u, 15u, 31u, 100u, 127u}) {
        const auto tag = Read(Mp3Builder().Noise(size).Data());
        EXPECT_EQ(tag.Title, u"name"_s);
        EXPECT_EQ(tag.Artist, u"Folder"_s);
    }
    EXPECT_EQ(Read(Mp3Builder().Id3v1("v1", "artist").Data()).Title, u"v1"_s);
    // An ID3v1 tag stands at the very end or not at all.
    EXPECT_EQ(Read(Mp3Builder().Id3v1("v1", "artist").Zeros(1).Data()).Title, u"name"_s);
}

TEST(AudioFile, WaveFilesAreNotSearchedForFramesAndMayCarryATrailingTag) {
    auto wave = Mp3Builder().Raw(TwoSeconds()).Frames(2).Data();
    const auto plain = Read(wave, InProfile(ReadProfile::Classic), u"/m/ABBA - Waterloo.wav"_s);
    EXPECT_EQ(plain.MPEGLayer, u"Wave"_s);
    EXPECT_EQ(plain.Length, 2);
    EXPECT_EQ(plain.Title, u"Waterloo"_s);
    EXPECT_EQ(plain.AddTime, 1);
    EXPECT_EQ(ReadingOf(wave).Mpeg.FrameSize, -1);
    const auto tagged = Mp3Builder().Raw(wave).TrailingTag(TitledTag("T", "A").Build()).Data();
    EXPECT_EQ(Read(tagged).Title, u"T"_s);
    EXPECT_EQ(Read(tagged).MPEGLayer, u"Wave"_s);
    // A RIFF file of another form stays what its name says.
    wave[8] = 'X';
    EXPECT_EQ(Read(wave, InProfile(ReadProfile::Classic), u"/m/a.avi"_s).MPEGLayer, u"Video (AVI)"_s);
}

TEST(AudioFile, OnlyAReadableWmaHeaderSuppressesTheFileName) {
    const auto options = InProfile(ReadProfile::Classic);
    const auto wma = AsfBuilder().Content(u"Waterloo"_s, u""_s, u""_s).Build();
    EXPECT_EQ(Read(wma, options, u"/m/A - B.wma"_s).Title, u"Waterloo"_s);
    EXPECT_EQ(Read(wma, options, u"/m/A - B.wma"_s).Artist, u""_s);
    const Bytes damaged(wma.begin(), wma.begin() + 20);
    const auto tag = Read(damaged, options, u"/m/A - B.wma"_s);
    EXPECT_EQ(tag.Title, u"B"_s);
    EXPECT_EQ(tag.MPEGLayer, u"Windows Media Audio"_s);
    EXPECT_TRUE(ReadingOf(damaged).Remarks.Text.startsWith(u"ASF"_s));
}

TEST(AudioFile, ATrailerThatLeadsNowhereIsIgnored) {
    const auto song = Mp3Builder().Frames(3).Data();
    for (const std::uint32_t position : {0u, 5u, 1251u, 0xFFFFFFFFu}) {
        const auto tag = Read(Mp3Builder().Raw(song).Trailer(position).Data());
        EXPECT_EQ(tag.BitRate, 128);
        EXPECT_EQ(tag.Title, u"name"_s);
    }
}

TEST(AudioFile, TheProgramsOwnFrameRestoresWhatTheAudioDoesNotTell) {
    TID3Tag kept;
    kept.MPEGLayer = u"MPEG 1.0 Layer II"_s;
    kept.BitRate = 192;
    kept.SampleRate = 48000;
    kept.ChannelMode = 3;
    kept.Emphasis = 4;
    kept.Private = kept.Original = kept.Padding = true;
    kept.FrameSize = 1044;
    kept.Reserved = 0xBEEF;
    kept.Flags = 0x80000005;
    kept.MainGenre = 15;
    kept.Remix = true;
    kept.AddTime = 36525.5;
    const auto tag = TitledTag("T", "A").Frame("XRUK", XrukBody(kept)).Build();
    auto restored =
        Read(Mp3Builder().Noise(500).TrailingTag(tag).Data(), InProfile(ReadProfile::Classic), u"/m/a.mpg"_s);
    EXPECT_EQ(restored.Genre, 18);  // what the main genre stands for
    EXPECT_EQ(restored.Title, u"T"_s);
    restored.FileName = restored.Title = restored.Artist = QString();
    restored.Genre = kNoGenre;
    EXPECT_EQ(restored, kept);

    const auto song = Read(Mp3Builder().Raw(tag).Frames(50).Data());
    EXPECT_EQ(song.MPEGLayer, u"MPEG 1.0 Layer III"_s);
    EXPECT_EQ(song.BitRate, 128);
    EXPECT_FALSE(song.Private);
    EXPECT_EQ(song.Flags, kept.Flags);

    const auto wave = Read(Mp3Builder().Raw(TwoSeconds()).TrailingTag(tag).Data());
    EXPECT_EQ(wave.MPEGLayer, u"Wave"_s);
    EXPECT_EQ(wave.MainGenre, 15);
}

TEST(AudioFile, TheMainGenreIsDerivedWhereItIsUnknownAndWanted) {
    auto options = InProfile(ReadProfile::Modern);
    TID3Tag kept;
    kept.MainGenre = 15;
    const auto named = TitledTag("T", "A").Text("TCON", "(17)German Rock");
    const auto frames = Mp3Builder().Frames(2).Data();
    const auto tagged = Mp3Builder().Raw(named.Build()).Raw(frames).Data();
    const auto owned = Mp3Builder()
                           .Raw(tagged)
                           .TrailingTag(TitledTag("T", "A").Frame("XRUK", XrukBody(kept)).Build())
                           .Data();
    const auto numbered = Mp3Builder().Raw(frames).Id3v1("t", "a", 9).Data();
    EXPECT_EQ(Read(tagged, options).MainGenre, 0);
    options.DeriveMainGenre = true;
    EXPECT_EQ(Read(tagged, options).MainGenre, 3);
    EXPECT_EQ(Read(owned, options).MainGenre, 15);
    EXPECT_EQ(Read(numbered, options).MainGenre, 14);
    EXPECT_EQ(Read(frames, options).MainGenre, 0);
}

TEST(AudioFile, ADamagedTagCostsOnlyItself) {
    const auto tag = TitledTag("T", "A").SizedFrame("TALB", 0x7FFFFFFF, "x").Build();
    const auto file = Mp3Builder().Raw(tag).Frames(20).Id3v1("v1", "artist").Data();
    const auto classic = Read(file, InProfile(ReadProfile::Classic));
    EXPECT_EQ(classic.Title, u"v1"_s);
    EXPECT_EQ(classic.BitRate, 128);
    EXPECT_TRUE(ReadingOf(file).Remarks.Text.contains(u"ID3v2"_s));
    // The modern profile keeps the frames before the damage.
    const auto modern = Read(file, InProfile(ReadProfile::Modern));
    EXPECT_EQ(modern.Title, u"T"_s);
    EXPECT_EQ(modern.BitRate, 128);
    EXPECT_TRUE(ReadingOf(Mp3Builder().Frames(2).Data()).Remarks.Text.isEmpty());
}
