#include "MusicManagment/playback/fmod/FMODPlaySound.h"

#include <algorithm>

#include "CommonRUKTools/Clock.h"

using namespace Qt::StringLiterals;

namespace {

constexpr float kOldestVersion = 3.5F;
constexpr int kLibraryBuffer = 100;     // ms
constexpr unsigned kInitFlags = 2;      // sound goes on when the window loses the focus
constexpr unsigned kStreamMode = 0x29;  // loop off, 16 bit, stereo
constexpr int kShortStream = 30000;     // ms
// Songs have no time of their own here: every row counts the same, and every pattern is as long as pattern 0.
constexpr quint32 kRowTime = 144;  // ms
constexpr quint32 kEndAtNextStep = 1;
constexpr int kFullSongVolume = 256;
constexpr int kFullStreamVolume = 255;
constexpr float kOldSongSeparation = 0.15F;

quint32 Now() {
    return static_cast<quint32>(CurrentClock().Ticks());
}

// How much of the fade is left, in whole percent. `end` is not past.
int PercentLeft(quint32 end, quint32 now, quint32 fadeTime) {
    if (fadeTime == 0) return 0;
    const quint32 left = end - now;
    return static_cast<int>(std::min<quint64>(100, quint64{100} * left / fadeTime));
}

int Scaled(int percent, int full) {
    return (percent * full + 50) / 100;
}

quint32 NotNegative(int value) {
    return static_cast<quint32>(std::max(0, value));
}

}  // namespace

TFMODPlaySound::TFMODPlaySound(FmodLibrary& library, const TFMODSettings& settings, QObject* parent)
    : TPlaySoundContainer(parent), library_(library), settings_(settings) {}

TFMODPlaySound::~TFMODPlaySound() {
    TFMODPlaySound::Close();
}

void TFMODPlaySound::ThrowRefusal(const QString& what) {
    const int code = library_.FSOUND_GetError();
    const QString message = what + FMODErrorText(code);
    if (IsOutputError(code)) throw EOutputException(message);
    throw EFMODException(message);
}

bool TFMODPlaySound::MustInitialise() const {
    const auto& known = library_.initialisation;
    return !known.done || known.outputType != settings_.OutputType || known.mixRate != settings_.MixRate ||
           known.softChannels != settings_.SoftChannels;
}

void TFMODPlaySound::InitialiseLibrary() {
    auto& known = library_.initialisation;
    if (known.done) library_.FSOUND_Close();
    known.done = false;
    const float version = library_.FSOUND_GetVersion();
    if (version < kOldestVersion)
        throw EFMODException(
            QString::asprintf("FMOD-DLL Version %3.2f ist zu alt (mind. Version %3.2f benötigt)",
                              static_cast<double>(version), static_cast<double>(kOldestVersion)));
    library_.FSOUND_SetOutput(settings_.OutputType);
    library_.FSOUND_SetDriver(0);
    library_.FSOUND_SetMixer(0);
    library_.FSOUND_SetBufferSize(kLibraryBuffer);
    if (!library_.FSOUND_Init(settings_.MixRate, settings_.SoftChannels, kInitFlags))
        ThrowRefusal(u"Fehler beim Initialisieren von FMOD: "_s);
    known = {true, settings_.OutputType, settings_.MixRate, settings_.SoftChannels};
}

void TFMODPlaySound::OpenStream() {
    stream_ = library_.FSOUND_Stream_OpenFile(BackendFile(), kStreamMode | FSOUND_MPEGACCURATE);
    if (stream_ == FSOUND_STREAM::kNone || library_.FSOUND_Stream_GetLengthMs(stream_) >= kShortStream)
        return;
    library_.FSOUND_Stream_Close(stream_);
    stream_ = library_.FSOUND_Stream_OpenFile(BackendFile(), kStreamMode);
}

