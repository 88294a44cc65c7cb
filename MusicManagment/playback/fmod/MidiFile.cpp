#include "MusicManagment/playback/fmod/MidiFile.h"

#include <algorithm>

namespace {

constexpr std::uint64_t kLongest = 24ULL * 3600 * 1'000'000;  // µs; a file that claims more is damaged
constexpr std::uint64_t kMostTicks = 0xFFFF'FFFF;
constexpr std::uint32_t kUsualTempo = 500'000;  // µs a quarter note, 120 a minute

constexpr std::uint8_t kSysex = 0xF0;
constexpr std::uint8_t kSysexRest = 0xF7;
constexpr std::uint8_t kMeta = 0xFF;
constexpr std::uint8_t kMetaEndOfTrack = 0x2F;
constexpr std::uint8_t kMetaTempo = 0x51;

struct TempoChange {
    std::uint64_t tick;
    std::uint32_t tempo;  // µs a quarter note, not 0
};

// While tracks are being read, the times of events are ticks.
struct Tracks {
    std::vector<MidiEvent> events;
    std::vector<TempoChange> tempos;
    std::uint64_t end = 0;  // tick
};

// A tick lasts `numerator` / `denominator` µs; with a fixed rate tempo events do not change it.
struct TickLength {
    std::uint64_t numerator = kUsualTempo;
    std::uint64_t denominator = 1;
    bool fixed = false;
};

std::optional<TickLength> TickLengthOf(std::uint16_t division) {
    if ((division & 0x8000) == 0) {
        if (division == 0) return std::nullopt;
        return TickLength{kUsualTempo, division, false};
    }
    const unsigned ticksPerFrame = division & 0xFF;
    const unsigned framesPerSecond = 256 - (division >> 8);
    if (ticksPerFrame == 0) return std::nullopt;
    // 29 stands for the 30000/1001 of NTSC.
    if (framesPerSecond == 29) return TickLength{100'100'000, 3000ULL * ticksPerFrame, true};
    return TickLength{1'000'000, std::uint64_t{framesPerSecond} * ticksPerFrame, true};
}

class TrackReader {
 public:
    TrackReader(ByteSpan track, Tracks& tracks) : reader_(track), tracks_(tracks) {}

    void Read() {
        while (!reader_.AtEnd() && ReadEvent()) {
        }
        tracks_.end = std::max(tracks_.end, tick_);
    }

 private:
    // At most four bytes of seven bits; a longer one is damage.
    std::optional<std::uint32_t> VariableLength() {
        std::uint32_t value = 0;
        for (int i = 0; i < 4; ++i) {
            const std::uint8_t byte = reader_.U8();
            if (reader_.Failed()) return std::nullopt;
            value = (value << 7) | (byte & 0x7Fu);
            if ((byte & 0x80) == 0) return value;
        }
        return std::nullopt;
    }

    // False at the end of the track and at damage.
    bool ReadEvent() {
        const auto delta = VariableLength();
        if (!delta || tick_ + *delta > kMostTicks) return false;
        std::uint8_t byte = reader_.U8();
        if (reader_.Failed()) return false;
        tick_ += *delta;
        if (byte == kMeta) return ReadMeta();
        if (byte == kSysex || byte == kSysexRest) return ReadSysex(byte);
        if (byte > kSysex) return false;
        if (byte >= 0x80) {
            running_ = byte;
            byte = reader_.U8();
        }
        return running_ != 0 && ReadChannelEvent(byte);
    }

    bool ReadChannelEvent(std::uint8_t first) {
        const std::uint8_t kind = running_ & 0xF0;
        const std::uint8_t second = kind == 0xC0 || kind == 0xD0 ? std::uint8_t{0} : reader_.U8();
        if (reader_.Failed() || first > 127 || second > 127) return false;
        tracks_.events.push_back(
            {.time = tick_, .status = running_, .first = first, .second = second, .sysex = {}});
        return true;
    }

    bool ReadMeta() {
        const std::uint8_t type = reader_.U8();
        const auto length = VariableLength();
        if (!length) return false;
        ByteReader data(reader_.Take(*length));
        if (reader_.Failed() || type == kMetaEndOfTrack) return false;
        const std::uint32_t tempo = type == kMetaTempo ? data.U24Be() : 0;
        if (tempo != 0) tracks_.tempos.push_back({tick_, tempo});
        return true;
    }

