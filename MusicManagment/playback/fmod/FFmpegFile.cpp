#include "MusicManagment/playback/fmod/FFmpegFile.h"

#include <QFile>
#include <QFileInfo>
#include <algorithm>
#include <utility>

#include "CommonRUKTools/ByteReader.h"
#include "MusicManagment/playback/backend/SoundLimits.h"
#include "MusicManagment/playback/fmod/SoundSource.h"

extern "C" {
#include <libavcodec/avcodec.h>
#include <libavformat/avformat.h>
#include <libavutil/log.h>
}

using namespace Qt::StringLiterals;

namespace {

// What may be inside, whatever a file is called. Formats that lead to other files are not among it.
constexpr const char* kFormats = "mp3,wav,w64,asf,asf_o,ogg,s16le";
// Those that the formats are written with. The libraries have some hundred more, which only a hostile file
// would name.
constexpr const char* kDecoders =
    "mp3float,mp3,mp2float,mp2,mp1float,mp1,wmav1,wmav2,wmapro,wmalossless,wmavoice,vorbis,libvorbis,opus,"
    "libopus,"
    "flac,aac,ac3,pcm_u8,pcm_s16le,pcm_s24le,pcm_s32le,pcm_f32le,pcm_f64le,pcm_alaw,pcm_mulaw,adpcm_ms,"
    "adpcm_ima_wav,gsm_ms";
constexpr std::int64_t kSmallFile = 4 << 20;  // bytes
constexpr int kMostBadReads = 100;            // in a row

TFmodError CodeOf(int error) {
    switch (error) {
        case AVERROR(ENOENT):
            return FMOD_ERR_FILE_NOTFOUND;
        case AVERROR(ENOMEM):
            return FMOD_ERR_MEMORY;
        case AVERROR_DECODER_NOT_FOUND:
            return FMOD_ERR_MEDIAPLAYER;
        case AVERROR_INVALIDDATA:
        case AVERROR_EOF:
        case AVERROR_STREAM_NOT_FOUND:
        case AVERROR_PATCHWELCOME:
        case AVERROR(EINVAL):
            return FMOD_ERR_FILE_FORMAT;
        default:
            return FMOD_ERR_FILE_BAD;
    }
}

int Checked(int result) {
    if (result < 0) throw ESoundFileError(CodeOf(result));
    return result;
}

template <typename T>
T* Checked(T* made) {
    if (made == nullptr) throw ESoundFileError(FMOD_ERR_MEMORY);
    return made;
}

class Options {
 public:
    ~Options() { av_dict_free(&dictionary_); }
    void Set(const char* name, const char* value) { Checked(av_dict_set(&dictionary_, name, value, 0)); }
    AVDictionary** Get() { return &dictionary_; }

 private:
    AVDictionary* dictionary_ = nullptr;
};

// How many samples of a packet are part of the sound. What an encoder added behind it stands beside the
// packet; where frames have no size of their own (Vorbis) the duration leaves it out already.
std::int64_t SamplesOf(const AVPacket& packet, std::int64_t duration, int frameSize) {
    std::size_t size = 0;
    const std::uint8_t* data = av_packet_get_side_data(&packet, AV_PKT_DATA_SKIP_SAMPLES, &size);
    if (data == nullptr || frameSize <= 0) return duration;
    ByteReader reader({data, size});
    reader.Skip(4);
    return std::min(duration, frameSize - std::int64_t{reader.U32Le()});
}

std::int64_t StampOf(const AVPacket& packet, std::int64_t without) {
    if (packet.pts != AV_NOPTS_VALUE) return packet.pts;
    return packet.dts != AV_NOPTS_VALUE ? packet.dts : without;
}

}  // namespace

void FFmpegFile::FreeFormat(AVFormatContext** context) {
    avformat_close_input(context);
}
void FFmpegFile::FreeCodec(AVCodecContext** context) {
    avcodec_free_context(context);
}
void FFmpegFile::FreeFrame(AVFrame** frame) {
    av_frame_free(frame);
}
void FFmpegFile::FreePacket(AVPacket** packet) {
    av_packet_free(packet);
}

