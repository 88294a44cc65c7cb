#include "MusicManagment/playback/fmod/SinkOutput.h"

#include <QtEndian>
#include <algorithm>
#include <chrono>
#include <cmath>

#include "CommonRUKTools/ByteWriter.h"

namespace {

constexpr quint32 kMostDataBytes = 0xFFFF'0000;
// Who comes late by more than this (the machine slept) goes on from now instead of catching up.
constexpr auto kMostLate = std::chrono::seconds(1);

}  // namespace

bool SinkOutput::Open(int rate, std::size_t frames, Pull pull) {
    rate_ = rate;
    pull_ = std::move(pull);
    buffer_.assign(2 * frames, 0.0F);
    failed_ = false;
    return Begin(rate);
}

void SinkOutput::Start() {
    if (started_) return;
    started_ = true;
    stop_ = false;
    if (pace_ == Pace::RealTime) thread_ = std::thread([this] { Run(); });
}

void SinkOutput::Stop() {
    if (!started_) return;
    started_ = false;
    {
        const std::lock_guard lock(mutex_);
        stop_ = true;
    }
    stopped_.notify_all();
    if (thread_.joinable()) thread_.join();
}

void SinkOutput::Close() {
    Stop();
    if (pull_) End();
    pull_ = nullptr;
}

bool SinkOutput::PullSome(std::size_t frames) {
    const std::span<float> stereo(buffer_.data(), 2 * frames);
    pull_(stereo.data(), frames);
    if (!Accept(stereo)) failed_ = true;
    return !failed_;
}

void SinkOutput::Advance(std::size_t frames) {
    if (pace_ != Pace::Caller || !started_) return;
    while (frames > 0 && !failed_) {
        const std::size_t count = std::min(frames, buffer_.size() / 2);
        PullSome(count);
        frames -= count;
    }
}

void SinkOutput::Run() {
    using Time = std::chrono::steady_clock;
    const std::size_t frames = buffer_.size() / 2;
    const auto step = std::chrono::duration_cast<Time::duration>(
        std::chrono::duration<double>(static_cast<double>(frames) / rate_));
    auto due = Time::now();
    std::unique_lock lock(mutex_);
    while (!stop_) {
        lock.unlock();
        const bool goesOn = PullSome(frames);
        lock.lock();
        if (!goesOn) return;
        due += step;
        if (due + kMostLate < Time::now()) due = Time::now();
        stopped_.wait_until(lock, due, [this] { return stop_; });
    }
}

WavFileOutput::WavFileOutput(const QString& path, Samples samples, Pace pace)
    : SinkOutput(pace), file_(path), samples_(samples) {}

bool WavFileOutput::Begin(int rate) {
    rate_ = rate;
    dataBytes_ = 0;
    return file_.open(QIODevice::WriteOnly | QIODevice::Truncate) && WriteHeader(0);
}

bool WavFileOutput::WriteHeader(quint32 dataBytes) {
    const bool floats = samples_ == Samples::Float32;
    const quint16 sampleBytes = floats ? 4 : 2;
    const auto rate = static_cast<quint32>(rate_);
    ByteWriter header;
    header.Raw("RIFF");
    header.U32Le(dataBytes + 36);
    header.Raw("WAVEfmt ");
    header.U32Le(16);
    header.U16Le(floats ? 3 : 1);
    header.U16Le(2);
    header.U32Le(rate);
    header.U32Le(rate * 2 * sampleBytes);
    header.U16Le(static_cast<quint16>(2 * sampleBytes));
    header.U16Le(static_cast<quint16>(8 * sampleBytes));
    header.Raw("data");
    header.U32Le(dataBytes);
    const auto size = static_cast<qint64>(header.Size());
    return file_.write(reinterpret_cast<const char*>(header.Bytes().data()), size) == size;
}

bool WavFileOutput::Accept(std::span<const float> stereo) {
    encoded_.clear();
    if (samples_ == Samples::Float32) {
        encoded_.resize(static_cast<qsizetype>(stereo.size_bytes()));
        qToLittleEndian<float>(stereo.data(), static_cast<qsizetype>(stereo.size()), encoded_.data());
    } else {
        encoded_.resize(2 * static_cast<qsizetype>(stereo.size()));
        for (std::size_t i = 0; i < stereo.size(); ++i)
            qToLittleEndian(static_cast<qint16>(std::lround(stereo[i] * 32767.0F)), encoded_.data() + 2 * i);
    }
    const auto count = static_cast<quint32>(encoded_.size());
    if (count > kMostDataBytes - dataBytes_) return false;
    dataBytes_ += count;
    return file_.write(encoded_) == encoded_.size();
}

void WavFileOutput::End() {
    if (!file_.isOpen()) return;
    if (!file_.seek(0) || !WriteHeader(dataBytes_) || !file_.flush())
        qWarning("%s is not complete: %s", qUtf8Printable(file_.fileName()),
                 qUtf8Printable(file_.errorString()));
    file_.close();
}
