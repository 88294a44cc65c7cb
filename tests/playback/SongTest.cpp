#include <gtest/gtest.h>

#include "MusicManagment/playback/fmod/FMODPlaySound.h"
#include "MusicManagment/playback/fmod/MidiFile.h"
#include "tests/PrintQt.h"
#include "tests/playback/Listening.h"
#include "tests/playback/SongFiles.h"

using namespace Qt::StringLiterals;

namespace {

class SongTest : public Listening {
 protected:
    SongTest() { Init(); }
    FMUSIC_MODULE Load(const char* name, const QByteArray& bytes) {
        WriteBytes(Path(name), bytes);
        return library.FMUSIC_LoadSong(Path(name));
    }
    // The loudest sample of either side since `from`.
    float Loudest(std::size_t from) const {
        const auto begin = heard->begin() + static_cast<std::ptrdiff_t>(2 * from);
        const auto [least, most] = std::minmax_element(begin, heard->end());
        return std::max(-*least, *most);
    }
};

TEST_F(SongTest, KindIsToldByTheContents) {
    const ModuleSong song;
    const QByteArray midi = Midi({MidiTrack().Note(0, 60, 480).End(0)});
    struct Case {
        const char* name;
        QByteArray bytes;
        int type, orders;
    };
    for (const auto& [name, bytes, type, orders] :
         {Case{"a.mod", Mod(song), FMUSIC_TYPE_MOD, 3}, Case{"a.s3m", S3m(song), FMUSIC_TYPE_S3M, 3},
          Case{"a.xm", Xm(song), FMUSIC_TYPE_XM, 3}, Case{"a.it", It(song), FMUSIC_TYPE_IT, 3},
          Case{"a.mid", midi, FMUSIC_TYPE_MIDI, 4}, Case{"a.rmi", Rmi(midi), FMUSIC_TYPE_MIDI, 4},
          Case{"midi.mp3", midi, FMUSIC_TYPE_MIDI, 4}, Case{"xm.wav", Xm(song), FMUSIC_TYPE_XM, 3}}) {
        const FMUSIC_MODULE loaded = Load(name, bytes);
        EXPECT_EQ(library.FMUSIC_GetType(loaded), type) << name;
        EXPECT_GE(library.FMUSIC_GetNumOrders(loaded), orders) << name;
        EXPECT_LE(library.FMUSIC_GetNumOrders(loaded), orders + 1) << name;  // an end marker counts
        EXPECT_EQ(library.FMUSIC_GetPatternLength(loaded, 0), type == FMUSIC_TYPE_MIDI ? 1 : 64) << name;
        library.FMUSIC_FreeSong(loaded);
        // As a stream none of them is played, whatever it is called.
        EXPECT_EQ(OpenStream(Path(name)), FSOUND_STREAM::kNone) << name;
        EXPECT_EQ(library.FSOUND_GetError(), FMOD_ERR_FILE_FORMAT) << name;
    }
}

TEST_F(SongTest, WhatIsNoSongIsRefused) {
    WriteWav(Path("a.wav"), Sine({}, 0.5));
    Encode(Path("a.mp3"), Sweep(1), {.codec = "libmp3lame", .format = "mp3"});
    WriteBytes(Path("empty.mid"), {});
    WriteBytes(Path("cut.mid"), "MThd");
    WriteBytes(Path("cut.xm"), Xm({}).left(50));
    WriteBytes(Path("riff.rmi"), QByteArray("RIFF\0\0\0\0RMID", 12));
    WriteBytes(Path("song.sgt"), QByteArray("RIFF\x20\0\0\0DMSG", 12));
    for (const char* name : {"a.wav", "a.mp3", "empty.mid", "cut.mid", "cut.xm", "riff.rmi", "song.sgt"}) {
        EXPECT_EQ(library.FMUSIC_LoadSong(Path(name)), FMUSIC_MODULE::kNone) << name;
        EXPECT_EQ(library.FSOUND_GetError(), FMOD_ERR_FILE_FORMAT) << name;
    }
    EXPECT_EQ(library.FMUSIC_LoadSong(Path("missing.mod")), FMUSIC_MODULE::kNone);
    EXPECT_EQ(library.FSOUND_GetError(), FMOD_ERR_FILE_NOTFOUND);
    library.SetMidiFont(Path("missing.sf2"));
    EXPECT_EQ(Load("a.mid", Midi({MidiTrack().Note(0, 60, 480)})), FMUSIC_MODULE::kNone);
    EXPECT_EQ(library.FSOUND_GetError(), FMOD_ERR_MEDIAPLAYER);
}

TEST_F(SongTest, OrderAndRowAreThoseThatAreHeard) {
    const FMUSIC_MODULE song = Load("a.mod", Mod({}));
    EXPECT_TRUE(library.FMUSIC_PlaySong(song));
    Hear(0.12 * 10.5);  // the decoder is half a second further
    EXPECT_EQ(library.FMUSIC_GetOrder(song), 0);
    EXPECT_NEAR(library.FMUSIC_GetRow(song), 10, 1);
    EXPECT_GT(Loudest(0), 0.1F);
    EXPECT_TRUE(library.FMUSIC_SetOrder(song, 2));
    EXPECT_EQ(library.FMUSIC_GetOrder(song), 2);
    Hear(0.12 * 3.5);
    EXPECT_NEAR(library.FMUSIC_GetRow(song), 3, 1);
    EXPECT_FALSE(library.FMUSIC_SetOrder(song, 3));
    EXPECT_FALSE(library.FMUSIC_SetOrder(song, -1));
    EXPECT_EQ(library.FMUSIC_GetOrder(song), 2);
    library.FMUSIC_StopSong(song);
    EXPECT_EQ(library.FMUSIC_GetOrder(song), 0);
    EXPECT_FALSE(library.FMUSIC_IsPlaying(song));
}

// The position of the last row would lie far before the length when the last pattern is short.
TEST_F(SongTest, EndedSongStandsAtItsLength) {
    for (const char* name : {"a.xm", "a.it", "a.mid"}) {
        const ModuleSong song{.orders = {0, 1}, .rows = {64, 8}};
        WriteBytes(Path(name), name[2] == 'x'   ? Xm(song)
                               : name[2] == 'i' ? It(song)
                                                : Midi({MidiTrack().Note(0, 60, 960)}));
        TFMODPlaySound sound(library, {.OutputType = FSOUND_OUTPUT_NOSOUND});
        library.initialisation = {true, FSOUND_OUTPUT_NOSOUND, kRate, 32};
        sound.SetBackendFile(Path(name));
        sound.Open();
        sound.Play();
        for (int i = 0; sound.GetStatus() == psPlaying && i < 200; ++i)
            Hear(0.1);
        EXPECT_EQ(sound.GetStatus(), psStopped) << name;
        EXPECT_EQ(sound.GetPosition(), sound.GetLength()) << name;
        sound.Play();
        EXPECT_EQ(sound.GetPosition(), 0U) << name;
        Hear(0.2);
        EXPECT_EQ(sound.GetStatus(), psPlaying) << name;
    }
}

TEST_F(SongTest, VolumeAndSeparation) {
    const FMUSIC_MODULE song = Load("a.mod", Mod({}));
    const auto play = [&] {
        library.FMUSIC_StopSong(song);
        Hear(0.1);  // what is left of it
        library.FMUSIC_PlaySong(song);
        const std::size_t from = HeardFrames();
        Hear(0.1);
        return from;
    };
    EXPECT_TRUE(library.FMUSIC_SetMasterVolume(song, 256));
    const float full = Loudest(play());
    library.FMUSIC_SetMasterVolume(song, 64);
    EXPECT_NEAR(Loudest(play()), full / 4, 0.01);

    // Amiga voices stand left and right; a separation of 0 brings them together.
    const auto sideDifference = [&](float separation) {
        EXPECT_TRUE(library.FMUSIC_SetPanSeperation(song, separation));
        float most = 0;
        for (std::size_t i = play(); i < HeardFrames(); ++i)
            most = std::max(most, std::abs(heard->at(2 * i) - heard->at(2 * i + 1)));
        return most;
    };
    const float wide = sideDifference(1);
    EXPECT_NEAR(sideDifference(0.15F), wide * 0.15F, wide * 0.05F);
    EXPECT_LT(sideDifference(0), wide * 0.01F);
    EXPECT_FALSE(library.FMUSIC_SetPanSeperation(song, 1.5F));
}

TEST_F(SongTest, MidiNotesSoundAtTheirTimeAlsoAfterASeek) {
    // A quarter takes 0.5 s, then 1 s. The second note begins at 3 s.
    const FMUSIC_MODULE song =
        Load("a.mid",
             Midi({MidiTrack().Program(0, 80).Note(0, 69, 240).Tempo(720, 1'000'000).Note(960, 69, 480)}));
    EXPECT_EQ(library.FMUSIC_GetNumOrders(song), (4000 + 143) / 144);
    library.FMUSIC_PlaySong(song);
    Hear(0.2);
    EXPECT_GT(Loudest(0), 0.02F);
    library.FMUSIC_SetOrder(song, 2880 / 144);
    EXPECT_EQ(library.FMUSIC_GetOrder(song), 20);
    Hear(0.05);
    std::size_t from = HeardFrames();
    Hear(0.06);
    EXPECT_LT(Loudest(from), 0.01F);
    from = HeardFrames();
    Hear(0.2);
    EXPECT_GT(Loudest(from), 0.02F);
    // The program was told on the way: the tone is that of a lead voice, not of a piano.
    EXPECT_GT(AmplitudeOf(440, *heard, from + Frames(0.05), Frames(0.1)), 0.01);
    EXPECT_EQ(library.FMUSIC_GetOrder(song), 3190 / 144);
}

ByteSpan Span(const QByteArray& bytes) {
    return AsBytes({bytes.constData(), static_cast<std::size_t>(bytes.size())});
}

TEST(MidiFileTest, TemposOfAllTracksGiveTheTimes) {
    const QByteArray file =
        Midi({MidiTrack().Tempo(0, 500'000).Tempo(960, 250'000).Tempo(480, 1'000'000).End(0),
              MidiTrack().Note(1200, 60, 480).End(0), MidiTrack().Note(240, 64, 1).End(1679)});
    const auto song = ReadMidiFile(Span(Rmi(file)));
    ASSERT_TRUE(song);
    ASSERT_EQ(song->events.size(), 4U);
    EXPECT_EQ(song->events[0].time, 250'000U);
    EXPECT_EQ(song->events[0].first, 64);
    EXPECT_EQ(song->events[2].time, 1'000'000U + 125'000U);
    EXPECT_EQ(song->events[3].time, 1'000'000U + 250'000U + 500'000U);
    EXPECT_EQ(song->length, 1'250'000U + 1'000'000U);
}

TEST(MidiFileTest, FilmTimeIgnoresTempos) {
    const MidiTrack track = MidiTrack().Tempo(0, 100'000).Note(1000, 60, 1000);
    EXPECT_EQ(ReadMidiFile(Span(Midi({track}, 0xE728)))->length, 2'000'000U);  // 25 frames of 40 ticks
    EXPECT_EQ(ReadMidiFile(Span(Midi({track}, 0xE350)))->length, 834'166U);    // 29.97 frames of 80
    EXPECT_FALSE(ReadMidiFile(Span(Midi({track}, 0xE700))));
    EXPECT_FALSE(ReadMidiFile(Span(Midi({track}, 0))));
}

TEST(MidiFileTest, DamageEndsOnlyItsTrack) {
    const MidiTrack good = MidiTrack().Note(0, 60, 480).End(0);
    for (const char* damage : {"00FF", "00FF5103", "00F07F01", "0090", "009080", "003C", "8080808000903C40",
                               "00F1", "FFFFFFFF", "00F0FFFFFF7F", "00FFFFFFFFFF"}) {
        const MidiTrack bad = MidiTrack().Note(0, 64, 100).Raw(QByteArray::fromHex(damage));
        const auto song = ReadMidiFile(Span(Midi({bad, good})));
        ASSERT_TRUE(song) << damage;
        EXPECT_GE(song->events.size(), 4U) << damage;
        EXPECT_LE(song->events.size(), 5U) << damage;  // "3C" is a byte of running status
    }
}

TEST(MidiFileTest, WhatComesAtOnceIsBounded) {
    MidiTrack track;
    for (int i = 0; i < 5000; ++i)
        track.Note(0, 60, 0);
    const auto song = ReadMidiFile(Span(Midi({track.Note(960, 64, 480)})));
    ASSERT_TRUE(song);
    EXPECT_EQ(song->events.size(), kMostMidiEvents + 2);
    EXPECT_EQ(song->length, 1'500'000U);
}

TEST(MidiFileTest, HugeTimesAreBounded) {
    MidiTrack track;
    for (int i = 0; i < 40; ++i)
        track.Tempo(0x0FFF'FFFF, 0xFF'FFFF);
    track.Note(0, 60, 1);
    const auto song = ReadMidiFile(Span(Midi({MidiTrack().Note(0, 60, 0x0FFF'FFFF), track}, 1)));
    ASSERT_TRUE(song);
    EXPECT_LE(song->length, 24ULL * 3600 * 1'000'000);
}

}  // namespace
