#include "ReadMPEGHeader/AudioFile.h"

#include <gtest/gtest.h>

#include <QTemporaryDir>
#include <cmath>

#include "CommonRUKTools/Errors.h"
#include "tests/HandClock.h"
#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/AsfBuilder.h"
#include "tests/ReadMPEGHeader/Builders.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::array kProfiles = {ReadProfile::Classic, ReadProfile::Modern};

Bytes WaveFile() {
    ByteWriter file;
    file.Raw("RIFF");
    file.U32Le(0);
    file.Raw("WAVEfmt ");
    file.U32Le(16);
    file.U16Le(1);
    file.U16Le(2);
    file.U32Le(1000);
    file.U32Le(4000);
    file.U16Le(4);
    file.U16Le(16);
    file.Raw("data");
    file.U32Le(8000);
    file.Zeros(8000);
    return file.Bytes();
}

// Frame "XRUK": the record's technical data as the program keeps them.
std::string RecordBody() {
    ByteWriter body;
    body.Zeros(243);
    body.Raw("MPEG 1.0 Layer II");
    body.U8(0);
    body.U16Le(192);
    body.U16Le(48000);
    body.U8(3);
    body.Zeros(6);
    body.U16Le(576);
    body.U16Le(77);  // reserved word
    body.U32Le(5);   // flags
    body.U8(15);     // main genre
    body.U8(1);      // remix
    body.F64Le(36525.5);
    return std::string(AsText(body.Bytes()));
}

