// WMAMP.ESP: Windows Media Audio.

extern "C" {
#include <libavcodec/avcodec.h>
#include <libavformat/avformat.h>
#include <libavutil/channel_layout.h>
#include <libavutil/opt.h>
#include <libswresample/swresample.h>
}

#include <algorithm>
#include <array>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

#include "MusicManagment/playback/eldos/modules/ModuleTable.h"

namespace {

// Decoded and thrown away before the target of a seek, so that the decoder has settled there.
constexpr std::int64_t kPrerollMs = 200;
constexpr int kMostChannels = 8;
constexpr const char* kDecoders = "wmav1,wmav2,wmapro,wmalossless,wmavoice";

template <auto Free>
struct FreeByAddress {
    template <typename T>
    void operator()(T* object) const {
        Free(&object);
    }
};
using Container = std::unique_ptr<AVFormatContext, FreeByAddress<avformat_close_input>>;
using Decoder = std::unique_ptr<AVCodecContext, FreeByAddress<avcodec_free_context>>;
using Resampler = std::unique_ptr<SwrContext, FreeByAddress<swr_free>>;
using Packet = std::unique_ptr<AVPacket, FreeByAddress<av_packet_free>>;
using Frame = std::unique_ptr<AVFrame, FreeByAddress<av_frame_free>>;

int Checked(int result) {
    if (result >= 0) return result;
    std::array<char, AV_ERROR_MAX_STRING_SIZE> text{};
    av_strerror(result, text.data(), text.size());
    throw std::runtime_error(text.data());
}

// Only ASF, and only from a file: the library would also follow addresses that stand in one.
Container OpenContainer(const char* fileName) {
    av_log_set_level(AV_LOG_QUIET);  // errors are told the caller
    AVDictionary* options = nullptr;
    av_dict_set(&options, "protocol_whitelist", "file", 0);
    av_dict_set(&options, "format_whitelist", "asf", 0);
    av_dict_set(&options, "codec_whitelist", kDecoders, 0);
    AVFormatContext* context = nullptr;
    const std::string address = std::string("file:") + fileName;
    const int result = avformat_open_input(&context, address.c_str(), nullptr, &options);
    av_dict_free(&options);
    Checked(result);
    return Container(context);
}

class WmaSound {
 public:
    explicit WmaSound(const char* fileName) : container_(OpenContainer(fileName)) {
        if (!packet_ || !frame_) throw std::bad_alloc();
        Checked(avformat_find_stream_info(container_.get(), nullptr));
        const AVCodec* codec = nullptr;
        const int index =
            Checked(av_find_best_stream(container_.get(), AVMEDIA_TYPE_AUDIO, -1, -1, &codec, 0));
        stream_ = container_->streams[index];
        OpenDecoder(codec);
        OpenResampler();
    }

    EldoSFormat Format() const { return {rate_, channels_}; }

    std::int64_t Length() const {
        const std::int64_t microseconds = container_->duration;
        if (microseconds == AV_NOPTS_VALUE || microseconds <= 0) return 0;
        return av_rescale(microseconds, rate_, AV_TIME_BASE);
    }

    std::int64_t Read(std::int16_t* samples, std::int64_t frames) {
        const auto channels = static_cast<std::size_t>(channels_);
        while (taken_ == decoded_.size()) {
            if (!DecodeSome()) return 0;
        }
        const std::size_t count =
            std::min(static_cast<std::size_t>(frames) * channels, decoded_.size() - taken_);
        std::copy_n(decoded_.begin() + static_cast<std::ptrdiff_t>(taken_), count, samples);
        taken_ += count;
        return static_cast<std::int64_t>(count / channels);
    }

    void Seek(std::int64_t frame) {
        const std::int64_t start = std::max<std::int64_t>(frame - rate_ * kPrerollMs / 1000, 0);
        const std::int64_t stamp =
            StreamStart() + av_rescale_q(start, AVRational{1, rate_}, stream_->time_base);
        Checked(av_seek_frame(container_.get(), stream_->index, stamp, AVSEEK_FLAG_BACKWARD));
        avcodec_flush_buffers(decoder_.get());
        OpenResampler();
        decoded_.clear();
        taken_ = 0;
        drained_ = false;
        target_ = frame;
    }

