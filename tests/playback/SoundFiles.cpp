#include "tests/playback/SoundFiles.h"

#include <QFile>
#include <QFileInfo>
#include <algorithm>
#include <cmath>
#include <map>
#include <memory>
#include <numbers>
#include <stdexcept>
#include <string>

#include "tests/WaveFile.h"

extern "C" {
#include <libavcodec/avcodec.h>
#include <libavformat/avformat.h>
#include <libavutil/opt.h>
}

using namespace Qt::StringLiterals;

namespace {

constexpr double kTurn = 2 * std::numbers::pi;

int Must(int result, const char* what) {
    if (result < 0) throw std::runtime_error(what + std::string(" failed: ") + std::to_string(result));
    return result;
}

qint16 Int16(float sample) {
    return static_cast<qint16>(std::lround(sample * 32767));
}

// Encodes and writes one file; everything it needs lives as long as the object.
class Encoder {
 public:
    Encoder(const QString& path, const Encoding& encoding, int rate) {
        Must(avformat_alloc_output_context2(&format_, nullptr, encoding.format, nullptr), "format");
        const AVCodec* codec = avcodec_find_encoder_by_name(encoding.codec);
        if (codec == nullptr) throw std::runtime_error("no encoder " + std::string(encoding.codec));
        codec_ = avcodec_alloc_context3(codec);
        codec_->sample_rate = rate;
        codec_->sample_fmt = codec->sample_fmts[0];
        codec_->ch_layout = AV_CHANNEL_LAYOUT_STEREO;
        codec_->time_base = {1, rate};
        codec_->strict_std_compliance = FF_COMPLIANCE_EXPERIMENTAL;
        if (encoding.bitRate > 0) codec_->bit_rate = encoding.bitRate;
        if (encoding.bitRate == 0) {
            codec_->flags |= AV_CODEC_FLAG_QSCALE;
            codec_->global_quality = 4 * FF_QP2LAMBDA;
        }
        if ((format_->oformat->flags & AVFMT_GLOBALHEADER) != 0) codec_->flags |= AV_CODEC_FLAG_GLOBAL_HEADER;
        Must(avcodec_open2(codec_, codec, nullptr), "codec");
        stream_ = avformat_new_stream(format_, nullptr);
        stream_->time_base = codec_->time_base;
        Must(avcodec_parameters_from_context(stream_->codecpar, codec_), "parameters");
        if (encoding.pictures) AddPictures();
        Must(avio_open(&format_->pb, QFile::encodeName(path).constData(), AVIO_FLAG_WRITE), "file");
        AVDictionary* options = nullptr;
        av_dict_set(&options, "write_xing", encoding.header ? "1" : "0", 0);
        av_dict_set(&options, "id3v2_version", encoding.header ? "3" : "0", 0);
        Must(avformat_write_header(format_, &options), "header");
        av_dict_free(&options);
    }
    ~Encoder() {
        av_packet_free(&packet_);
        avcodec_free_context(&codec_);
        avio_closep(&format_->pb);
        avformat_free_context(format_);
    }
    Encoder(const Encoder&) = delete;
    Encoder& operator=(const Encoder&) = delete;

    void Write(const Samples& samples) {
        const std::size_t frames = samples.size() / 2;
        const std::size_t step = codec_->frame_size > 0 ? static_cast<std::size_t>(codec_->frame_size) : 1024;
        for (std::size_t at = 0; at < frames; at += step)
            Send(samples.data() + 2 * at, std::min(step, frames - at));
        Must(avcodec_send_frame(codec_, nullptr), "flush");
        Receive();
        Must(av_write_trailer(format_), "trailer");
    }

 private:
    static constexpr int kPictureSide = 16;  // dots

    void AddPictures() {
        pictures_ = avformat_new_stream(format_, nullptr);
        pictures_->time_base = {1, 10};
        pictures_->avg_frame_rate = {10, 1};
        AVCodecParameters& dots = *pictures_->codecpar;
        dots.codec_type = AVMEDIA_TYPE_VIDEO;
        dots.codec_id = AV_CODEC_ID_RAWVIDEO;
        dots.format = AV_PIX_FMT_BGR24;
        dots.bits_per_coded_sample = 24;
        dots.width = dots.height = kPictureSide;
    }

    // Those that are due before the sound that was encoded last.
    void WritePictures() {
        while (pictures_ != nullptr && picture_ * codec_->sample_rate < written_ * 10) {
            Must(av_new_packet(packet_, kPictureSide * kPictureSide * 3), "picture");
            std::fill_n(packet_->data, packet_->size, std::uint8_t{0x80});
            packet_->stream_index = pictures_->index;
            packet_->pts = packet_->dts = av_rescale_q(picture_++, {1, 10}, pictures_->time_base);
            packet_->duration = 1;
            packet_->flags = AV_PKT_FLAG_KEY;
            Must(av_write_frame(format_, packet_), "write");
            av_packet_unref(packet_);
        }
    }

    void Send(const float* stereo, std::size_t count) {
        AVFrame* frame = av_frame_alloc();
        frame->nb_samples = static_cast<int>(count);
        frame->format = codec_->sample_fmt;
        frame->sample_rate = codec_->sample_rate;
        frame->ch_layout = codec_->ch_layout;
        frame->pts = written_;
        written_ += frame->nb_samples;
        Must(av_frame_get_buffer(frame, 0), "frame");
        for (std::size_t i = 0; i < 2 * count; ++i)
            Store(*frame, i / 2, i % 2, stereo[i]);
        Must(avcodec_send_frame(codec_, frame), "encode");
        av_frame_free(&frame);
        WritePictures();
        Receive();
    }

