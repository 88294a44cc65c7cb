#include "tests/playback/engines/EncodedTone.h"

extern "C" {
#include <libavcodec/avcodec.h>
#include <libavformat/avformat.h>
#include <libavutil/channel_layout.h>
}

#include <QFile>
#include <QFileInfo>
#include <algorithm>
#include <cmath>
#include <memory>
#include <numbers>
#include <stdexcept>

namespace {

constexpr int kFrames = 2 * kToneRate;

int Checked(int result) {
    if (result < 0) throw std::runtime_error("FFmpeg refuses, error " + std::to_string(result));
    return result;
}

float ToneAt(int frame) {
    const double hertz = frame < kToneRate ? kFirstTone : kSecondTone;
    return static_cast<float>(0.5 * std::sin(2 * std::numbers::pi * hertz * frame / kToneRate));
}

class ToneFile {
 public:
    explicit ToneFile(const QString& path) {
        const QString extension = QFileInfo(path).suffix();
        const bool wma = extension == QLatin1StringView("wma");
        Checked(avformat_alloc_output_context2(&container_, nullptr, wma ? "asf" : nullptr,
                                               QFile::encodeName(path).constData()));
        OpenEncoder(wma ? AV_CODEC_ID_WMAV2 : container_->oformat->audio_codec);
        Checked(avio_open(&container_->pb, QFile::encodeName(path).constData(), AVIO_FLAG_WRITE));
        Checked(avformat_write_header(container_, nullptr));
    }
    ~ToneFile() {
        avio_closep(&container_->pb);
        avformat_free_context(container_);
        avcodec_free_context(&encoder_);
        av_packet_free(&packet_);
    }
    ToneFile(const ToneFile&) = delete;
    ToneFile& operator=(const ToneFile&) = delete;

    void Write() {
        const int step = encoder_->frame_size > 0 ? encoder_->frame_size : 1024;
        for (int start = 0; start < kFrames; start += step)
            EncodeFrom(start, std::min(step, kFrames - start));
        Checked(avcodec_send_frame(encoder_, nullptr));
        WritePackets();
        Checked(av_write_trailer(container_));
    }

 private:
    void OpenEncoder(AVCodecID id) {
        const AVCodec* codec = avcodec_find_encoder(id);
        if (codec == nullptr) throw std::runtime_error("FFmpeg has no encoder for this");
        encoder_ = avcodec_alloc_context3(codec);
        encoder_->sample_fmt = codec->sample_fmts[0];
        encoder_->sample_rate = kToneRate;
        encoder_->bit_rate = 128000;
        encoder_->time_base = {1, kToneRate};
        av_channel_layout_default(&encoder_->ch_layout, 2);
        if ((container_->oformat->flags & AVFMT_GLOBALHEADER) != 0)
            encoder_->flags |= AV_CODEC_FLAG_GLOBAL_HEADER;
        Checked(avcodec_open2(encoder_, codec, nullptr));
        stream_ = avformat_new_stream(container_, nullptr);
        stream_->time_base = encoder_->time_base;
        Checked(avcodec_parameters_from_context(stream_->codecpar, encoder_));
    }

    void EncodeFrom(int start, int count) {
        AVFrame* frame = av_frame_alloc();
        const std::unique_ptr<AVFrame, void (*)(AVFrame*)> owner(frame,
                                                                 [](AVFrame* f) { av_frame_free(&f); });
        frame->nb_samples = count;
        frame->format = encoder_->sample_fmt;
        frame->sample_rate = kToneRate;
        frame->pts = start;
        Checked(av_channel_layout_copy(&frame->ch_layout, &encoder_->ch_layout));
        Checked(av_frame_get_buffer(frame, 0));
        for (int i = 0; i < count; ++i) {
            for (int channel = 0; channel < 2; ++channel)
                SetSample(*frame, i, channel, ToneAt(start + i));
        }
        Checked(avcodec_send_frame(encoder_, frame));
        WritePackets();
    }

    void SetSample(AVFrame& frame, int index, int channel, float value) const {
        const bool planar = av_sample_fmt_is_planar(encoder_->sample_fmt) != 0;
        std::uint8_t* data = frame.extended_data[planar ? channel : 0];
        const int at = planar ? index : 2 * index + channel;
        switch (av_get_packed_sample_fmt(encoder_->sample_fmt)) {
            case AV_SAMPLE_FMT_S16:
                reinterpret_cast<std::int16_t*>(data)[at] = static_cast<std::int16_t>(value * 32767);
                break;
            case AV_SAMPLE_FMT_S32:
                reinterpret_cast<std::int32_t*>(data)[at] = static_cast<std::int32_t>(value * 2147483000.0);
                break;
            case AV_SAMPLE_FMT_FLT:
                reinterpret_cast<float*>(data)[at] = value;
                break;
            default:
                throw std::runtime_error("the encoder wants another sample format");
        }
    }

    void WritePackets() {
        while (avcodec_receive_packet(encoder_, packet_) == 0) {
            av_packet_rescale_ts(packet_, encoder_->time_base, stream_->time_base);
            packet_->stream_index = stream_->index;
            Checked(av_interleaved_write_frame(container_, packet_));
        }
    }

    AVFormatContext* container_ = nullptr;
    AVCodecContext* encoder_ = nullptr;
    AVStream* stream_ = nullptr;
    AVPacket* packet_ = av_packet_alloc();
};

}  // namespace

void WriteTwoTones(const QString& path) {
    ToneFile(path).Write();
}