 private:
    void OpenDecoder(const AVCodec* codec) {
        decoder_.reset(avcodec_alloc_context3(codec));
        if (!decoder_) throw std::bad_alloc();
        Checked(avcodec_parameters_to_context(decoder_.get(), stream_->codecpar));
        decoder_->pkt_timebase = stream_->time_base;
        // What the container was opened with holds for its own decoders only.
        Checked(av_opt_set(decoder_.get(), "codec_whitelist", kDecoders, 0));
        Checked(avcodec_open2(decoder_.get(), codec, nullptr));
        rate_ = decoder_->sample_rate;
        channels_ = decoder_->ch_layout.nb_channels;
        if (rate_ <= 0 || channels_ <= 0 || channels_ > kMostChannels) throw std::runtime_error("no format");
    }

    // Made anew at each seek: it keeps samples of its own.
    void OpenResampler() {
        SwrContext* context = nullptr;
        Checked(swr_alloc_set_opts2(&context, &decoder_->ch_layout, AV_SAMPLE_FMT_S16, rate_,
                                    &decoder_->ch_layout, decoder_->sample_fmt, rate_, 0, nullptr));
        resampler_.reset(context);
        Checked(swr_init(context));
    }

    std::int64_t StreamStart() const {
        return stream_->start_time == AV_NOPTS_VALUE ? 0 : stream_->start_time;
    }

    // Fills decoded_ with the next samples; it may stay empty. False at the end.
    bool DecodeSome() {
        decoded_.clear();
        taken_ = 0;
        const int result = avcodec_receive_frame(decoder_.get(), frame_.get());
        if (result == AVERROR_EOF) return false;
        if (result == AVERROR(EAGAIN)) return SendPacket();
        // Damaged data costs that packet.
        if (result == AVERROR_INVALIDDATA) return true;
        Checked(result);
        TakeFrame();
        return true;
    }

    bool SendPacket() {
        if (drained_) return false;
        av_packet_unref(packet_.get());
        const int result = av_read_frame(container_.get(), packet_.get());
        if (result == AVERROR_EOF) {
            drained_ = true;
            Checked(avcodec_send_packet(decoder_.get(), nullptr));
            return true;
        }
        Checked(result);
        if (packet_->stream_index != stream_->index) return true;
        const int sent = avcodec_send_packet(decoder_.get(), packet_.get());
        if (sent != AVERROR_INVALIDDATA) Checked(sent);
        return true;
    }

    void TakeFrame() {
        // Data in another format than the head promised: the resampler is not made for it.
        if (frame_->sample_rate != rate_ || frame_->ch_layout.nb_channels != channels_ ||
            frame_->format != decoder_->sample_fmt)
            throw std::runtime_error("change of format");
        const auto channels = static_cast<std::size_t>(channels_);
        decoded_.resize(static_cast<std::size_t>(frame_->nb_samples) * channels);
        auto* target = reinterpret_cast<std::uint8_t*>(decoded_.data());
        const int count =
            Checked(swr_convert(resampler_.get(), &target, frame_->nb_samples,
                                const_cast<const std::uint8_t**>(frame_->extended_data), frame_->nb_samples));
        decoded_.resize(static_cast<std::size_t>(count) * channels);
        SkipToTarget(count);
    }

    void SkipToTarget(std::int64_t count) {
        const std::int64_t stamp = frame_->best_effort_timestamp;
        if (target_ == 0 || stamp == AV_NOPTS_VALUE) return;
        const std::int64_t first =
            av_rescale_q(stamp - StreamStart(), stream_->time_base, AVRational{1, rate_});
        const std::int64_t skipped = std::clamp<std::int64_t>(target_ - first, 0, count);
        taken_ = static_cast<std::size_t>(skipped) * static_cast<std::size_t>(channels_);
        if (skipped < count) target_ = 0;
    }

    Container container_;
    Decoder decoder_;
    Resampler resampler_;
    Packet packet_{av_packet_alloc()};
    Frame frame_{av_frame_alloc()};
    AVStream* stream_ = nullptr;
    std::vector<std::int16_t> decoded_;
    std::size_t taken_ = 0;    // of decoded_
    std::int64_t target_ = 0;  // frame that a seek has asked for; 0 once it has been reached
    int rate_ = 0;
    int channels_ = 0;
    bool drained_ = false;
};

}  // namespace

ELDOS_EXPORT const EldoSModule* EldoSSoundModule() {
    return ModuleTable<WmaSound>::Get();
}
