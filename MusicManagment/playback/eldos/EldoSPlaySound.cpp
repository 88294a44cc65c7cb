#include "MusicManagment/playback/eldos/EldoSPlaySound.h"

#include <algorithm>
#include <limits>

#include "CommonRUKTools/Clock.h"
#include "MusicManagment/playback/eldos/EldoSSound.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kLookEvery = 5000;  // ms; each attempt takes some tenths of a second

QString NoOutput() {
    return u"Es gibt keine Tonausgabe, die EldoS verwenden kann."_s;
}

TEldoSSettings Bounded(TEldoSSettings settings) {
    settings.BufferCount = std::clamp(settings.BufferCount, 2, 64);
    settings.BufferSize = std::clamp(settings.BufferSize, 1024, 1048576);
    return settings;
}

}  // namespace

TEldoSPlaySound::TEldoSPlaySound(const TEldoSSettings& settings, QObject* parent)
    : TPlaySoundContainer(parent), settings_(Bounded(settings)) {
    connect(&timer_, &QTimer::timeout, this, &TEldoSPlaySound::TopUp);
}

TEldoSPlaySound::~TEldoSPlaySound() = default;

void TEldoSPlaySound::Open() {
    Close();
    auto sound = std::make_unique<EldoSSound>(BackendFile(), settings_.ModuleFolders);
    auto output = settings_.MakeOutput();
    if (output == nullptr || !output->Open(sound->Rate(), sound->Channels()))
        throw EOutputException(NoOutput());
    sound_ = std::move(sound);
    output_ = std::move(output);

    const std::size_t frameBytes = sizeof(std::int16_t) * static_cast<std::size_t>(sound_->Channels());
    const std::size_t frames = static_cast<std::size_t>(settings_.BufferSize) / frameBytes;
    buffer_.resize(frames * static_cast<std::size_t>(sound_->Channels()));
    // A few times within what is queued, so that a late timer is not heard.
    const auto queuedMs = static_cast<int>(frames) * settings_.BufferCount * 1000LL / sound_->Rate();
    timer_.setInterval(static_cast<int>(std::clamp<qint64>(queuedMs / 4, 5, 100)));
    length_ = sound_->Length();
    status_ = psStopped;
}

void TEldoSPlaySound::Close() {
    timer_.stop();
    output_.reset();
    sound_.reset();
    status_ = psClosed;
    pushed_ = 0;
    length_ = 0;
    atEnd_ = false;
    outputLost_ = false;
}

void TEldoSPlaySound::Play() {
    if (status_ == psClosed) return;
    if (status_ != psPlaying) {
        // It has played to its end before.
        if (atEnd_ && output_->Queued() == 0) SeekTo(0);
        SetPlaying(true);
    }
    nextLook_ = 0;
    TopUp();
    if (IsSilenced()) throw EOutputException(NoOutput());
}

TPSStatus TEldoSPlaySound::GetStatus() {
    if (IsSilenced()) throw EOutputException(NoOutput());
    return status_;
}

void TEldoSPlaySound::Stop() {
    if (status_ == psClosed) return;
    SetPlaying(false);
    status_ = psStopped;
    SeekTo(0);
}

void TEldoSPlaySound::PauseResume() {
    if (status_ == psPlaying) {
        SetPlaying(false);
    } else if (status_ == psPaused) {
        SetPlaying(true);
        TopUp();
    }
}

quint32 TEldoSPlaySound::GetPosition() {
    return ToMilliseconds(PlayedFrames());
}

void TEldoSPlaySound::SetPosition(quint32 milliseconds) {
    if (status_ == psClosed) return;
    const std::int64_t frame = qint64{milliseconds} * sound_->Rate() / 1000;
    SeekTo(length_ > 0 ? std::min(frame, length_) : frame);
    if (status_ == psPlaying) TopUp();
}

quint32 TEldoSPlaySound::GetLength() {
    return ToMilliseconds(length_);
}

void TEldoSPlaySound::SetGain(float gain) {
    if (output_) output_->SetGain(gain);
}

void TEldoSPlaySound::TopUp() {
    if (status_ != psPlaying) return;
    if (!outputLost_ && output_->Failed()) NoticeLoss();
    if (outputLost_) Recover();
    if (outputLost_) return;
    const std::size_t bytes = buffer_.size() * sizeof(std::int16_t);
    const std::size_t target = bytes * static_cast<std::size_t>(settings_.BufferCount);
    while (!atEnd_ && output_->Queued() + bytes <= target)
        QueueBuffer();
    if (!atEnd_ || output_->Queued() > 0) return;
    // The device still sounds its last samples: it is not paused.
    timer_.stop();
    status_ = psStopped;
}

void TEldoSPlaySound::QueueBuffer() {
    const std::int64_t frames = sound_->Read(buffer_);
    const auto samples = static_cast<std::size_t>(frames * sound_->Channels());
    const bool queued = samples > 0 && output_->Queue(std::span(buffer_).first(samples));
    if (queued) pushed_ += frames;
    atEnd_ = !queued || samples < buffer_.size();
    // What the head of the file promised may be more than there is, or less.
    if (atEnd_) length_ = pushed_;
}

void TEldoSPlaySound::SetPlaying(bool playing) {
    output_->SetPaused(!playing);
    status_ = playing ? psPlaying : psPaused;
    playing ? timer_.start() : timer_.stop();
}

void TEldoSPlaySound::SeekTo(std::int64_t frame) {
    sound_->Seek(frame);
    output_->Clear();
    pushed_ = frame;
    atEnd_ = false;
}

// What is still queued was not heard and is read again; where that cannot be it is left out. A timer calls.
void TEldoSPlaySound::NoticeLoss() {
    outputLost_ = true;
    nextLook_ = 0;
    const std::int64_t heard = PlayedFrames();
    output_->Clear();
    try {
        SeekTo(heard);
    } catch (const EEldoSException& error) {
        qWarning("A part of a song is left out: %s", qUtf8Printable(error.Message()));
    }
}

void TEldoSPlaySound::Recover() {
    const qint64 now = CurrentClock().Ticks();
    if (now < nextLook_) return;
    nextLook_ = now + kLookEvery;
    if (!output_->Open(sound_->Rate(), sound_->Channels())) return;
    output_->SetPaused(false);
    outputLost_ = false;
}

std::int64_t TEldoSPlaySound::PlayedFrames() {
    if (status_ == psClosed) return 0;
    const std::size_t frameBytes = sizeof(std::int16_t) * static_cast<std::size_t>(sound_->Channels());
    return pushed_ - static_cast<std::int64_t>(output_->Queued() / frameBytes);
}

quint32 TEldoSPlaySound::ToMilliseconds(std::int64_t frames) const {
    if (status_ == psClosed) return 0;
    const std::int64_t seconds = frames / sound_->Rate();
    if (seconds >= std::numeric_limits<quint32>::max() / 1000) return std::numeric_limits<quint32>::max();
    return static_cast<quint32>(seconds * 1000 + frames % sound_->Rate() * 1000 / sound_->Rate());
}