void TFMODPlaySound::Open() {
    Close();
    if (MustInitialise()) InitialiseLibrary();
    channel_ = -1;
    song_ = library_.FMUSIC_LoadSong(BackendFile());
    if (song_ != FMUSIC_MODULE::kNone) {
        library_.FMUSIC_SetMasterVolume(song_, kFullStreamVolume);
        const int type = library_.FMUSIC_GetType(song_);
        if (type == FMUSIC_TYPE_MOD || type == FMUSIC_TYPE_S3M)
            library_.FMUSIC_SetPanSeperation(song_, kOldSongSeparation);
        return;
    }
    OpenStream();
    if (stream_ == FSOUND_STREAM::kNone)
        ThrowRefusal(u"Fehler beim Öffnen der Datei "_s + BackendFile() + u" in FMOD: "_s);
}

void TFMODPlaySound::Close() {
    if (song_ != FMUSIC_MODULE::kNone) library_.FMUSIC_FreeSong(song_);
    if (stream_ != FSOUND_STREAM::kNone) {
        library_.FSOUND_Stream_Stop(stream_);
        library_.FSOUND_Stream_Close(stream_);
    }
    song_ = FMUSIC_MODULE::kNone;
    stream_ = FSOUND_STREAM::kNone;
    channel_ = -1;
}

bool TFMODPlaySound::StartSong() {
    if (!library_.FMUSIC_PlaySong(song_)) return false;
    library_.FMUSIC_SetMasterVolume(song_, kFullSongVolume);
    return true;
}

bool TFMODPlaySound::StartStream() {
    channel_ = library_.FSOUND_Stream_PlayEx(stream_, FSOUND_FREE, FSOUND_DSPUNIT::kNone, true);
    if (channel_ < 0) {
        channel_ = -1;
        return false;
    }
    library_.FSOUND_SetPan(channel_, FSOUND_STEREOPAN);
    library_.FSOUND_SetVolume(channel_, kFullStreamVolume);
    return library_.FSOUND_SetPaused(channel_, false);
}

bool TFMODPlaySound::SetPaused(bool paused) {
    return song_ != FMUSIC_MODULE::kNone ? library_.FMUSIC_SetPaused(song_, paused)
                                         : library_.FSOUND_SetPaused(channel_, paused);
}

void TFMODPlaySound::Play() {
    bool done = true;
    switch (State()) {
        case psPaused:
            done = SetPaused(false);
            break;
        case psPlaying:
            if (fadeInEnd_ != 0) fadeInEnd_ = kEndAtNextStep;
            CutFadeOut();
            break;
        case psStopped:
            done = song_ != FMUSIC_MODULE::kNone ? StartSong() : StartStream();
            break;
        default:
            break;
    }
    if (!done) ThrowRefusal(u"Fehler beim Abspielen von "_s + BackendFile() + u" in FMOD: "_s);
    GetStatus();  // tells of a lost output
}

void TFMODPlaySound::PauseResume() {
    const TPSStatus status = State();
    if (status != psPaused && status != psPlaying) return;
    if (!SetPaused(status == psPlaying))
        ThrowRefusal(u"Fehler beim Pausieren/Fortsetzen von "_s + BackendFile() + u" in FMOD: "_s);
}

void TFMODPlaySound::Stop() {
    if (song_ != FMUSIC_MODULE::kNone) library_.FMUSIC_StopSong(song_);
    if (stream_ != FSOUND_STREAM::kNone) library_.FSOUND_Stream_Stop(stream_);
    channel_ = -1;
    CancelFades();
}

TPSStatus TFMODPlaySound::GetStatus() {
    const TPSStatus state = State();
    if (state == psPlaying && outputLost_) throw EOutputException(u"Die Tonausgabe ist nicht mehr da."_s);
    return state;
}

