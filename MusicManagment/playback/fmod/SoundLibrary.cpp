#include "MusicManagment/playback/fmod/SoundLibrary.h"

#include <algorithm>
#include <bit>

#include "CommonRUKTools/Clock.h"
#include "MusicManagment/playback/fmod/SoundLibraryImpl.h"

namespace {

constexpr float kVersion = 3.75F;
constexpr int kLowestRate = 4000;
constexpr int kHighestRate = 192000;
constexpr int kMostChannels = 1024;
constexpr std::size_t kSmallestBuffer = 64;  // frames
// ms; each attempt takes some tenths of a second. Below the five seconds in which the player asks, so that it
// meets one each time.
constexpr qint64 kReopenEvery = 4500;

}  // namespace

SoundLibrary::SoundLibrary(OutputFactory outputs) : outputs_(std::move(outputs)) {}

SoundLibrary::~SoundLibrary() {
    SoundLibrary::FSOUND_Close();
}

bool SoundLibrary::Fail(TFmodError error) {
    lastError_ = error;
    return false;
}

bool SoundLibrary::Initialised() {
    lastError_ = FMOD_ERR_NONE;
    return mixer_ != nullptr || Fail(FMOD_ERR_UNINITIALIZED);
}

bool SoundLibrary::BeforeInit() {
    lastError_ = FMOD_ERR_NONE;
    return mixer_ == nullptr || Fail(FMOD_ERR_BUSY);
}

void SoundLibrary::SetMidiFont(const QString& path) {
    midiFont_ = path;
}

void SoundLibrary::SetMasterVolume(float gain) {
    masterVolume_ = std::clamp(gain, 0.0F, 1.0F);
    if (mixer_ != nullptr) mixer_->SetMaster(masterVolume_);
}

void SoundLibrary::Advance(std::size_t frames) {
    if (output_ != nullptr) output_->Advance(frames);
}

bool SoundLibrary::OutputLost() const {
    return output_ != nullptr && output_->Failed() && !output_->Replaceable();
}

quint64 SoundLibrary::FramesPlayed() const {
    return mixer_ != nullptr ? mixer_->FramesPlayed() : 0;
}

quint64 SoundLibrary::FramesStarved() const {
    return mixer_ != nullptr ? mixer_->FramesStarved() : 0;
}

float SoundLibrary::FSOUND_GetVersion() {
    return kVersion;
}

int SoundLibrary::FSOUND_GetError() {
    return lastError_;
}

bool SoundLibrary::FSOUND_SetOutput(int outputType) {
    if (!BeforeInit()) return false;
    if (outputType < FSOUND_OUTPUT_NOSOUND || outputType > FSOUND_OUTPUT_XBOX)
        return Fail(FMOD_ERR_INVALID_PARAM);
    outputType_ = static_cast<TFSoundOutputTypes>(outputType);
    return true;
}

// Each output has its one device, and there is one mixer.
bool SoundLibrary::FSOUND_SetDriver(int driver) {
    return BeforeInit() && (driver == 0 || Fail(FMOD_ERR_INVALID_PARAM));
}

bool SoundLibrary::FSOUND_SetMixer(int mixer) {
    return BeforeInit() && (mixer == 0 || Fail(FMOD_ERR_INVALID_PARAM));
}

bool SoundLibrary::FSOUND_SetBufferSize(int milliseconds) {
    if (!BeforeInit()) return false;
    if (milliseconds <= 0 || milliseconds > 1000) return Fail(FMOD_ERR_INVALID_PARAM);
    bufferMs_ = milliseconds;
    return true;
}

// Devices want a power of two.
std::size_t SoundLibrary::BufferFrames() const {
    return std::max(kSmallestBuffer, std::bit_floor(static_cast<std::size_t>(rate_) *
                                                    static_cast<std::size_t>(bufferMs_) / 1000));
}

bool SoundLibrary::OpenOutput() {
    output_ = outputs_(outputType_);
    const auto pull = [this](float* stereo, std::size_t frames) { Render(stereo, frames); };
    if (output_ == nullptr || !output_->Open(rate_, BufferFrames(), pull)) {
        output_.reset();
        return false;
    }
    output_->Start();
    return true;
}

bool SoundLibrary::FSOUND_Init(int mixRate, int softChannels, [[maybe_unused]] unsigned flags) {
    if (!BeforeInit()) return false;
    if (mixRate < kLowestRate || mixRate > kHighestRate || softChannels < 0 || softChannels > kMostChannels)
        return Fail(FMOD_ERR_INVALID_PARAM);
    rate_ = mixRate;
    mixer_ = std::make_unique<Mixer>(static_cast<std::size_t>(softChannels), channelRounds_);
    mixer_->SetMaster(masterVolume_);
    if (OpenOutput()) return true;
    mixer_.reset();
    return Fail(FMOD_ERR_INIT);
}

