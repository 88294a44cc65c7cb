#include "MusicManagment/playback/fmod/SdlOutput.h"

#include <SDL.h>

#include <algorithm>

namespace {

constexpr std::size_t kMostFrames = 32768;  // SDL counts them in 16 bits

constexpr Uint64 kLongestWait = 400;  // ms; a device that has hung is not waited for

}  // namespace

// Without card and server SDL can still start a driver; only opening a device tells.
bool SdlOutput::Open(int rate, std::size_t frames, Pull pull) {
    Close();
    pull_ = std::move(pull);
    for (const QString& driver : drivers_) {
        if (!audio_.Acquire(driver)) continue;
        if (OpenDevice(rate, frames)) return true;
        audio_.Release();
    }
    return false;
}

bool SdlOutput::OpenDevice(int rate, std::size_t frames) {
    SDL_AudioSpec wanted = {};
    wanted.freq = rate;
    wanted.format = AUDIO_F32SYS;
    wanted.channels = 2;
    wanted.samples = static_cast<Uint16>(std::min(frames, kMostFrames));
    wanted.userdata = this;
    wanted.callback = [](void* self, Uint8* bytes, int size) {
        static_cast<SdlOutput*>(self)->Give(
            {reinterpret_cast<float*>(bytes), static_cast<std::size_t>(size) / sizeof(float)});
    };
    // No changes allowed: SDL converts when the device wants another format.
    device_ = SDL_OpenAudioDevice(nullptr, 0, &wanted, nullptr, 0);
    return device_ != 0;
}

void SdlOutput::Give(std::span<float> stereo) {
    pull_(stereo.data(), stereo.size() / 2);
    silent_ = std::ranges::all_of(stereo, [](float sample) { return sample == 0; });
}

// A sound server drops what it has not played when the device is closed; SDL waits for two blocks only.
// Behind the glide a block of silence is to be among them.
void SdlOutput::AwaitSilence() {
    const Uint64 until = SDL_GetTicks64() + kLongestWait;
    while (started_ && !silent_ && !Failed() && SDL_GetTicks64() < until)
        SDL_Delay(1);
}

void SdlOutput::Start() {
    if (device_ == 0) return;
    SDL_PauseAudioDevice(device_, 0);
    started_ = true;
}

void SdlOutput::Stop() {
    if (device_ == 0) return;
    SDL_PauseAudioDevice(device_, 1);
    // The callback runs under this lock; after it a running one is over.
    SDL_LockAudioDevice(device_);
    SDL_UnlockAudioDevice(device_);
    started_ = false;
}

void SdlOutput::Close() {
    AwaitSilence();
    if (device_ != 0) SDL_CloseAudioDevice(device_);
    device_ = 0;
    started_ = false;
    audio_.Release();
}

// When its server ends, SDL goes on calling back and only the device's status tells.
bool SdlOutput::Failed() const {
    return device_ != 0 && started_ && SDL_GetAudioDeviceStatus(device_) != SDL_AUDIO_PLAYING;
}
