#include <algorithm>
#include <limits>

#include "MusicManagment/playback/fmod/FFmpegSource.h"
#include "MusicManagment/playback/fmod/SoundLibraryImpl.h"

namespace {

int ToMs(quint64 frames, int rate) {
    const quint64 ms = frames * 1000 / static_cast<quint64>(rate);
    return static_cast<int>(std::min<quint64>(ms, std::numeric_limits<int>::max()));
}

}  // namespace

FSOUND_STREAM SoundLibrary::FSOUND_Stream_OpenFile(const QString& fileName, unsigned mode) {
    if (!Initialised() || !HasSpace(streams_)) return FSOUND_STREAM::kNone;
    const auto lengthBy =
        (mode & FSOUND_MPEGACCURATE) != 0 ? FFmpegFile::LengthBy::Counting : FFmpegFile::LengthBy::Header;
    Voice stream;
    const bool opened = Try([&] {
        auto source = std::make_unique<FFmpegSource>(fileName, lengthBy, rate_);
        stream.length = source->Length();
        stream.ahead = std::make_unique<DecodeAhead>(std::move(source), rate_);
    });
    if (!opened) return FSOUND_STREAM::kNone;
    const auto handle = static_cast<FSOUND_STREAM>(++lastHandle_);
    streams_.emplace(handle, std::move(stream));
    return handle;
}

bool SoundLibrary::FSOUND_Stream_Close(FSOUND_STREAM stream) {
    Voice* found = Find(streams_, stream);
    if (found == nullptr) return false;
    mixer_->Release(found->channel);
    streams_.erase(stream);
    return true;
}

int SoundLibrary::FSOUND_Stream_GetLengthMs(FSOUND_STREAM stream) {
    const Voice* found = Find(streams_, stream);
    return found != nullptr ? ToMs(found->length, rate_) : 0;
}

int SoundLibrary::FSOUND_Stream_GetTime(FSOUND_STREAM stream) {
    const Voice* found = Find(streams_, stream);
    return found != nullptr ? ToMs(found->ahead->Position(), rate_) : 0;
}

bool SoundLibrary::FSOUND_Stream_SetTime(FSOUND_STREAM stream, int milliseconds) {
    Voice* found = Find(streams_, stream);
    if (found == nullptr) return false;
    // Rounded up, so that the time reads back as it was set.
    const quint64 frame =
        (static_cast<quint64>(std::max(0, milliseconds)) * static_cast<quint64>(rate_) + 999) / 1000;
    return Try([&] { found->ahead->Seek(frame); });
}

int SoundLibrary::FSOUND_Stream_PlayEx(FSOUND_STREAM stream, int channel, FSOUND_DSPUNIT unit, bool paused) {
    Voice* found = Find(streams_, stream);
    if (found == nullptr) return -1;
    if (channel != FSOUND_FREE || unit != FSOUND_DSPUNIT::kNone) {
        Fail(FMOD_ERR_INVALID_PARAM);
        return -1;
    }
    return StartVoice(*found, 1, paused) ? found->channel : -1;
}

bool SoundLibrary::FSOUND_Stream_Stop(FSOUND_STREAM stream) {
    Voice* found = Find(streams_, stream);
    if (found == nullptr) return false;
    mixer_->Release(found->channel);
    found->channel = Mixer::kNoChannel;
    return Rewind(*found);
}
