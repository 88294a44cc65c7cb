#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "CommonRUKTools/ByteReader.h"

// One thing that a synthesizer is told, at its time.
struct MidiEvent {
    std::uint64_t time = 0;   // microseconds from the start
    std::uint8_t status = 0;  // 0x80 to 0xEF, or 0xF0 for a system-exclusive message
    std::uint8_t first = 0;   // data bytes, 0 to 127
    std::uint8_t second = 0;
    ByteSpan sysex;  // without the leading 0xF0 and the closing 0xF7; a part of the file
};

// A MIDI song as one series of events in the order of time.
struct MidiFile {
    std::vector<MidiEvent> events;
    std::uint64_t length = 0;  // microseconds
};

// The most events in a tenth of a second; what is more is left out. A synthesizer would need minutes for all
// that a small file can say at once.
inline constexpr std::size_t kMostMidiEvents = 1024;
inline constexpr std::uint64_t kMidiSlice = 100'000;  // microseconds

// True for a Standard MIDI File and for one in a RIFF wrapper (RMI).
bool LooksLikeMidi(ByteSpan head);

// The Standard MIDI File within an RMI file; other bytes as they are. Empty when there is none in the
// wrapper.
ByteSpan WithoutWrapper(ByteSpan file);

// Reads a Standard MIDI File (format 0 or 1) or RMI file. Damage ends the track that it is in; nothing when
// the file has no header or no events. The events point into `file`.
std::optional<MidiFile> ReadMidiFile(ByteSpan file);
