#include "MusicManagment/playback/fmod/MidiSource.h"

#include <fluidsynth.h>

#include <QFile>
#include <algorithm>
#include <array>
#include <bitset>

#include "MusicManagment/playback/fmod/MidiFile.h"

namespace {

constexpr int kOrderMs = 144;
constexpr int kTailMs = 300;  // notes that still sound at the end fade within this
constexpr int kFramesAtOnce = 512;
constexpr double kGain = 0.4;  // the library's own 0.2 is far below the level of recorded music
// Small, good enough and on every system that has the library.
constexpr const char* kUsualFont = "/usr/share/sounds/sf2/TimGM6mb.sf2";

struct Delete {
    void operator()(fluid_settings_t* settings) const { delete_fluid_settings(settings); }
    void operator()(fluid_synth_t* synth) const { delete_fluid_synth(synth); }
};

void SilenceLibrary() {
    for (const int level : {FLUID_ERR, FLUID_WARN, FLUID_INFO, FLUID_DBG})
        fluid_set_log_function(level, nullptr, nullptr);
}

QByteArray FontOf(fluid_settings_t* settings, const QString& font) {
    if (!font.isEmpty()) return QFile::encodeName(font);
    if (QFile::exists(QString::fromLatin1(kUsualFont))) return kUsualFont;
    char* named = nullptr;
    fluid_settings_dupstr(settings, "synth.default-soundfont", &named);
    QByteArray result(named);
    fluid_free(named);
    return result;
}

// Which of the events before a place still count there, asked from the last to the first: of controllers,
// programs, bends and pressures the last of each. What depends on the order (banks, parameters by number,
// system-exclusive messages) counts as well, up to a bound.
class Shaping {
 public:
    bool Counts(const MidiEvent& event) {
        const unsigned kind = event.status & 0xF0U;
        if (kind == 0x80 || kind == 0x90) return false;
        const bool isController = kind == 0xB0;
        if (kind == 0xF0 || (isController && NeedsOrder(event.first))) return ++inOrder_ <= kMostInOrder;
        const unsigned which = isController || kind == 0xA0 ? event.first : 0U;
        const std::size_t place = (event.status & 0x7FU) * 128U + which;
        if (told_.test(place)) return false;
        told_.set(place);
        return true;
    }

 private:
    static constexpr int kMostInOrder = 1024;

    static bool NeedsOrder(std::uint8_t controller) {
        return controller == 0 || controller == 32 || controller == 6 || controller == 38 ||
               (controller >= 96 && controller <= 101);
    }

    std::bitset<std::size_t{128} * 128> told_;  // by status and first data byte
    int inOrder_ = 0;
};

class MidiSong : public SongSource {
 public:
    MidiSong(const QByteArray& file, int rate, const QString& font) : bytes_(file), rate_(rate) {
        const auto song = ReadMidiFile({reinterpret_cast<const std::uint8_t*>(bytes_.constData()),
                                        static_cast<std::size_t>(bytes_.size())});
        if (!song) throw ESoundFileError(FMOD_ERR_FILE_FORMAT);
        song_ = *song;
        length_ = FrameAt(song_.length);
        MakeSynth(font);
    }

    std::size_t Read(float* stereo, std::size_t frames) override;
    std::uint64_t Seek(std::uint64_t frame) override;
    std::uint64_t SeekOrder(int order) override { return Seek(FirstFrameOf(order)); }
    std::uint64_t Length() const override { return length_; }
    FMUSIC_TYPES Type() const override { return FMUSIC_TYPE_MIDI; }
    int Orders() const override { return static_cast<int>((song_.length / 1000 + kOrderMs - 1) / kOrderMs); }
    int PatternRows(int) const override { return 1; }
    SongPlace Place() const override {
        const std::uint64_t ms = frame_ * 1000 / static_cast<std::uint64_t>(rate_);
        return {frame_ >= length_ ? Orders() : static_cast<int>(ms / kOrderMs), 0};
    }
    void SetSeparation(float) override {}

 private:
    std::uint64_t FrameAt(std::uint64_t microseconds) const {
        return microseconds * static_cast<std::uint64_t>(rate_) / 1'000'000;
    }
    // The frame before it still counts as the order before.
    std::uint64_t FirstFrameOf(int order) const {
        return (static_cast<std::uint64_t>(order) * kOrderMs * static_cast<std::uint64_t>(rate_) + 999) /
               1000;
    }
    std::uint64_t End() const { return length_ + static_cast<std::uint64_t>(rate_) * kTailMs / 1000; }
    void Silence();
    void MakeSynth(const QString& font);
    void Tell(const MidiEvent& event);
    void FadeTail(float* stereo, std::size_t frames) const;

