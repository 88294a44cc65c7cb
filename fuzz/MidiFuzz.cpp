// Any bytes are a MIDI file: what is read of them is in order, within the file and within its own length.
// make_midi_seeds.py writes inputs to start from.

#include <cstdlib>
#include <map>

#include "MusicManagment/playback/fmod/MidiFile.h"

namespace {

constexpr std::uint64_t kDay = 24ULL * 3600 * 1'000'000;  // microseconds

void Require(bool condition) {
    if (!condition) std::abort();
}

bool IsPartOf(ByteSpan part, ByteSpan whole) {
    return part.empty() ||
           (part.data() >= whole.data() && part.data() + part.size() <= whole.data() + whole.size());
}

void Check(const MidiFile& song, ByteSpan file) {
    Require(!song.events.empty() && song.events.size() <= file.size());
    Require(song.length <= kDay);
    std::uint64_t time = 0;
    std::map<std::uint64_t, std::size_t> slices;
    for (const MidiEvent& event : song.events) {
        Require(++slices[event.time / kMidiSlice] <= kMostMidiEvents);
        Require(event.time >= time && event.time <= song.length);
        time = event.time;
        Require(event.status >= 0x80 && event.status <= 0xF0);
        Require(event.first <= 127 && event.second <= 127);
        Require(IsPartOf(event.sysex, file) && (event.sysex.empty() || event.status == 0xF0));
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const ByteSpan file(data, size);
    const auto song = ReadMidiFile(file);
    if (song) Check(*song, file);
    return 0;
}