FFmpegFile::FFmpegFile(const QString& path, LengthBy lengthBy)
    : frame_(Checked(av_frame_alloc())), packet_(Checked(av_packet_alloc())) {
    av_log_set_level(AV_LOG_QUIET);
    OpenContainer(path);
    OpenDecoder();
    MeasureLength(lengthBy, QFileInfo(path).size());
    FindFirstSample();
}

FFmpegFile::~FFmpegFile() = default;

void FFmpegFile::OpenContainer(const QString& path) {
    Options options;
    options.Set("protocol_whitelist", "file");
    options.Set("format_whitelist", kFormats);
    options.Set("codec_whitelist", kDecoders);
    const AVInputFormat* forced = nullptr;
    if (path.endsWith(u".raw"_s, Qt::CaseInsensitive)) {
        forced = av_find_input_format("s16le");
        options.Set("sample_rate", "44100");
        options.Set("ch_layout", "stereo");
    }
    // Only where the name says so: whoever plays sound files asks for no pictures.
    if (path.endsWith(u".avi"_s, Qt::CaseInsensitive)) {
        forced = av_find_input_format("avi");
        options.Set("format_whitelist", "avi");
    }
    AVFormatContext* opened = nullptr;
    // The prefix keeps a name with a colon in it from being taken for another protocol.
    Checked(
        avformat_open_input(&opened, ("file:" + QFile::encodeName(path)).constData(), forced, options.Get()));
    format_.reset(opened);
    Checked(avformat_find_stream_info(opened, nullptr));
}

void FFmpegFile::OpenDecoder() {
    const AVCodec* decoder = nullptr;
    const int best = Checked(av_find_best_stream(format_.get(), AVMEDIA_TYPE_AUDIO, -1, -1, &decoder, 0));
    for (unsigned i = 0; i < format_->nb_streams; ++i)
        format_->streams[i]->discard = AVDISCARD_ALL;
    stream_ = format_->streams[best];
    stream_->discard = AVDISCARD_DEFAULT;
    codec_.reset(Checked(avcodec_alloc_context3(decoder)));
    Checked(avcodec_parameters_to_context(codec_.get(), stream_->codecpar));
    codec_->pkt_timebase = stream_->time_base;
    codec_->thread_count = 1;
    Options options;
    options.Set("codec_whitelist", kDecoders);
    Checked(avcodec_open2(codec_.get(), decoder, options.Get()));
    if (!IsSoundFormat(codec_->sample_rate, codec_->ch_layout.nb_channels))
        throw ESoundFileError(FMOD_ERR_FILE_FORMAT);
}

int FFmpegFile::Rate() const {
    return codec_->sample_rate;
}

int FFmpegFile::Channels() const {
    return codec_->ch_layout.nb_channels;
}

bool FFmpegFile::FitsIn16Bits() const {
    constexpr int kBytes = 2;
    return av_get_bytes_per_sample(codec_->sample_fmt) <= kBytes;
}

// The time stamp of the first sample that is heard.
std::int64_t FFmpegFile::Origin() const {
    return stream_->start_time != AV_NOPTS_VALUE ? stream_->start_time : 0;
}

// Uncompressed sound has its length in the header, unless the file has been cut off.
bool FFmpegFile::LengthIsExact(std::int64_t fileSize) const {
    const int bits = av_get_exact_bits_per_sample(stream_->codecpar->codec_id);
    const std::int64_t claimed = length_ * bits / 8 * codec_->ch_layout.nb_channels;
    return bits > 0 && length_ > 0 && claimed <= fileSize;
}

