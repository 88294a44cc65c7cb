#include <array>
#include <cstring>
#include <vector>

#include "CommonRUKTools/ByteWriter.h"
#include "MusicManagment/conversion/PartialFile.h"
#include "MusicManagment/conversion/SongEncoder.h"

extern "C" {
#include <libavutil/channel_layout.h>
#include <libavutil/opt.h>
#include <libswresample/swresample.h>
}

using namespace Qt::StringLiterals;

namespace {

constexpr std::int64_t kMostSound = 0xFFFF'0000;  // bytes; the sizes of RIFF have 32 bits
constexpr int kWideShift = 8;                     // the 24 bits of a sample stand at the upper end of 32

struct FreeResampler {
    void operator()(SwrContext* context) const { swr_free(&context); }
};

// Floats of two sides become whole numbers of one side or two.
class SampleCutter {
 public:
    SampleCutter(const WavSettings& settings, const SampleKind& samples, bool toMono) {
        AVChannelLayout stereo = AV_CHANNEL_LAYOUT_STEREO;
        AVChannelLayout mono = AV_CHANNEL_LAYOUT_MONO;
        SwrContext* made = nullptr;
        const bool narrow = settings.Bits == 16;
        int result = swr_alloc_set_opts2(&made, toMono ? &mono : &stereo,
                                         narrow ? AV_SAMPLE_FMT_S16 : AV_SAMPLE_FMT_S32, samples.Rate,
                                         &stereo, AV_SAMPLE_FMT_FLT, samples.Rate, 0, nullptr);
        context_.reset(made);
        constexpr std::array<double, 2> kMean = {0.5, 0.5};
        if (result >= 0 && toMono) result = swr_set_matrix(made, kMean.data(), 2);
        const bool keepsAll = samples.FitsIn16Bits && (!toMono || samples.IsMono);
        if (result >= 0 && narrow && settings.Dither && !keepsAll)
            result = av_opt_set_int(made, "dither_method", SWR_DITHER_TRIANGULAR, 0);
        if (result < 0 || swr_init(made) < 0)
            throw ERukException(u"Die Samples lassen sich nicht umwandeln."_s);
    }

    // Returns how many frames stand at `target`.
    int Cut(const float* stereo, std::size_t frames, std::uint8_t* target) {
        const auto* source = reinterpret_cast<const std::uint8_t*>(stereo);
        const auto count = static_cast<int>(frames);
        return swr_convert(context_.get(), &target, count, stereo != nullptr ? &source : nullptr, count);
    }

 private:
    std::unique_ptr<SwrContext, FreeResampler> context_;
};

class WaveEncoder : public SongEncoder {
 public:
    WaveEncoder(const QString& path, const WavSettings& settings, const SampleKind& samples)
        : file_(path),
          bytes_(settings.Bits / 8),
          sides_(settings.Sides == WavSettings::Channels::Mono ||
                         (settings.Sides == WavSettings::Channels::AsSource && samples.IsMono)
                     ? 1
                     : 2),
          rate_(samples.Rate),
          cutter_(settings, samples, sides_ == 1) {
        file_.Append(Head(0).Bytes());
    }

    void Write(const float* stereo, std::size_t frames) override {
        constexpr std::size_t kWidest = 2 * sizeof(std::int32_t);
        cut_.resize(frames * kWidest);
        const int count = cutter_.Cut(stereo, frames, cut_.data());
        if (count < 0) throw ERukException(u"Die Samples lassen sich nicht umwandeln."_s);
        Append(static_cast<std::size_t>(count) * static_cast<std::size_t>(sides_));
    }

    void Finish() override {
        const std::int64_t sound = file_.Size() - static_cast<std::int64_t>(Head(0).Size());
        if (sound % 2 != 0) file_.Append(std::array<std::uint8_t, 1>{});
        file_.Overwrite(0, Head(static_cast<std::uint32_t>(sound)).Bytes());
        file_.Finish();
    }

 private:
    ByteWriter Head(std::uint32_t sound) const {
        constexpr std::uint32_t kRestOfHead = 36;
        const auto frame = static_cast<std::uint16_t>(sides_ * bytes_);
        ByteWriter head;
        head.Raw("RIFF");
        head.U32Le(kRestOfHead + sound + sound % 2);
        head.Raw("WAVEfmt ");
        head.U32Le(16);
        head.U16Le(1);  // plain samples
        head.U16Le(static_cast<std::uint16_t>(sides_));
        head.U32Le(static_cast<std::uint32_t>(rate_));
        head.U32Le(static_cast<std::uint32_t>(rate_) * frame);
        head.U16Le(frame);
        head.U16Le(static_cast<std::uint16_t>(8 * bytes_));
        head.Raw("data");
        head.U32Le(sound);
        return head;
    }

    // Samples of `cut_`, which are the machine's own, low byte first in the file.
    void Append(std::size_t samples) {
        out_.Clear();
        for (std::size_t i = 0; i < samples; ++i) {
            if (bytes_ == 2) {
                std::int16_t sample = 0;
                std::memcpy(&sample, cut_.data() + i * sizeof(sample), sizeof(sample));
                out_.U16Le(static_cast<std::uint16_t>(sample));
            } else {
                std::int32_t sample = 0;
                std::memcpy(&sample, cut_.data() + i * sizeof(sample), sizeof(sample));
                const auto wide = static_cast<std::uint32_t>(sample) >> kWideShift;
                out_.U16Le(static_cast<std::uint16_t>(wide));
                out_.U8(static_cast<std::uint8_t>(wide >> 16));
            }
        }
        if (file_.Size() + static_cast<std::int64_t>(out_.Size()) > kMostSound)
            throw EStreamError(u"Eine WAV-Datei kann nicht größer als 4 GB sein."_s);
        file_.Append(out_.Bytes());
    }

    FileWriter file_;
    const int bytes_;  // a sample
    const int sides_;
    const int rate_;
    SampleCutter cutter_;
    std::vector<std::uint8_t> cut_;
    ByteWriter out_;
};

}  // namespace

std::unique_ptr<SongEncoder> MakeWaveEncoder(const QString& path, const WavSettings& settings,
                                             const SampleKind& samples) {
    return std::make_unique<WaveEncoder>(path, settings, samples);
}
