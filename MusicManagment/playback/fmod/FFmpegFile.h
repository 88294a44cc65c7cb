#pragma once

#include <QString>
#include <cstdint>
#include <memory>
#include <optional>

struct AVCodecContext;
struct AVFormatContext;
struct AVFrame;
struct AVPacket;
struct AVStream;

// One sound file, opened and decoded by the FFmpeg libraries: its best audio stream as decoded frames, in the
// file's own rate and layout. Samples that an encoder put in front of and behind the sound are left out.
class FFmpegFile {
 public:
    enum class LengthBy { Header, Counting };

    // Throws ESoundFileError, also when nothing in the file can be decoded. Counting reads all packets of the
    // file; small files, which cost nothing, are always counted.
    FFmpegFile(const QString& path, LengthBy lengthBy);
    ~FFmpegFile();

    int Rate() const;  // Hz, above 0
    int Channels() const;
    bool FitsIn16Bits() const;                       // its samples lose nothing in 16 bits
    std::int64_t Length() const { return length_; }  // samples a channel, at Rate()

    // The next decoded frame, good until the next call; nullptr at the end. Damage is passed over.
    const AVFrame* Next();
    // Whether the end that Next told is none of the file's: the medium has gone, or cannot be read.
    bool ReadingFailed() const;
    // The place of a frame's first sample; -1 when the file does not tell.
    std::int64_t SampleOf(const AVFrame& frame) const;
    // Next goes on somewhere before the sample or at it, as near as the file's index allows. False when the
    // file cannot be searched.
    bool SeekBefore(std::int64_t sample);

 private:
    template <auto Free>
    struct Deleter {
        template <typename T>
        void operator()(T* pointer) const {
            Free(&pointer);
        }
    };
    static void FreeFormat(AVFormatContext** context);
    static void FreeCodec(AVCodecContext** context);
    static void FreeFrame(AVFrame** frame);
    static void FreePacket(AVPacket** packet);

    void OpenContainer(const QString& path);
    void OpenDecoder();
    void MeasureLength(LengthBy lengthBy, std::int64_t fileSize);
    bool LengthIsExact(std::int64_t fileSize) const;
    bool ReadPacket();
    void CountPackets();
    void FindFirstSample();
    std::int64_t Origin() const;

    std::unique_ptr<AVFormatContext, Deleter<FreeFormat>> format_;
    std::unique_ptr<AVCodecContext, Deleter<FreeCodec>> codec_;
    std::unique_ptr<AVFrame, Deleter<FreeFrame>> frame_;
    std::unique_ptr<AVPacket, Deleter<FreePacket>> packet_;
    AVStream* stream_ = nullptr;  // the format's
    std::int64_t length_ = 0;
    std::int64_t firstSample_ = 0;
    std::optional<std::int64_t> firstStamp_;  // of the first packet, in the stream's time
    bool keepFrame_ = false;                  // the next frame is in frame_ already
    bool drained_ = false;
};