void FFmpegFile::MeasureLength(LengthBy lengthBy, std::int64_t fileSize) {
    const AVRational sample = {1, Rate()};
    if (stream_->duration != AV_NOPTS_VALUE)
        length_ = av_rescale_q(stream_->duration, stream_->time_base, sample);
    else if (format_->duration != AV_NOPTS_VALUE)
        length_ = av_rescale_q(format_->duration, {1, AV_TIME_BASE}, sample);
    if ((lengthBy == LengthBy::Counting || fileSize <= kSmallFile) && !LengthIsExact(fileSize))
        CountPackets();
    length_ = std::max<std::int64_t>(0, length_);
}

// Into packet_: the next packet of the stream. False at the end, or when the file cannot be read any further.
bool FFmpegFile::ReadPacket() {
    for (int bad = 0; bad < kMostBadReads;) {
        av_packet_unref(packet_.get());
        const int result = av_read_frame(format_.get(), packet_.get());
        if (result >= 0 && packet_->stream_index == stream_->index) {
            if (!firstStamp_) firstStamp_ = std::min(Origin(), StampOf(*packet_, Origin()));
            return true;
        }
        if (result >= 0) continue;
        if (result != AVERROR_INVALIDDATA && result != AVERROR(EAGAIN)) return false;
        ++bad;
    }
    return false;
}

void FFmpegFile::CountPackets() {
    const AVRational sample = {1, Rate()};
    std::int64_t end = AV_NOPTS_VALUE;
    while (ReadPacket()) {
        const std::int64_t start = StampOf(*packet_, AV_NOPTS_VALUE);
        if (start == AV_NOPTS_VALUE) continue;
        const std::int64_t from = av_rescale_q(start - Origin(), stream_->time_base, sample);
        const std::int64_t duration = av_rescale_q(packet_->duration, stream_->time_base, sample);
        end = std::max(end, from + SamplesOf(*packet_, duration, stream_->codecpar->frame_size));
    }
    if (end != AV_NOPTS_VALUE) length_ = end;
    if (!SeekBefore(0)) throw ESoundFileError(FMOD_ERR_FILE_BAD);
}

// Some decoders (of Windows Media) give nothing for the first packet, and stamp what follows accordingly. The
// place 0 is the first sample that comes out.
void FFmpegFile::FindFirstSample() {
    if (Next() == nullptr) throw ESoundFileError(FMOD_ERR_FILE_FORMAT);
    firstSample_ = std::max<std::int64_t>(0, SampleOf(*frame_));
    keepFrame_ = true;
}

const AVFrame* FFmpegFile::Next() {
    if (std::exchange(keepFrame_, false)) return frame_.get();
    for (;;) {
        const int result = avcodec_receive_frame(codec_.get(), frame_.get());
        if (result == 0) return frame_.get();
        if (result == AVERROR_EOF || drained_) return nullptr;
        drained_ = !ReadPacket();
        // A packet that the decoder refuses is lost, and no more than that.
        avcodec_send_packet(codec_.get(), drained_ ? nullptr : packet_.get());
    }
}

std::int64_t FFmpegFile::SampleOf(const AVFrame& frame) const {
    if (frame.best_effort_timestamp == AV_NOPTS_VALUE) return -1;
    const std::int64_t since = frame.best_effort_timestamp - Origin();
    return std::max<std::int64_t>(0, av_rescale_q(since, stream_->time_base, {1, Rate()}) - firstSample_);
}

bool FFmpegFile::ReadingFailed() const {
    return format_->pb != nullptr && format_->pb->error < 0;
}

bool FFmpegFile::SeekBefore(std::int64_t sample) {
    // The beginning is the first packet, even where all of it is left out: it says how much else is, and
    // where frames are short (MPEG-2) the first sample that is heard lies in the second.
    const std::int64_t stamp = sample <= 0 ? firstStamp_.value_or(Origin())
                                           : av_rescale_q(sample, {1, Rate()}, stream_->time_base) + Origin();
    keepFrame_ = false;
    if (av_seek_frame(format_.get(), stream_->index, stamp, AVSEEK_FLAG_BACKWARD) < 0) return false;
    avcodec_flush_buffers(codec_.get());
    drained_ = false;
    return true;
}
