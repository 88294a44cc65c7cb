#pragma once

#include <functional>
#include <memory>
#include <vector>

#include "MusicManagment/playback/fmod/FFmpegFile.h"
#include "MusicManagment/playback/fmod/SoundSource.h"

struct SwrContext;

// A sound file as frames at the mix rate. Seeks are exact to the sample wherever the file's time stamps are.
class FFmpegSource : public SoundSource {
 public:
    // Throws ESoundFileError. `rate` in Hz.
    FFmpegSource(const QString& path, FFmpegFile::LengthBy lengthBy, int rate);
    // The rate follows from that of the file.
    FFmpegSource(const QString& path, FFmpegFile::LengthBy lengthBy,
                 const std::function<int(int fileRate)>& rateFor);
    ~FFmpegSource() override;

    std::size_t Read(float* stereo, std::size_t frames) override;
    std::uint64_t Seek(std::uint64_t frame) override;
    std::uint64_t Length() const override { return length_; }
    int Rate() const { return rate_; }
    const FFmpegFile& File() const { return file_; }

 private:
    struct ResamplerDeleter {
        void operator()(SwrContext* context) const;
    };
    // What the resampler has been made for.
    struct Input {
        int format = -1;
        int rate = 0;
        int channels = 0;
        bool operator==(const Input&) const = default;
    };

    bool Fill();
    void Convert(const AVFrame* frame);
    void PrepareResampler(const AVFrame& frame);
    std::int64_t LandBefore(std::int64_t sample, std::int64_t margin);
    std::int64_t ToMixRate(std::int64_t samples) const;

    FFmpegFile file_;
    const int rate_;
    std::uint64_t length_ = 0;
    std::unique_ptr<SwrContext, ResamplerDeleter> resampler_;
    Input input_;
    std::vector<float> decoded_;  // frames that nobody has read yet
    std::size_t read_ = 0;        // of these, in floats
    std::size_t skip_ = 0;        // frames to come that stand before the place that was sought
    bool ended_ = false;
};
