#include "MusicManagment/playback/fmod/FFmpegSource.h"

#include <algorithm>
#include <array>

#include "MusicManagment/playback/backend/SoundLimits.h"

extern "C" {
#include <libavutil/channel_layout.h>
#include <libavutil/frame.h>
#include <libavutil/mathematics.h>
#include <libswresample/swresample.h>
}

namespace {

// Where decoding starts before the place that is sought, one after the other while the file leads too far:
// frames of MPEG sound lean on those before them, in the lowest of variable bit rates on a dozen and more.
constexpr std::array kMarginsMs = {600, 2400, 9600};
constexpr int kToleranceMs = 5;
constexpr int kMostFrameSamples = 1 << 20;

}  // namespace

void FFmpegSource::ResamplerDeleter::operator()(SwrContext* context) const {
    swr_free(&context);
}

FFmpegSource::FFmpegSource(const QString& path, FFmpegFile::LengthBy lengthBy, int rate)
    : FFmpegSource(path, lengthBy, [rate](int) { return rate; }) {}

FFmpegSource::FFmpegSource(const QString& path, FFmpegFile::LengthBy lengthBy,
                           const std::function<int(int fileRate)>& rateFor)
    : file_(path, lengthBy), rate_(rateFor(file_.Rate())) {
    length_ = static_cast<std::uint64_t>(ToMixRate(file_.Length()));
}

FFmpegSource::~FFmpegSource() = default;

std::int64_t FFmpegSource::ToMixRate(std::int64_t samples) const {
    return av_rescale(samples, rate_, file_.Rate());
}

void FFmpegSource::PrepareResampler(const AVFrame& frame) {
    const Input input = {frame.format, frame.sample_rate, frame.ch_layout.nb_channels};
    if (resampler_ != nullptr && input == input_) return;
    if (!IsSoundFormat(input.rate, input.channels)) throw ESoundFileError(FMOD_ERR_FILE_FORMAT);
    if (resampler_ != nullptr) Convert(nullptr);
    AVChannelLayout from = {};
    if (frame.ch_layout.order == AV_CHANNEL_ORDER_UNSPEC)
        av_channel_layout_default(&from, frame.ch_layout.nb_channels);
    else
        av_channel_layout_copy(&from, &frame.ch_layout);
    AVChannelLayout stereo = AV_CHANNEL_LAYOUT_STEREO;
    SwrContext* made = nullptr;
    const int result =
        swr_alloc_set_opts2(&made, &stereo, AV_SAMPLE_FMT_FLT, rate_, &from,
                            static_cast<AVSampleFormat>(frame.format), frame.sample_rate, 0, nullptr);
    av_channel_layout_uninit(&from);
    resampler_.reset(made);
    // Mono goes to both sides as it is; the resampler would halve its power.
    constexpr std::array<double, 2> kBothSides = {1, 1};
    if (result >= 0 && input.channels == 1) swr_set_matrix(made, kBothSides.data(), 1);
    if (result < 0 || swr_init(made) < 0) throw ESoundFileError(FMOD_ERR_FILE_FORMAT);
    input_ = input;
}

// Appends a frame's sound to the decoded one, or with nullptr what the resampler still holds back.
void FFmpegSource::Convert(const AVFrame* frame) {
    const int samples = frame != nullptr ? frame->nb_samples : 0;
    if (samples < 0 || samples > kMostFrameSamples) return;
    const int most = swr_get_out_samples(resampler_.get(), samples);
    if (most <= 0) return;
    const std::size_t before = decoded_.size();
    decoded_.resize(before + 2 * static_cast<std::size_t>(most));
    auto* target = reinterpret_cast<std::uint8_t*>(decoded_.data() + before);
    const auto** source = frame != nullptr ? const_cast<const std::uint8_t**>(frame->extended_data) : nullptr;
    const int made = swr_convert(resampler_.get(), &target, most, source, samples);
    decoded_.resize(before + 2 * static_cast<std::size_t>(std::max(0, made)));
}

// Gets new decoded frames; false when there are no more.
bool FFmpegSource::Fill() {
    decoded_.clear();
    read_ = 0;
    while (decoded_.empty() && !ended_) {
        if (const AVFrame* frame = file_.Next()) {
            PrepareResampler(*frame);
            Convert(frame);
        } else {
            ended_ = true;
            if (resampler_ != nullptr) Convert(nullptr);
        }
        const std::size_t skipped = std::min(skip_, decoded_.size() / 2);
        decoded_.erase(decoded_.begin(), decoded_.begin() + static_cast<std::ptrdiff_t>(2 * skipped));
        skip_ -= skipped;
    }
    return !decoded_.empty();
}

std::size_t FFmpegSource::Read(float* stereo, std::size_t frames) {
    std::size_t done = 0;
    while (done < frames) {
        if (read_ == decoded_.size() && !Fill()) break;
        const std::size_t count = std::min(frames - done, (decoded_.size() - read_) / 2);
        std::copy_n(decoded_.data() + read_, 2 * count, stereo + 2 * done);
        read_ += 2 * count;
        done += count;
    }
    return done;
}

// Decodes from a margin before the sample. Returns the first sample decoded, -1 when there is none.
std::int64_t FFmpegSource::LandBefore(std::int64_t sample, std::int64_t margin) {
    resampler_.reset();
    decoded_.clear();
    read_ = 0;
    skip_ = 0;
    ended_ = false;
    if (!file_.SeekBefore(std::max<std::int64_t>(0, sample - margin)))
        throw ESoundFileError(FMOD_ERR_FILE_BAD);
    const AVFrame* first = file_.Next();
    if (first == nullptr) return -1;
    const std::int64_t landed = file_.SampleOf(*first);
    PrepareResampler(*first);
    Convert(first);
    return landed < 0 ? sample : landed;
}

std::uint64_t FFmpegSource::Seek(std::uint64_t frame) {
    const auto wanted = static_cast<std::int64_t>(std::min(frame, length_));
    const std::int64_t sample = av_rescale(wanted, file_.Rate(), rate_);
    const std::int64_t tolerance = std::int64_t{file_.Rate()} * kToleranceMs / 1000;
    std::int64_t landed = -1;
    for (const int margin : kMarginsMs) {
        landed = LandBefore(sample, std::int64_t{file_.Rate()} * margin / 1000);
        if (landed >= 0 && landed <= sample + tolerance) break;
    }
    if (landed < 0) {
        ended_ = true;
        return static_cast<std::uint64_t>(wanted);
    }
    const std::int64_t start = ToMixRate(landed);
    const std::size_t skip = start < wanted ? static_cast<std::size_t>(wanted - start) : 0;
    const std::size_t skipped = std::min(skip, decoded_.size() / 2);
    read_ = 2 * skipped;
    skip_ = skip - skipped;
    return static_cast<std::uint64_t>(std::max(start, wanted));
}