    const QByteArray bytes_;  // the song points into it
    const int rate_;
    MidiFile song_;
    std::uint64_t length_ = 0;
    std::unique_ptr<fluid_settings_t, Delete> settings_;
    std::unique_ptr<fluid_synth_t, Delete> synth_;
    std::uint64_t frame_ = 0;  // the next one
    std::size_t next_ = 0;     // of the events
};

void MidiSong::MakeSynth(const QString& font) {
    SilenceLibrary();
    settings_.reset(new_fluid_settings());
    if (settings_ == nullptr) throw ESoundFileError(FMOD_ERR_MEMORY);
    fluid_settings_setnum(settings_.get(), "synth.sample-rate", rate_);
    fluid_settings_setnum(settings_.get(), "synth.gain", kGain);
    fluid_settings_setint(settings_.get(), "synth.lock-memory", 0);
    fluid_settings_setint(settings_.get(), "synth.dynamic-sample-loading", 1);
    fluid_settings_setint(settings_.get(), "synth.threadsafe-api", 0);
    synth_.reset(new_fluid_synth(settings_.get()));
    if (synth_ == nullptr) throw ESoundFileError(FMOD_ERR_MEMORY);
    if (fluid_synth_sfload(synth_.get(), FontOf(settings_.get(), font).constData(), 1) == FLUID_FAILED)
        throw ESoundFileError(FMOD_ERR_MEDIAPLAYER);
}

void MidiSong::Tell(const MidiEvent& event) {
    const int channel = event.status & 0x0F;
    fluid_synth_t* synth = synth_.get();
    switch (event.status & 0xF0) {
        case 0x80:
            fluid_synth_noteoff(synth, channel, event.first);
            break;
        case 0x90:  // one without velocity ends a note, as the synthesizer knows
            fluid_synth_noteon(synth, channel, event.first, event.second);
            break;
        case 0xA0:
            fluid_synth_key_pressure(synth, channel, event.first, event.second);
            break;
        case 0xB0:
            fluid_synth_cc(synth, channel, event.first, event.second);
            break;
        case 0xC0:
            fluid_synth_program_change(synth, channel, event.first);
            break;
        case 0xD0:
            fluid_synth_channel_pressure(synth, channel, event.first);
            break;
        case 0xE0:
            fluid_synth_pitch_bend(synth, channel, event.second * 128 + event.first);
            break;
        default:
            fluid_synth_sysex(synth, reinterpret_cast<const char*>(event.sysex.data()),
                              static_cast<int>(event.sysex.size()), nullptr, nullptr, nullptr, 0);
    }
}

// A reset leaves voices and reverberation to die away within some tenths of a second.
void MidiSong::Silence() {
    fluid_synth_system_reset(synth_.get());
    std::array<float, 2 * kFramesAtOnce> lost{};
    for (int frames = rate_ * kTailMs / 1000; frames > 0; frames -= kFramesAtOnce)
        fluid_synth_write_float(synth_.get(), kFramesAtOnce, lost.data(), 0, 2, lost.data(), 1, 2);
}

// Notes that began before the place stay silent; everything that shapes the later ones is told.
std::uint64_t MidiSong::Seek(std::uint64_t frame) {
    frame_ = std::min(frame, length_);
    Silence();
    next_ = static_cast<std::size_t>(
        std::ranges::lower_bound(song_.events, frame_, {},
                                 [this](const MidiEvent& event) { return FrameAt(event.time); }) -
        song_.events.begin());
    Shaping shaping;
    std::vector<const MidiEvent*> counting;
    for (std::size_t i = next_; i > 0; --i)
        if (shaping.Counts(song_.events[i - 1])) counting.push_back(&song_.events[i - 1]);
    while (!counting.empty()) {
        Tell(*counting.back());
        counting.pop_back();
    }
    return frame_;
}

std::size_t MidiSong::Read(float* stereo, std::size_t frames) {
    const auto count = static_cast<std::size_t>(std::min<std::uint64_t>(frames, End() - frame_));
    for (std::size_t done = 0; done < count;) {
        while (next_ < song_.events.size() && FrameAt(song_.events[next_].time) <= frame_)
            Tell(song_.events[next_++]);
        std::size_t step = count - done;
        if (next_ < song_.events.size())
            step = static_cast<std::size_t>(
                std::min<std::uint64_t>(step, FrameAt(song_.events[next_].time) - frame_));
        float* target = stereo + 2 * done;
        fluid_synth_write_float(synth_.get(), static_cast<int>(step), target, 0, 2, target, 1, 2);
        FadeTail(target, step);
        frame_ += step;
        done += step;
    }
    return count;
}

// Call before frame_ moves on.
void MidiSong::FadeTail(float* stereo, std::size_t frames) const {
    if (frame_ + frames <= length_) return;
    const float tail = static_cast<float>(End() - length_);
    for (std::size_t i = 0; i < frames; ++i) {
        const std::uint64_t at = frame_ + i;
        if (at < length_) continue;
        const float gain = static_cast<float>(End() - at) / tail;
        stereo[2 * i] *= gain;
        stereo[2 * i + 1] *= gain;
    }
}

}  // namespace

std::unique_ptr<SongSource> LoadMidiSong(const QByteArray& file, int rate, const QString& font) {
    return std::make_unique<MidiSong>(file, rate, font);
}
