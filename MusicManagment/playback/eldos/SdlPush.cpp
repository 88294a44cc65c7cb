#include "MusicManagment/playback/eldos/SdlPush.h"

#include <SDL.h>

namespace {

constexpr Uint16 kDeviceFrames = 2048;

// SDL converts when the device wants another format.
SDL_AudioDeviceID OpenDevice(int rate, int channels) {
    SDL_AudioSpec wanted = {};
    wanted.freq = rate;
    wanted.format = AUDIO_S16SYS;
    wanted.channels = static_cast<Uint8>(channels);
    wanted.samples = kDeviceFrames;
    return SDL_OpenAudioDevice(nullptr, 0, &wanted, nullptr, 0);
}

}  // namespace

bool SdlPush::Open(int rate, int channels) {
    Close();
    for (const QString& driver : drivers_) {
        if (!audio_.Acquire(driver)) continue;
        device_ = OpenDevice(rate, channels);
        if (device_ != 0) return true;
        audio_.Release();
    }
    return false;
}

bool SdlPush::Queue(std::span<const std::int16_t> samples) {
    return SDL_QueueAudio(device_, samples.data(), static_cast<Uint32>(samples.size_bytes())) == 0;
}

std::size_t SdlPush::Queued() {
    return SDL_GetQueuedAudioSize(device_);
}

void SdlPush::Clear() {
    SDL_ClearQueuedAudio(device_);
}

void SdlPush::SetPaused(bool paused) {
    paused_ = paused;
    SDL_PauseAudioDevice(device_, paused ? 1 : 0);
}

// When its server ends SDL goes on taking samples, and only the device's status tells.
bool SdlPush::Failed() const {
    return device_ == 0 || (!paused_ && SDL_GetAudioDeviceStatus(device_) != SDL_AUDIO_PLAYING);
}

void SdlPush::Close() {
    if (device_ != 0) SDL_CloseAudioDevice(device_);
    device_ = 0;
    paused_ = true;
    audio_.Release();
}
