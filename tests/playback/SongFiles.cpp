#include "tests/playback/SongFiles.h"

#include <algorithm>

#include "CommonRUKTools/ByteWriter.h"

namespace {

constexpr std::uint8_t kNoOrder = 255;

QByteArray Bytes(const ByteWriter& out) {
    return {reinterpret_cast<const char*>(out.Bytes().data()), static_cast<qsizetype>(out.Size())};
}

std::uint16_t U16(std::size_t value) {
    return static_cast<std::uint16_t>(value);
}

}  // namespace

QByteArray Mod(const ModuleSong& song) {
    constexpr std::uint16_t kSampleWords = 1024;
    ByteWriter out;
    out.Block("song", 20);
    for (int sample = 0; sample < 31; ++sample) {
        out.Block("", 22);
        out.U16Be(sample == 0 ? kSampleWords : 0);
        out.U8(0);
        out.U8(sample == 0 ? 64 : 0);
        out.U16Be(0);
        out.U16Be(1);
    }
    out.U8(static_cast<std::uint8_t>(song.orders.size()));
    out.U8(127);
    for (std::size_t i = 0; i < 128; ++i)
        out.U8(i < song.orders.size() ? song.orders[i] : std::uint8_t{0});
    out.Raw("M.K.");
    for (std::size_t pattern = 0; pattern < song.rows.size(); ++pattern) {
        out.U32Be(0x01AC'1000);  // sample 1 at period 428 on the first channel
        out.Zeros(1024 - 4);
    }
    for (int i = 0; i < 2 * kSampleWords; ++i)
        out.U8(static_cast<std::uint8_t>(i % 16 < 8 ? 100 : -100));
    return Bytes(out);
}

QByteArray S3m(const ModuleSong& song) {
    ByteWriter out;
    out.Block("song", 28);
    out.U8(0x1A);
    out.U8(16);
    out.U16Le(0);
    const std::size_t orders = song.orders.size() + song.orders.size() % 2;
    for (const std::size_t value : {orders, std::size_t{0}, song.rows.size(), std::size_t{0}})
        out.U16Le(U16(value));
    out.U16Le(0x1320);
    out.U16Le(2);
    out.Raw("SCRM");
    for (const int value : {64, 6, 125, 0xB0, 0, 0})
        out.U8(static_cast<std::uint8_t>(value));
    out.Zeros(10);
    for (int channel = 0; channel < 32; ++channel)
        out.U8(channel < 2 ? static_cast<std::uint8_t>(channel * 8) : std::uint8_t{255});
    for (std::size_t i = 0; i < orders; ++i)
        out.U8(i < song.orders.size() ? song.orders[i] : kNoOrder);
    for (std::size_t i = 0; i < song.rows.size(); ++i)
        out.U16Le(0);  // empty patterns
    return Bytes(out);
}

QByteArray Xm(const ModuleSong& song) {
    ByteWriter out;
    out.Raw("Extended Module: ");
    out.Block("song", 20);
    out.U8(0x1A);
    out.Block("test", 20);
    out.U16Le(0x0104);
    out.U32Le(276);
    for (const std::size_t value : {song.orders.size(), std::size_t{0}, std::size_t{2}, song.rows.size(),
                                    std::size_t{0}, std::size_t{1}, std::size_t{6}, std::size_t{125}})
        out.U16Le(U16(value));
    for (std::size_t i = 0; i < 256; ++i)
        out.U8(i < song.orders.size() ? song.orders[i] : std::uint8_t{0});
    for (const int rows : song.rows) {
        out.U32Le(9);
        out.U8(0);
        out.U16Le(U16(static_cast<std::size_t>(rows)));
        out.U16Le(0);
    }
    return Bytes(out);
}

QByteArray It(const ModuleSong& song) {
    ByteWriter out;
    out.Raw("IMPM");
    out.Block("song", 26);
    out.U16Le(0x1004);
    const std::size_t orders = song.orders.size() + 1;
    for (const std::size_t value : {orders, std::size_t{0}, std::size_t{0}, song.rows.size()})
        out.U16Le(U16(value));
    for (const int value : {0x0214, 0x0200, 1, 0})
        out.U16Le(static_cast<std::uint16_t>(value));
    for (const int value : {128, 48, 6, 125, 128, 0})
        out.U8(static_cast<std::uint8_t>(value));
    out.Zeros(10);
    for (int channel = 0; channel < 128; ++channel)
        out.U8(channel < 64 ? 32 : 64);
    for (const std::uint8_t order : song.orders)
        out.U8(order);
    out.U8(kNoOrder);
    std::size_t offset = out.Size() + 4 * song.rows.size();
    for (const int rows : song.rows) {
        out.U32Le(static_cast<std::uint32_t>(offset));
        offset += 8 + static_cast<std::size_t>(rows);
    }
    for (const int rows : song.rows) {
        out.U16Le(U16(static_cast<std::size_t>(rows)));
        out.U16Le(U16(static_cast<std::size_t>(rows)));
        out.Zeros(4 + static_cast<std::size_t>(rows));
    }
    return Bytes(out);
}

void MidiTrack::Wait(std::uint32_t ticks) {
    for (int shift = 21; shift >= 0; shift -= 7) {
        const std::uint32_t rest = ticks >> shift;
        if (rest != 0 || shift == 0) bytes_ += static_cast<char>((rest & 0x7F) | (shift > 0 ? 0x80 : 0));
    }
}

MidiTrack& MidiTrack::Note(std::uint32_t wait, int key, std::uint32_t ticks) {
    Wait(wait);
    bytes_ += static_cast<char>(0x90);
    bytes_ += static_cast<char>(key);
    bytes_ += static_cast<char>(100);
    Wait(ticks);  // running status
    bytes_ += static_cast<char>(key);
    bytes_ += '\0';
    return *this;
}

MidiTrack& MidiTrack::Tempo(std::uint32_t wait, std::uint32_t microsecondsPerQuarter) {
    Wait(wait);
    bytes_ += QByteArray::fromHex("FF5103");
    for (int shift = 16; shift >= 0; shift -= 8)
        bytes_ += static_cast<char>(microsecondsPerQuarter >> shift);
    return *this;
}

MidiTrack& MidiTrack::Program(std::uint32_t wait, int program) {
    Wait(wait);
    bytes_ += static_cast<char>(0xC0);
    bytes_ += static_cast<char>(program);
    return *this;
}

MidiTrack& MidiTrack::Raw(QByteArray bytes) {
    bytes_ += bytes;
    return *this;
}

MidiTrack& MidiTrack::End(std::uint32_t wait) {
    Wait(wait);
    return Raw(QByteArray::fromHex("FF2F00"));
}

QByteArray Midi(const std::vector<MidiTrack>& tracks, std::uint16_t division) {
    ByteWriter out;
    out.Raw("MThd");
    out.U32Be(6);
    out.U16Be(tracks.size() > 1 ? 1 : 0);
    out.U16Be(U16(tracks.size()));
    out.U16Be(division);
    for (const MidiTrack& track : tracks) {
        out.Raw("MTrk");
        out.U32Be(static_cast<std::uint32_t>(track.Bytes().size()));
        out.Raw(std::string_view(track.Bytes().constData(), static_cast<std::size_t>(track.Bytes().size())));
    }
    return Bytes(out);
}

QByteArray Rmi(const QByteArray& midi) {
    ByteWriter out;
    const auto size = static_cast<std::uint32_t>(midi.size());
    out.Raw("RIFF");
    out.U32Le(size + 12 + 12 + size % 2);
    out.Raw("RMIDLIST");
    out.U32Le(3);
    out.Raw(std::string_view("abc\0", 4));  // a chunk of odd size in front
    out.Raw("data");
    out.U32Le(size);
    out.Raw(std::string_view(midi.constData(), size));
    out.Zeros(size % 2);
    return Bytes(out);
}
