#include "MusicManagment/playback/eldos/SdlPush.h"

#include <SDL.h>

#include <algorithm>
#include <cmath>

namespace {

constexpr Uint16 kDeviceFrames = 2048;

// While it lives the device asks for no samples.
class DeviceLock {
 public:
    explicit DeviceLock(SDL_AudioDeviceID device) : device_(device) { SDL_LockAudioDevice(device_); }
    ~DeviceLock() { SDL_UnlockAudioDevice(device_); }
    DeviceLock(const DeviceLock&) = delete;
    DeviceLock& operator=(const DeviceLock&) = delete;

 private:
    const SDL_AudioDeviceID device_;
};

}  // namespace

bool SdlPush::Open(int rate, int channels) {
    Close();
    // SDL converts when the device wants another format.
    SDL_AudioSpec wanted = {};
    wanted.freq = rate;
    wanted.format = AUDIO_S16SYS;
    wanted.channels = static_cast<Uint8>(channels);
    wanted.samples = kDeviceFrames;
    wanted.callback = &SdlPush::Fill;
    wanted.userdata = this;
    for (const QString& driver : drivers_) {
        if (!audio_.Acquire(driver)) continue;
        device_ = SDL_OpenAudioDevice(nullptr, 0, &wanted, nullptr, 0);
        if (device_ != 0) return true;
        audio_.Release();
    }
    return false;
}

void SdlPush::Fill(void* self, unsigned char* target, int bytes) {
    const std::size_t samples = static_cast<std::size_t>(bytes) / sizeof(std::int16_t);
    static_cast<SdlPush*>(self)->Give({reinterpret_cast<std::int16_t*>(target), samples});
}

// Silence follows what is queued. The gain glides, a jump would click.
void SdlPush::Give(std::span<std::int16_t> target) {
    const std::size_t count = std::min(target.size(), queue_.size() - given_);
    const float step = (gain_ - gainNow_) / static_cast<float>(std::max<std::size_t>(count, 1));
    for (std::size_t i = 0; i < count; ++i) {
        const float gain = gainNow_ + step * static_cast<float>(i + 1);
        target[i] = static_cast<std::int16_t>(std::lrint(static_cast<float>(queue_[given_ + i]) * gain));
    }
    std::ranges::fill(target.subspan(count), std::int16_t{0});
    given_ += count;
    gainNow_ = gain_;
}

bool SdlPush::Queue(std::span<const std::int16_t> samples) {
    const DeviceLock lock(device_);
    queue_.erase(queue_.begin(), queue_.begin() + static_cast<std::ptrdiff_t>(given_));
    given_ = 0;
    queue_.insert(queue_.end(), samples.begin(), samples.end());
    return true;
}

std::size_t SdlPush::Queued() {
    const DeviceLock lock(device_);
    return (queue_.size() - given_) * sizeof(std::int16_t);
}

void SdlPush::Clear() {
    const DeviceLock lock(device_);
    queue_.clear();
    given_ = 0;
}

void SdlPush::SetGain(float gain) {
    const DeviceLock lock(device_);
    gain_ = gain;
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
    queue_.clear();
    given_ = 0;
    audio_.Release();
}
