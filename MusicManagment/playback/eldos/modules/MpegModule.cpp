// ELAMP.ESP: MPEG audio, layers I to III.

#include <mpg123.h>

#include <memory>
#include <stdexcept>

#include "MusicManagment/playback/eldos/modules/ModuleTable.h"

namespace {

// Frames decoded before the target of a seek. Layer III frames borrow bits from earlier ones; in files of
// variable rate from more of them than the library's default of 4.
constexpr long kPrerollFrames = 12;

struct Deleter {
    void operator()(mpg123_handle* handle) const { mpg123_delete(handle); }
};

class MpegSound {
 public:
    explicit MpegSound(const char* fileName) : handle_(mpg123_new(nullptr, nullptr)) {
        if (!handle_) throw std::runtime_error("mpg123_new");
        Check(mpg123_param(Handle(), MPG123_ADD_FLAGS, MPG123_QUIET | MPG123_SKIP_ID3V2, 0));
        Check(mpg123_param(Handle(), MPG123_PREFRAMES, kPrerollFrames, 0));
        Check(mpg123_open(Handle(), fileName));
        KeepFormat();
        // Only a scan tells the length of files of variable rate and of truncated ones.
        Check(mpg123_scan(Handle()));
    }

    EldoSFormat Format() const { return format_; }
    std::int64_t Length() const { return std::max<std::int64_t>(mpg123_length(Handle()), 0); }

    std::int64_t Read(std::int16_t* samples, std::int64_t frames) {
        const std::size_t frameBytes = sizeof(std::int16_t) * static_cast<std::size_t>(format_.channels);
        const std::size_t wanted = static_cast<std::size_t>(frames) * frameBytes;
        std::size_t bytes = 0;
        int result = MPG123_OK;
        // The library announces the format in a step of its own, without samples.
        do {
            result = mpg123_read(Handle(), samples, wanted, &bytes);
        } while (bytes == 0 && (result == MPG123_OK || result == MPG123_NEW_FORMAT));
        if (bytes == 0 && result != MPG123_DONE) Check(result);
        return static_cast<std::int64_t>(bytes / frameBytes);
    }

    void Seek(std::int64_t frame) {
        if (mpg123_seek(Handle(), frame, SEEK_SET) < 0) Check(MPG123_ERR);
    }

 private:
    mpg123_handle* Handle() const { return handle_.get(); }

    void Check(int result) const {
        if (result == MPG123_OK) return;
        throw std::runtime_error(result == MPG123_ERR ? mpg123_strerror(Handle())
                                                      : mpg123_plain_strerror(result));
    }

    // The whole song is given out in the format of its first frame.
    void KeepFormat() {
        long rate = 0;
        int channels = 0;
        int encoding = 0;
        Check(mpg123_getformat(Handle(), &rate, &channels, &encoding));
        Check(mpg123_format_none(Handle()));
        Check(mpg123_format(Handle(), rate, channels, MPG123_ENC_SIGNED_16));
        format_ = {static_cast<std::int32_t>(rate), channels};
    }

    std::unique_ptr<mpg123_handle, Deleter> handle_;
    EldoSFormat format_ = {};
};

}  // namespace

ELDOS_EXPORT const EldoSModule* EldoSSoundModule() {
    return ModuleTable<MpegSound>::Get();
}
