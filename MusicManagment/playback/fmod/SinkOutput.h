#pragma once

#include <QFile>
#include <atomic>
#include <condition_variable>
#include <mutex>
#include <span>
#include <thread>
#include <vector>

#include "MusicManagment/playback/fmod/AudioOutput.h"

// Outputs without a device: the mix is pulled in real time by a thread of theirs, or by Advance only.
class SinkOutput : public AudioOutput {
 public:
    enum class Pace { RealTime, Caller };
    explicit SinkOutput(Pace pace) : pace_(pace) {}

    bool Open(int rate, std::size_t frames, Pull pull) final;
    void Start() final;
    void Stop() final;
    void Close() final;
    bool Failed() const final { return failed_.load(); }
    bool Unpaced() const final { return pace_ == Pace::Caller; }
    void Advance(std::size_t frames) final;

 protected:
    // What becomes of the mix. False ends the output as failed.
    virtual bool Begin([[maybe_unused]] int rate) { return true; }
    virtual bool Accept([[maybe_unused]] std::span<const float> stereo) { return true; }
    virtual void End() {}

 private:
    void Run();
    bool PullSome(std::size_t frames);

    const Pace pace_;
    int rate_ = 0;
    Pull pull_;
    std::vector<float> buffer_;  // one pull
    std::atomic<bool> failed_{false};
    bool started_ = false;

    std::mutex mutex_;
    std::condition_variable stopped_;
    bool stop_ = false;
    std::thread thread_;
};

// Plays to nobody.
class NullOutput : public SinkOutput {
 public:
    using SinkOutput::SinkOutput;
    ~NullOutput() override { Close(); }
};

// Collects what Advance pulls.
class CaptureOutput : public SinkOutput {
 public:
    using Samples = std::vector<float>;  // left, right, left, ...
    explicit CaptureOutput(std::shared_ptr<Samples> heard)
        : SinkOutput(Pace::Caller), heard_(std::move(heard)) {}
    ~CaptureOutput() override { Close(); }

 private:
    bool Accept(std::span<const float> stereo) override {
        heard_->insert(heard_->end(), stereo.begin(), stereo.end());
        return true;
    }

    std::shared_ptr<Samples> heard_;
};

// Writes a WAV file, from the beginning each time it is opened. It ends in the middle when it has reached the
// 4 GiB that the format can tell.
class WavFileOutput : public SinkOutput {
 public:
    enum class Samples { Int16, Float32 };
    WavFileOutput(const QString& path, Samples samples, Pace pace);
    ~WavFileOutput() override { Close(); }

 private:
    bool Begin(int rate) override;
    bool Accept(std::span<const float> stereo) override;
    void End() override;
    bool WriteHeader(quint32 dataBytes);

    QFile file_;
    const Samples samples_;
    int rate_ = 0;
    quint32 dataBytes_ = 0;
    QByteArray encoded_;
};