TPSStatus TFMODPlaySound::State() {
    const bool isSong = song_ != FMUSIC_MODULE::kNone;
    if (!isSong && stream_ == FSOUND_STREAM::kNone) return psClosed;
    if (!isSong && channel_ < 0) return psStopped;
    if (!(isSong ? library_.FMUSIC_IsPlaying(song_) : library_.FSOUND_IsPlaying(channel_))) return psStopped;
    // A sound without an output still counts as playing; the error tells.
    outputLost_ = IsOutputError(library_.FSOUND_GetError());
    const bool paused = isSong ? library_.FMUSIC_GetPaused(song_) : library_.FSOUND_GetPaused(channel_);
    return paused ? psPaused : psPlaying;
}

// Of the open song, in ms; 0 when its first pattern has no rows.
quint32 TFMODPlaySound::PatternTime() const {
    return NotNegative(library_.FMUSIC_GetPatternLength(song_, 0)) * kRowTime;
}

quint32 TFMODPlaySound::GetPosition() {
    if (song_ != FMUSIC_MODULE::kNone)
        return NotNegative(library_.FMUSIC_GetOrder(song_)) * PatternTime() +
               NotNegative(library_.FMUSIC_GetRow(song_)) * kRowTime;
    if (stream_ != FSOUND_STREAM::kNone) return NotNegative(library_.FSOUND_Stream_GetTime(stream_));
    return 0;
}

void TFMODPlaySound::SetPosition(quint32 milliseconds) {
    if (song_ != FMUSIC_MODULE::kNone) {
        if (const quint32 pattern = PatternTime(); pattern != 0)
            library_.FMUSIC_SetOrder(song_, static_cast<int>(milliseconds / pattern));
    } else if (stream_ != FSOUND_STREAM::kNone) {
        library_.FSOUND_Stream_SetTime(stream_, static_cast<int>(std::min<quint32>(milliseconds, INT_MAX)));
    }
}

quint32 TFMODPlaySound::GetLength() {
    if (song_ != FMUSIC_MODULE::kNone)
        return NotNegative(library_.FMUSIC_GetNumOrders(song_)) * PatternTime();
    if (stream_ != FSOUND_STREAM::kNone) return NotNegative(library_.FSOUND_Stream_GetLengthMs(stream_));
    return 0;
}

void TFMODPlaySound::SetVolume(int percent) {
    const int bounded = std::clamp(percent, 0, 100);
    if (song_ != FMUSIC_MODULE::kNone)
        library_.FMUSIC_SetMasterVolume(song_, Scaled(bounded, kFullSongVolume));
    else if (channel_ >= 0)
        library_.FSOUND_SetVolume(channel_, Scaled(bounded, kFullStreamVolume));
}

void TFMODPlaySound::StartFadeIn() {
    fadeInEnd_ = Now() + settings_.FadeTime;
}

void TFMODPlaySound::StartFadeOut() {
    fadeOutEnd_ = Now() + settings_.FadeTime;
}

// At the very tick of an end nothing happens; the tick after it ends the fade. Ticks are compared as they
// stand, without regard to their wrapping round: an end of 1 is thus always past.
bool TFMODPlaySound::FadeStep() {
    const quint32 now = Now();
    if (fadeInEnd_ != 0 && now < fadeInEnd_)
        SetVolume(100 - PercentLeft(fadeInEnd_, now, settings_.FadeTime));
    if (fadeInEnd_ != 0 && now > fadeInEnd_) {
        fadeInEnd_ = 0;
        SetVolume(100);
    }
    if (fadeOutEnd_ != 0 && now < fadeOutEnd_) SetVolume(PercentLeft(fadeOutEnd_, now, settings_.FadeTime));
    if (fadeOutEnd_ == 0 || now <= fadeOutEnd_) return false;
    Stop();
    return true;
}

void TFMODPlaySound::CancelFades() {
    fadeInEnd_ = 0;
    fadeOutEnd_ = 0;
}

void TFMODPlaySound::CutFadeOut() {
    if (fadeOutEnd_ != 0) fadeOutEnd_ = kEndAtNextStep;
}