    bool ReadSysex(std::uint8_t status) {
        const auto length = VariableLength();
        if (!length) return false;
        ByteSpan data = reader_.Take(*length);
        if (reader_.Failed()) return false;
        // Messages in several pieces are rare and not put together.
        if (status != kSysex || data.empty() || data.back() != kSysexRest) return true;
        tracks_.events.push_back(
            {.time = tick_, .status = kSysex, .first = 0, .second = 0, .sysex = data.first(data.size() - 1)});
        return true;
    }

    ByteReader reader_;
    Tracks& tracks_;
    std::uint64_t tick_ = 0;
    std::uint8_t running_ = 0;
};

Tracks ReadTracks(ByteReader reader) {
    Tracks tracks;
    while (reader.Remaining() >= 8) {
        const bool isTrack = StartsWith(reader.Rest(), "MTrk");
        reader.Skip(4);
        // The last track of a file that was cut off ends early.
        const std::uint32_t size = reader.U32Be();
        const ByteSpan data = reader.Take(std::min<std::size_t>(size, reader.Remaining()));
        if (isTrack) TrackReader(data, tracks).Read();
    }
    std::ranges::stable_sort(tracks.events, {}, &MidiEvent::time);
    std::ranges::stable_sort(tracks.tempos, {}, &TempoChange::tick);
    return tracks;
}

// Turns ticks, asked for in rising order, into microseconds.
class Tempo {
 public:
    Tempo(std::vector<TempoChange> changes, TickLength length)
        : changes_(std::move(changes)), length_(length) {}

    std::uint64_t TimeAt(std::uint64_t tick) {
        while (!length_.fixed && next_ < changes_.size() && changes_[next_].tick <= tick) {
            const TempoChange change = changes_[next_++];
            time_ = Since(change.tick);
            tick_ = change.tick;
            length_.numerator = change.tempo;
        }
        return Since(tick);
    }

 private:
    // Ticks have 32 bits and tempos 24: no overflow.
    std::uint64_t Since(std::uint64_t tick) const {
        return std::min(kLongest, time_ + (tick - tick_) * length_.numerator / length_.denominator);
    }

    const std::vector<TempoChange> changes_;
    TickLength length_;
    std::size_t next_ = 0;
    std::uint64_t tick_ = 0;
    std::uint64_t time_ = 0;
};

void ThinOut(std::vector<MidiEvent>& events) {
    std::uint64_t slice = 0;
    std::size_t count = 0;
    std::erase_if(events, [&](const MidiEvent& event) {
        if (event.time / kMidiSlice != slice) count = 0;
        slice = event.time / kMidiSlice;
        return ++count > kMostMidiEvents;
    });
}

}  // namespace

bool LooksLikeMidi(ByteSpan head) {
    return StartsWith(head, "MThd") ||
           (StartsWith(head, "RIFF") && head.size() >= 12 && StartsWith(head.subspan(8), "RMID"));
}

ByteSpan WithoutWrapper(ByteSpan file) {
    if (!StartsWith(file, "RIFF")) return file;
    ByteReader reader(file);
    reader.Seek(12);
    while (reader.Remaining() >= 8) {
        const bool isData = StartsWith(reader.Rest(), "data");
        reader.Skip(4);
        const std::uint32_t size = reader.U32Le();
        if (isData) return reader.Rest().first(std::min<std::size_t>(size, reader.Remaining()));
        reader.Skip(std::size_t{size} + size % 2);
    }
    return {};
}

std::optional<MidiFile> ReadMidiFile(ByteSpan file) {
    const ByteSpan midi = WithoutWrapper(file);
    if (!StartsWith(midi, "MThd")) return std::nullopt;
    ByteReader reader(midi);
    reader.Skip(4);
    const std::uint32_t headerSize = reader.U32Be();
    ByteReader header(reader.Take(headerSize));
    header.Skip(4);
    const auto tickLength = TickLengthOf(header.U16Be());
    if (header.Failed() || !tickLength) return std::nullopt;

    Tracks tracks = ReadTracks(reader);
    if (tracks.events.empty()) return std::nullopt;
    MidiFile song{std::move(tracks.events), 0};
    Tempo tempo(std::move(tracks.tempos), *tickLength);
    for (MidiEvent& event : song.events)
        event.time = tempo.TimeAt(event.time);
    ThinOut(song.events);
    song.length = tempo.TimeAt(tracks.end);
    return song;
}
