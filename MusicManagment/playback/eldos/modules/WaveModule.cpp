// WAVMP.ESP: wave files.

#include <sndfile.h>

#include <algorithm>
#include <cmath>
#include <memory>
#include <stdexcept>
#include <vector>

#include "MusicManagment/playback/eldos/modules/ModuleTable.h"

namespace {

struct Closer {
    void operator()(SNDFILE* file) const { sf_close(file); }
};

bool IsWave(int format) {
    const int type = format & SF_FORMAT_TYPEMASK;
    return type == SF_FORMAT_WAV || type == SF_FORMAT_WAVEX || type == SF_FORMAT_RF64;
}

std::int16_t ToSample(float value) {
    const float scaled = std::clamp(value * 32768.0F, -32768.0F, 32767.0F);
    return static_cast<std::int16_t>(std::lrint(scaled));
}

class WaveSound {
 public:
    explicit WaveSound(const char* fileName) : file_(sf_open(fileName, SFM_READ, &info_)) {
        if (!file_) throw std::runtime_error(sf_strerror(nullptr));
        if (!IsWave(info_.format)) throw std::runtime_error("not a wave file");
    }

    EldoSFormat Format() const { return {info_.samplerate, info_.channels}; }
    std::int64_t Length() const { return std::max<std::int64_t>(info_.frames, 0); }

    // Through floats: files of floats may be louder than full scale and are to be clipped then, not wrapped.
    std::int64_t Read(std::int16_t* samples, std::int64_t frames) {
        const auto channels = static_cast<std::size_t>(info_.channels);
        floats_.resize(static_cast<std::size_t>(frames) * channels);
        const sf_count_t read = sf_readf_float(file_.get(), floats_.data(), frames);
        if (read < 0) throw std::runtime_error(sf_strerror(file_.get()));
        std::transform(floats_.begin(), floats_.begin() + read * info_.channels, samples, ToSample);
        return read;
    }

    void Seek(std::int64_t frame) {
        if (sf_seek(file_.get(), frame, SEEK_SET) < 0) throw std::runtime_error(sf_strerror(file_.get()));
    }

 private:
    SF_INFO info_ = {};
    std::unique_ptr<SNDFILE, Closer> file_;
    std::vector<float> floats_;
};

}  // namespace

ELDOS_EXPORT const EldoSModule* EldoSSoundModule() {
    return ModuleTable<WaveSound>::Get();
}