void SoundLibrary::FSOUND_Close() {
    if (mixer_ != nullptr) {
        mixer_->ReleaseAll();
        channelRounds_ = mixer_->Rounds();
    }
    if (output_ != nullptr) output_->Close();
    output_.reset();
    streams_.clear();
    songs_.clear();
    mixer_.reset();
    initialisation = {};
}

// A lost device (a sound server that was restarted, a card pulled out) is opened anew when there is one
// again.
bool SoundLibrary::OutputWorks() {
    if (output_ != nullptr && (!output_->Failed() || !output_->Replaceable())) return !output_->Failed();
    const qint64 now = CurrentClock().Ticks();
    if (output_ == nullptr && now - lastReopening_ < kReopenEvery) return false;
    lastReopening_ = now;
    if (output_ != nullptr) output_->Close();
    return OpenOutput();
}

// Sounds wait for a device that can come back. Into a file that takes no more nothing plays on.
bool SoundLibrary::Sounds(int channel) {
    if (OutputWorks()) return mixer_->Playing(channel);
    Fail(FMOD_ERR_INIT);
    return output_ == nullptr && mixer_->Playing(channel);
}

// Runs in the output's thread.
void SoundLibrary::Render(float* stereo, std::size_t frames) {
    if (!output_->Unpaced()) return mixer_->Render(stereo, frames);
    for (std::size_t done = 0; done < frames;) {
        const std::size_t count = std::min(Mixer::kBlock, frames - done);
        mixer_->WaitReady(count);
        mixer_->Render(stereo + 2 * done, count);
        done += count;
    }
}

bool SoundLibrary::StartVoice(Voice& voice, float gain, bool paused) {
    if (!OutputWorks()) return Fail(FMOD_ERR_INIT);
    mixer_->Release(voice.channel);
    if (voice.ahead->Exhausted() && !Rewind(voice)) return false;
    voice.channel = mixer_->Start(*voice.ahead, gain, paused);
    return voice.channel != Mixer::kNoChannel || Fail(FMOD_ERR_CHANNEL_ALLOC);
}

bool SoundLibrary::Rewind(Voice& voice) {
    return Try([&] { voice.ahead->Seek(0); });
}

bool SoundLibrary::FSOUND_SetPaused(int channel, bool paused) {
    return Initialised() && (mixer_->SetPaused(channel, paused) || Fail(FMOD_ERR_INVALID_PARAM));
}

bool SoundLibrary::FSOUND_GetPaused(int channel) {
    return Initialised() && mixer_->Paused(channel);
}

bool SoundLibrary::FSOUND_IsPlaying(int channel) {
    return Initialised() && Sounds(channel);
}

bool SoundLibrary::FSOUND_SetVolume(int channel, int volume) {
    const float gain = static_cast<float>(std::clamp(volume, 0, 255)) / 255;
    return Initialised() && (mixer_->SetGain(channel, gain) || Fail(FMOD_ERR_INVALID_PARAM));
}

bool SoundLibrary::FSOUND_SetPan(int channel, int pan) {
    if (!Initialised()) return false;
    if (pan < FSOUND_STEREOPAN || pan > 255) return Fail(FMOD_ERR_INVALID_PARAM);
    const float right = static_cast<float>(pan) / 255;
    const bool known = pan == FSOUND_STEREOPAN ? mixer_->SetSides(channel, 1, 1)
                                               : mixer_->SetSides(channel, 1 - right, right);
    return known || Fail(FMOD_ERR_INVALID_PARAM);
}

FSOUND_DSPUNIT SoundLibrary::FSOUND_DSP_GetFFTUnit() {
    return FSOUND_DSPUNIT::kFft;
}

void SoundLibrary::FSOUND_DSP_SetActive(FSOUND_DSPUNIT unit, bool active) {
    if (unit == FSOUND_DSPUNIT::kFft) spectrumActive_ = active;
}

bool SoundLibrary::FSOUND_DSP_GetActive(FSOUND_DSPUNIT unit) {
    return unit == FSOUND_DSPUNIT::kFft && spectrumActive_;
}

const float* SoundLibrary::FSOUND_DSP_GetSpectrum() {
    static_assert(FSOUND_SPECTRUM_SIZE == Spectrum::kBands);
    if (mixer_ == nullptr || !spectrumActive_) return spectrum_.Silence();
    std::array<float, Spectrum::kFrames> heard{};
    mixer_->Heard(heard.data(), heard.size());
    return spectrum_.Of(heard);
}
