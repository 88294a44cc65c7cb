#pragma once

#include <QByteArray>
#include <cstdint>
#include <span>
#include <vector>

// Small songs, made in memory.

// Orders name patterns; each pattern has its number of rows (64 where a format knows no other). A row lasts
// 120 ms. The first row of a mod's patterns plays a tone of 0.25 s, left.
struct ModuleSong {
    std::vector<std::uint8_t> orders = {0, 1, 0};
    std::vector<int> rows = {64, 64};
};
QByteArray Mod(const ModuleSong& song);
QByteArray S3m(const ModuleSong& song);
QByteArray Xm(const ModuleSong& song);
QByteArray It(const ModuleSong& song);

// Builds one MIDI track; times are ticks since the last event.
class MidiTrack {
 public:
    MidiTrack& Note(std::uint32_t wait, int key, std::uint32_t ticks);
    MidiTrack& Tempo(std::uint32_t wait, std::uint32_t microsecondsPerQuarter);
    MidiTrack& Program(std::uint32_t wait, int program);
    MidiTrack& Raw(QByteArray bytes);
    MidiTrack& End(std::uint32_t wait);
    const QByteArray& Bytes() const { return bytes_; }

 private:
    void Wait(std::uint32_t ticks);
    QByteArray bytes_;
};
QByteArray Midi(const std::vector<MidiTrack>& tracks, std::uint16_t division = 480);
// The same in the RIFF wrapper of an .rmi file.
QByteArray Rmi(const QByteArray& midi);