    void Store(const AVFrame& frame, std::size_t at, std::size_t side, float sample) const {
        switch (codec_->sample_fmt) {
            case AV_SAMPLE_FMT_FLTP:
                reinterpret_cast<float*>(frame.data[side])[at] = sample;
                break;
            case AV_SAMPLE_FMT_S16P:
                reinterpret_cast<qint16*>(frame.data[side])[at] = Int16(sample);
                break;
            case AV_SAMPLE_FMT_S32P:
                reinterpret_cast<qint32*>(frame.data[side])[at] = Int16(sample) * 65536;
                break;
            case AV_SAMPLE_FMT_S16:
                reinterpret_cast<qint16*>(frame.data[0])[2 * at + side] = Int16(sample);
                break;
            default:
                throw std::runtime_error("an encoder wants samples of another kind");
        }
    }

    void Receive() {
        while (avcodec_receive_packet(codec_, packet_) == 0) {
            av_packet_rescale_ts(packet_, codec_->time_base, stream_->time_base);
            packet_->stream_index = 0;
            Must(av_write_frame(format_, packet_), "write");
            av_packet_unref(packet_);
        }
    }

    AVFormatContext* format_ = nullptr;
    AVCodecContext* codec_ = nullptr;
    AVStream* stream_ = nullptr;
    AVStream* pictures_ = nullptr;
    AVPacket* packet_ = av_packet_alloc();
    std::int64_t written_ = 0;
    std::int64_t picture_ = 0;
};

}  // namespace

Samples Sine(Tone tone, double seconds, int rate) {
    Samples samples(2 * static_cast<std::size_t>(std::lround(seconds * rate)));
    for (std::size_t i = 0; i < samples.size(); ++i)
        samples[i] = static_cast<float>(tone.amplitude *
                                        std::sin(kTurn * tone.frequency * static_cast<double>(i / 2) / rate));
    return samples;
}

Samples Sweep(double seconds, int rate) {
    Samples samples(2 * static_cast<std::size_t>(std::lround(seconds * rate)));
    for (std::size_t i = 0; i < samples.size(); ++i) {
        const double time = static_cast<double>(i / 2) / rate;
        samples[i] = static_cast<float>(0.4 * std::sin(kTurn * (200 * time + 50 * time * time)));
    }
    return samples;
}

void WriteBytes(const QString& path, const QByteArray& bytes) {
    QFile file(path);
    if (!file.open(QIODevice::WriteOnly) || file.write(bytes) != bytes.size())
        throw std::runtime_error("cannot write " + path.toStdString());
}

QByteArray ReadBytes(const QString& path) {
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly)) throw std::runtime_error("cannot read " + path.toStdString());
    return file.readAll();
}

void WriteWav(const QString& path, const Samples& samples, int rate, int channels) {
    const auto sides = static_cast<std::uint16_t>(channels);
    ByteWriter out = WaveHead({.Rate = static_cast<std::uint32_t>(rate), .Channels = sides, .Bits = 16},
                              static_cast<std::uint32_t>(samples.size() / 2 * sides * 2));
    for (std::size_t i = 0; i < samples.size(); i += channels == 1 ? 2 : 1)
        out.U16Le(static_cast<std::uint16_t>(Int16(samples[i])));
    WriteBytes(path, {reinterpret_cast<const char*>(out.Bytes().data()), static_cast<qsizetype>(out.Size())});
}

void WriteRaw(const QString& path, const Samples& samples) {
    WriteWav(path, samples);
    WriteBytes(path, ReadBytes(path).mid(44));
}

void Encode(const QString& path, const Samples& samples, const Encoding& encoding, int rate) {
    av_log_set_level(AV_LOG_QUIET);
    Encoder(path, encoding, rate).Write(samples);
}

void WriteSound(const QString& path, const Samples& samples) {
    static const std::map<QString, Encoding> encodings = {
        {u"mp3"_s, {.codec = "libmp3lame", .format = "mp3"}},
        {u"mp2"_s, {.codec = "mp2", .format = "mp2"}},
        {u"wma"_s, {.codec = "wmav2", .format = "asf"}},
        {u"asf"_s, {.codec = "wmav2", .format = "asf"}},
        {u"ogg"_s, {.codec = "vorbis", .format = "ogg"}},
        {u"avi"_s, {.codec = "pcm_s16le", .format = "avi", .pictures = true}}};
    const QString extension = QFileInfo(path).suffix();
    if (extension == u"wav"_s) return WriteWav(path, samples);
    if (extension == u"raw"_s) return WriteRaw(path, samples);
    Encode(path, samples, encodings.at(extension));
}

double AmplitudeOf(double frequency, const Samples& heard, std::size_t from, std::size_t frames, int side,
                   int rate) {
    double sine = 0;
    double cosine = 0;
    for (std::size_t i = 0; i < frames; ++i) {
        const double turn = kTurn * frequency * static_cast<double>(i) / rate;
        const double sample = heard.at(2 * (from + i) + static_cast<std::size_t>(side));
        sine += sample * std::sin(turn);
        cosine += sample * std::cos(turn);
    }
    return 2 * std::hypot(sine, cosine) / static_cast<double>(frames);
}

double LargestStep(const Samples& heard, std::size_t from, int side) {
    double largest = 0;
    for (std::size_t i = 2 * from + static_cast<std::size_t>(side) + 2; i < heard.size(); i += 2)
        largest = std::max(largest, std::abs(static_cast<double>(heard[i]) - heard[i - 2]));
    return largest;
}

double SteepestStep(Tone tone, int rate) {
    return tone.amplitude * 2 * std::numbers::pi * tone.frequency / rate;
}
