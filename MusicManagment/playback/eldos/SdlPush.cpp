#include "MusicManagment/playback/eldos/SdlPush.h"

#include <SDL.h>

#include <bit>

namespace {

// What the device asks for at once, a power of two: about two glides, 46 ms at 44,100 Hz.
Uint16 DeviceFrames(int rate) {
    return static_cast<Uint16>(std::bit_floor(GlideFrames(rate) * 5 / 2));
}

// A sound server drops what it has not played when the device is closed, and SDL waits for two periods only.
// The silence that is in the second of them is not missed.
constexpr int kSilenceAtEnd = 50;  // ms
// One that has hung is not waited for.
constexpr Uint32 kLongestWait = 150;  // ms

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
    queue_.Reset(rate, channels);
    silence_ = static_cast<std::size_t>(rate) * kSilenceAtEnd / 1000;
    // SDL converts when the device wants another format.
    SDL_AudioSpec wanted = {};
    wanted.freq = rate;
    wanted.format = AUDIO_S16SYS;
    wanted.channels = static_cast<Uint8>(channels);
    wanted.samples = DeviceFrames(rate);
    wanted.callback = &SdlPush::Fill;
    wanted.userdata = this;
    for (const QString& driver : drivers_) {
        if (!audio_.Acquire(driver)) continue;
        device_ = SDL_OpenAudioDevice(nullptr, 0, &wanted, nullptr, 0);
        if (device_ != 0) break;
        audio_.Release();
    }
    // From now on it asks, in a pause as well: only the queue can glide there.
    if (device_ != 0) SDL_PauseAudioDevice(device_, 0);
    return device_ != 0;
}

void SdlPush::Fill(void* self, unsigned char* target, int bytes) {
    const std::size_t samples = static_cast<std::size_t>(bytes) / sizeof(std::int16_t);
    static_cast<SdlPush*>(self)->queue_.Give({reinterpret_cast<std::int16_t*>(target), samples});
}

bool SdlPush::Queue(std::span<const std::int16_t> samples) {
    const DeviceLock lock(device_);
    queue_.Queue(samples);
    return true;
}

std::size_t SdlPush::Queued() {
    const DeviceLock lock(device_);
    return queue_.Queued() * sizeof(std::int16_t);
}

void SdlPush::Clear() {
    const DeviceLock lock(device_);
    queue_.Clear();
}

void SdlPush::SetGain(float gain) {
    const DeviceLock lock(device_);
    queue_.SetGain(gain);
}

void SdlPush::SetPaused(bool paused) {
    const DeviceLock lock(device_);
    queue_.SetPaused(paused);
}

// When its server ends SDL goes on asking for samples, and only the device's status tells.
bool SdlPush::Failed() const {
    return device_ == 0 || SDL_GetAudioDeviceStatus(device_) != SDL_AUDIO_PLAYING;
}

bool SdlPush::IsSilent() {
    const DeviceLock lock(device_);
    return queue_.WasSilent(silence_);
}

void SdlPush::AwaitSilence() {
    const Uint64 until = SDL_GetTicks64() + kLongestWait;
    while (!IsSilent() && !Failed() && SDL_GetTicks64() < until)
        SDL_Delay(1);
}

void SdlPush::Close() {
    if (device_ != 0) {
        Clear();
        AwaitSilence();
        SDL_CloseAudioDevice(device_);
    }
    device_ = 0;
    audio_.Release();
}