void WriteFile(const QString& path, ByteSpan bytes) {
    QFile file(path);
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    file.write(reinterpret_cast<const char*>(bytes.data()), static_cast<qint64>(bytes.size()));
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

TEST(AudioFile, RefusalsLeaveTheDefaults) {
    TID3Tag tag;
    tag.Title = u"old"_s;
    EXPECT_EQ(ReadAudioFile(u""_s, InProfile(ReadProfile::Classic), tag), u"Keine Datei angegeben"_s);
    TID3Tag fresh;
    ResetTag(false, fresh, 1);
    EXPECT_EQ(tag, fresh);
    EXPECT_EQ(ReadAudioFile(u":0123ABCD:\\a.mp3"_s, InProfile(ReadProfile::Classic), tag),
              u"CD nicht eingelegt"_s);
    EXPECT_EQ(tag, fresh);
}

TEST(AudioFile, AMissingFileIsDescribedByItsName) {
    TID3Tag tag;
    const auto path = u"/nowhere/ABBA - Waterloo.mp3"_s;
    EXPECT_EQ(ReadAudioFile(path, InProfile(ReadProfile::Classic), tag), u"Datei nicht gefunden"_s);
    EXPECT_EQ(tag.Artist, u"ABBA"_s);
    EXPECT_EQ(tag.Title, u"Waterloo"_s);
    EXPECT_EQ(tag.FileName, path);
    EXPECT_EQ(tag.MPEGLayer, u"MPEG ??? Layer ???"_s);
}

TEST(AudioFile, WhatIsThereButCannotBeReadIsAnError) {
    const QTemporaryDir folder;
    TID3Tag tag;
    EXPECT_THROW(ReadAudioFile(folder.path(), InProfile(ReadProfile::Classic), tag), EStreamError);
    // Behind a file there is nothing.
    WriteFile(folder.filePath(u"f"_s), {});
    EXPECT_EQ(ReadAudioFile(folder.filePath(u"f/g.mp3"_s), InProfile(ReadProfile::Classic), tag),
              u"Datei nicht gefunden"_s);
    // The system would see the name of the file that is there.
    EXPECT_EQ(ReadAudioFile(folder.filePath(u"f\0g"_s), InProfile(ReadProfile::Classic), tag),
              u"Datei nicht gefunden"_s);
    BrokenMedium medium;
    EXPECT_EQ(ReadSong(medium, u"/m/x.mp3"_s, InProfile(ReadProfile::Classic)).Error, u"Lesefehler"_s);
}

TEST(AudioFile, AnOrdinarySongIsReadInBothProfiles) {
    const QTemporaryDir folder;
    const auto path = folder.filePath(u"x.mp3"_s);
    const auto tags = TitledTag("Waterloo", "ABBA").Text("TRCK", "3/12").Text("TLEN", "999000");
    WriteFile(path, Mp3Builder().Raw(tags.Build()).Frames(400).Id3v1("other", "other").Data());
    for (const auto profile : kProfiles) {
        TID3Tag tag;
        EXPECT_EQ(ReadAudioFile(path, InProfile(profile), tag), u""_s);
        EXPECT_EQ(tag.Title, u"Waterloo"_s);
        EXPECT_EQ(tag.Track, 3);
        EXPECT_EQ(tag.MPEGLayer, u"MPEG 1.0 Layer III"_s);
        EXPECT_EQ(tag.BitRate, 128);
        EXPECT_EQ(tag.Length, 10);  // what was found in the sound stands before the tag
        EXPECT_EQ(tag.FileName, path);
        EXPECT_EQ(LastMpegResults().FrameSize, 417);
        ReadAudioFile(u""_s, InProfile(profile), tag);
        EXPECT_EQ(LastMpegResults().FrameSize, -1);
    }
}

TEST(AudioFile, ATagTellsTheLengthWhereNoSoundIsFound) {
    const auto tag = TitledTag("Waterloo", "ABBA").Text("TLEN", "165000").Build();
    EXPECT_EQ(Read(Mp3Builder().Raw(tag).Noise(500).Data()).Length, 165);
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

TEST(AudioFile, WithoutAFrameTheExtensionDescribesTheFile) {
    const auto noise = Mp3Builder().Noise(1000).Data();
    const auto format = [&noise](const QString& path) {
        return Read(noise, InProfile(ReadProfile::Classic), path).MPEGLayer;
    };
    EXPECT_EQ(format(u"/m/a.MPEG"_s), u"Video (MPG)"_s);
    EXPECT_EQ(format(u"/m/a.ogg"_s), u"MPEG ??? Layer ???"_s);
    const auto song = Mp3Builder().Frames(2).Data();
    EXPECT_EQ(Read(song, InProfile(ReadProfile::Classic), u"/m/a.mpg"_s).MPEGLayer, u"MPEG 1.0 Layer III"_s);
}

TEST(AudioFile, WaveFilesAreNotSearchedForFramesAndMayCarryATrailingTag) {
    auto wave = Mp3Builder().Raw(WaveFile()).Frames(2).Data();
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
    const auto tag = TitledTag("T", "A").Frame("XRUK", RecordBody()).Build();
    const auto restored =
        Read(Mp3Builder().Noise(500).TrailingTag(tag).Data(), InProfile(ReadProfile::Classic), u"/m/a.mpg"_s);
    EXPECT_EQ(restored.MPEGLayer, u"MPEG 1.0 Layer II"_s);
    EXPECT_EQ(restored.BitRate, 192);
    EXPECT_EQ(restored.Flags, 5u);
    EXPECT_EQ(restored.Reserved, 77);
    EXPECT_EQ(restored.MainGenre, 15);
    EXPECT_TRUE(restored.Remix);
    EXPECT_EQ(restored.AddTime, 36525.5);
    EXPECT_EQ(restored.Genre, 18);  // what the main genre stands for

    const auto song = Read(Mp3Builder().Raw(tag).Frames(50).Data());
    EXPECT_EQ(song.MPEGLayer, u"MPEG 1.0 Layer III"_s);
    EXPECT_EQ(song.BitRate, 128);
    EXPECT_EQ(song.Flags, 5u);

    const auto wave = Read(Mp3Builder().Raw(WaveFile()).TrailingTag(tag).Data());
    EXPECT_EQ(wave.MPEGLayer, u"Wave"_s);
    EXPECT_EQ(wave.MainGenre, 15);
}

TEST(AudioFile, TheRemixMarkOfTheGenreIsKept) {
    const auto tag = TitledTag("T", "A").Text("TCON", "(18)Techno (RX)").Build();
    const auto song = Read(Mp3Builder().Raw(tag).Frames(2).Data());
    EXPECT_TRUE(song.Remix);
    EXPECT_EQ(song.Genre, 18);
}

TEST(AudioFile, ADamagedTagCostsOnlyItself) {
    auto tag = TitledTag("T", "A").Build();
    tag[7] = 0x7F;  // the size in the header reaches far beyond the file
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

TEST(AudioFile, TheFileTimeIsTheCallersOrNow) {
    const HandClock clock;
    const auto song = Mp3Builder().Frames(2).Data();
    EXPECT_EQ(Read(song, ReadOptions()).AddTime, clock.Day);
    EXPECT_EQ(Read(song).AddTime, 1);
}
