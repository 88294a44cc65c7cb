#include <lame/lame.h>

#include <array>
#include <vector>

#include "MusicManagment/conversion/PartialFile.h"
#include "MusicManagment/conversion/SongEncoder.h"

using namespace Qt::StringLiterals;

namespace {

struct CloseLame {
    void operator()(lame_global_flags* lame) const { lame_close(lame); }
};

MPEG_mode ModeFor(Mp3Settings::Channels sides, bool isMono) {
    switch (sides) {
        case Mp3Settings::Channels::AsSource:
            return isMono ? MONO : JOINT_STEREO;
        case Mp3Settings::Channels::Stereo:
            return STEREO;
        case Mp3Settings::Channels::Joint:
            return JOINT_STEREO;
        case Mp3Settings::Channels::Mono:
            break;
    }
    return MONO;
}

// Whether frames of this constant bit rate are long enough for the first one to tell delay and padding: it
// takes up to 192 bytes.
bool HoldsFirstFrame(int bitRate, int sampleRate) {
    constexpr int kLongestOfIt = 192;
    const int samples = sampleRate >= 32000 ? 1152 : 576;  // MPEG-1, MPEG-2 and 2.5
    return samples / 8 * bitRate * 1000 / sampleRate >= kLongestOfIt;
}

void SetAverage(lame_global_flags* lame, int bitRate) {
    lame_set_VBR(lame, vbr_abr);
    lame_set_VBR_mean_bitrate_kbps(lame, bitRate);
}

// An average that cannot be departed from: all frames but the first have the same size.
void SetNarrowConstant(lame_global_flags* lame, int bitRate) {
    SetAverage(lame, bitRate);
    lame_set_VBR_min_bitrate_kbps(lame, bitRate);
    lame_set_VBR_max_bitrate_kbps(lame, bitRate);
    lame_set_VBR_hard_min(lame, 1);
}

void SetBits(lame_global_flags* lame, const Mp3Settings& settings, int sampleRate) {
    switch (settings.Bits) {
        case Mp3Settings::Method::Variable:
            lame_set_VBR(lame, vbr_mtrh);
            lame_set_VBR_q(lame, settings.Quality);
            break;
        case Mp3Settings::Method::Constant:
            if (!HoldsFirstFrame(settings.BitRate, sampleRate))
                return SetNarrowConstant(lame, settings.BitRate);
            lame_set_VBR(lame, vbr_off);
            lame_set_brate(lame, settings.BitRate);
            break;
        case Mp3Settings::Method::Average:
            SetAverage(lame, settings.BitRate);
            break;
    }
}

class Mp3Encoder : public SongEncoder {
 public:
    Mp3Encoder(const QString& path, const Mp3Settings& settings, const SampleKind& samples)
        : file_(path), lame_(lame_init()) {
        if (!lame_) throw std::bad_alloc();
        const MPEG_mode mode = ModeFor(settings.Sides, samples.IsMono);
        lame_set_num_channels(lame_.get(), 2);
        lame_set_mode(lame_.get(), mode);
        lame_set_in_samplerate(lame_.get(), samples.Rate);
        lame_set_out_samplerate(lame_.get(), samples.Rate);
        lame_set_quality(lame_.get(), settings.Effort);
        SetBits(lame_.get(), settings, samples.Rate);
        lame_set_write_id3tag_automatic(lame_.get(), 0);
        // The first frame, which tells the delay and the padding, so that joined tracks stay joined.
        lame_set_bWriteVbrTag(lame_.get(), 1);
        Checked(lame_init_params(lame_.get()));
        asLoud_ = 1 / lame_get_scale(lame_.get());
    }

    void Write(const float* stereo, std::size_t frames) override {
        // The bound is the library's own for what one call can give.
        encoded_.resize(frames * 5 / 4 + 7200);
        samples_.assign(stereo, stereo + 2 * frames);
        for (float& sample : samples_)
            sample *= asLoud_;
        Append(lame_encode_buffer_interleaved_ieee_float(lame_.get(), samples_.data(),
                                                         static_cast<int>(frames), encoded_.data(),
                                                         static_cast<int>(encoded_.size())));
    }

    void Finish() override {
        encoded_.resize(7200);
        Append(lame_encode_flush(lame_.get(), encoded_.data(), static_cast<int>(encoded_.size())));
        std::array<unsigned char, 2880> frame{};  // the longest there is
        const std::size_t size = lame_get_lametag_frame(lame_.get(), frame.data(), frame.size());
        if (size > 0 && size <= frame.size()) file_.Overwrite(0, ByteSpan(frame).first(size));
        file_.Finish();
    }

 private:
    static int Checked(int result) {
        if (result < 0)
            throw ERukException(u"Der MP3-Encoder lehnt diese Einstellungen ab (Fehler "_s +
                                QString::number(result) + u")."_s);
        return result;
    }
    void Append(int result) {
        file_.Append(ByteSpan(encoded_).first(static_cast<std::size_t>(Checked(result))));
    }

    FileWriter file_;
    std::unique_ptr<lame_global_flags, CloseLame> lame_;
    // What makes up for the library's own scale, which at some bit rates is quieter than the source.
    float asLoud_ = 1;
    std::vector<float> samples_;
    std::vector<unsigned char> encoded_;
};

}  // namespace

std::unique_ptr<SongEncoder> MakeMp3Encoder(const QString& path, const Mp3Settings& settings,
                                            const SampleKind& samples) {
    return std::make_unique<Mp3Encoder>(path, settings, samples);
}
