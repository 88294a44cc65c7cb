#include "MusicManagment/playback/PlaySound.h"

#include <QEventLoop>
#include <QThread>
#include <algorithm>
#include <limits>
#include <utility>

#include "CommonRUKTools/Clock.h"
#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/playback/ExternalLink.h"
#include "MusicManagment/playback/PlaySoundMenu.h"
#include "MusicManagment/playback/backend/FadingBackend.h"
#include "MusicManagment/playback/backend/GainBackend.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kWaitRound = 250;  // ms
constexpr qint64 kStep = 10000;  // ms, of the menu's commands back and forward

}  // namespace

TPlaySound::TPlaySound(EngineTable engines, QObject* parent)
    : TPlaySoundContainer(parent),
      engineTable_(std::move(engines)),
      timers_({.Tick = [this] { RunHandler(&TPlaySound::Tick); },
               .EndOfSong = [this] { RunHandler(&TPlaySound::HandleEndOfSong); },
               .AutoStop = [this] { RunHandler(&TPlaySound::HandleAutoStop); }}) {}

TPlaySound::~TPlaySound() {
    SetPlayList(nullptr);
    SetMusicDatabase(nullptr);
}

// --- Playing ---

void TPlaySound::Play() {
    if (UseExternal()) {
        external_->Send(ecPlay);
        return RestartAutoStop();
    }
    if (!current_ || EndFadesOfPlaying() || !FileSource::Exists(fileName_)) return;
    current_->Play();
    ResumeFading();
    StartTimers();
    AnnounceSong();
}

// A song that plays already only gets its full volume back.
bool TPlaySound::EndFadesOfPlaying() {
    FadingBackend* current = AsFading(current_.get());
    if (current == nullptr || current_->GetStatus() != psPlaying) return false;
    current->CancelFades();
    current->SetVolume(100);
    if (FadingBackend* fading = AsFading(fading_.get())) fading->CutFadeOut();
    return true;
}

// One that has come to its end in the meantime would begin anew.
void TPlaySound::ResumeFading() {
    if (fading_ && fading_->GetStatus() != psStopped) fading_->Play();
}

void TPlaySound::AnnounceSong() {
    Raise(OnPlayingStarted);
    Feedback(fbStarted);
    if (panel_ != nullptr) {
        panel_->ShowSong(fileName_);
        panel_->Redraw();
    }
    if (controller_ == nullptr) return;
    controller_->FeedbackFileName(fileName_);
    Feedback(fbStateChanged, 1);
}

void TPlaySound::Stop(StopMode mode) {
    if (playExtern_) {
        timers_.StopAutoStop();
        if (ExternalRuns()) external_->Send(ecStop, mode == StopMode::Fade);
        return;
    }
    if (!current_) return;
    FadingBackend* fading = AsFading(current_.get());
    // A fade-out runs on the timer, which rests unless the song plays.
    if (mode == StopMode::Fade && fading != nullptr && settings_.FMODCrossoverTime >= kShortestFade &&
        !fading->IsFadingOut() && current_->GetStatus() == psPlaying) {
        fading->SetFadeTime(settings_.FMODCrossoverTime);
        fading->StartFadeOut();
        return;
    }
    FinishStop();
    if (timers_.TicksExist() && !timers_.Ticking()) RunTick(TickKind::Last);
}

// The timers rest before anybody is told, who may start another song.
void TPlaySound::FinishStop() {
    StopTimers();
    current_->Stop();
    fading_.reset();
    Raise(OnPlayingStopped);
    Feedback(fbStopped);
    StateChanged();
}

void TPlaySound::PauseResume() {
    if (UseExternal()) {
        external_->Send(ecPauseResume);
        return;
    }
    if (!current_) return;
    if (current_->GetStatus() == psPaused) {
        current_->Play();
        ResumeFading();
        StartTimers();
        Raise(OnPlayingResumed);
        Feedback(fbResumed);
    } else {
        current_->PauseResume();
        if (fading_) fading_->PauseResume();
        StopTimers();
        Raise(OnPlayingPaused);
        Feedback(fbPaused);
    }
    StateChanged();
}

void TPlaySound::StartTimers() {
    endReached_ = false;
    crossFadeStarted_ = false;
    timers_.StopEnd();
    playCount_.Start(CurrentClock().Ticks());
    timers_.StartTicks(timerInterval_);
    RestartAutoStop();
}

void TPlaySound::StopTimers() {
    endReached_ = false;
    crossFadeStarted_ = false;
    timers_.StopAll();
}

void TPlaySound::RestartAutoStop() {
    if (autoStop_ > 0) timers_.StartAutoStop(autoStop_);
}

template <typename T>
T TPlaySound::AskCurrent(T (TPlaySoundContainer::*question)(), T none) const {
    try {
        return current_ ? (*current_.*question)() : none;
    } catch (const ERukException&) {
        return none;
    }
}

quint32 TPlaySound::GetPosition() {
    if (playExtern_) return ExternalRuns() ? static_cast<quint32>(external_->Send(ecGetPosition)) : 0;
    return AskCurrent<quint32>(&TPlaySoundContainer::GetPosition, 0);
}

void TPlaySound::SetPosition(quint32 milliseconds) {
    if (playExtern_) {
        if (ExternalRuns()) external_->Send(ecSetPosition, milliseconds);
    } else if (current_) {
        current_->SetPosition(milliseconds);
    }
    if (OnSeeked) OnSeeked(*this, milliseconds);
}

quint32 TPlaySound::GetLength() {
    if (playExtern_) return ExternalRuns() ? static_cast<quint32>(external_->Send(ecGetLength)) : 0;
    return AskCurrent<quint32>(&TPlaySoundContainer::GetLength, 0);
}

TPSStatus TPlaySound::GetStatus() {
    if (!playExtern_) return AskCurrent(&TPlaySoundContainer::GetStatus, psClosed);
    if (!ExternalRuns()) return psClosed;
    const qint64 answer = external_->Send(ecGetStatus);
    return answer >= psClosed && answer <= psSeeking ? static_cast<TPSStatus>(answer) : psClosed;
}

void TPlaySound::SetStatus(TPSStatus status) {
    switch (status) {
        case psClosed:
            return SetFileName(QString());
        case psPaused:
            return PauseResume();
        case psPlaying:
            return Play();
        case psStopped:
            return Stop(StopMode::AtOnce);
        case psOpening:
        case psSeeking:
            return;
    }
}

void TPlaySound::WaitForEnd(WaitMode mode) {
    for (TPSStatus status = GetStatus(); status != psClosed && status != psStopped; status = GetStatus()) {
        if (mode == WaitMode::Block) {
            QThread::msleep(kWaitRound);
            continue;
        }
        QEventLoop messages;
        QTimer::singleShot(kWaitRound, &messages, &QEventLoop::quit);
        messages.exec();
    }
}

// --- Properties ---

void TPlaySound::SetTimerInterval(int milliseconds) {
    timerInterval_ = std::max(milliseconds, 1);
    if (timers_.Ticking()) timers_.StartTicks(timerInterval_);
}

void TPlaySound::SetAutoStop(int milliseconds) {
    if (milliseconds == autoStop_) return;
    autoStop_ = milliseconds;
    if (milliseconds < 1) return timers_.StopAutoStop();
    const qint64 left = qint64{milliseconds} - GetPosition();
    if (left < 1000)
        HandleAutoStop();
    else
        timers_.StartAutoStop(static_cast<int>(left));
}

void TPlaySound::SetEngines(const EngineSettings& settings) {
    const EngineSettings former = std::exchange(settings_, settings);
    if (playExtern_) external_->SendChanges(former, settings_);
}

void TPlaySound::SetGain(float gain) {
    gain_ = std::clamp(gain, 0.0F, 1.0F);
    if (engineTable_.SetSharedGain) engineTable_.SetSharedGain(gain_);
    if (GainBackend* current = AsGain(current_.get())) current->SetGain(gain_);
}

// --- Wiring ---

void TPlaySound::SetMusicDatabase(TMusicDatabase* database) {
    if (database == database_) return;
    if (database_) {
        database_->LeaveSettings(*this);
        if (database_->PlaySound() == this) database_->SetPlaySound(nullptr);
    }
    database_ = database;
    if (database == nullptr) return;
    database->SetPlaySound(this);
    database->JoinSettings(*this);
}

void TPlaySound::SetPlayList(TPlayList* playList) {
    if (playList == playList_) return;
    if (playList_ && playList_->PlaySound() == this) playList_->SetPlaySound(nullptr);
    playList_ = playList;
    if (playList != nullptr) playList->SetPlaySound(this);
}

void TPlaySound::RedrawPanel() {
    if (panel_ != nullptr) panel_->Redraw();
}

// --- Menu ---

TMenuExItem& TPlaySound::Menu() {
    if (!menu_) menu_ = BuildPlaySoundMenu();
    return *menu_;
}

// How the user's wish for another song is carried out.
SongChange TPlaySound::ChangeOnDemand() const {
    return Crossover() >= coAllChanges ? SongChange::CrossFade : SongChange::Hard;
}

// How the user's wish to stop is carried out.
StopMode TPlaySound::StopOnDemand() const {
    return Crossover() == coAlways ? StopMode::Fade : StopMode::AtOnce;
}

bool TPlaySound::ClickMenuItem(int id) {
    switch (id) {
        case plPlay:
            Play();
            return true;
        case plPause:
            PauseResume();
            return true;
        case plStop:
            Stop(StopOnDemand());
            return true;
        case plPrevious:
            if (playList_) playList_->PlayPrevious(ChangeOnDemand());
            return true;
        case plNext:
            if (playList_) playList_->PlayNext(ChangeOnDemand());
            return true;
        case plBack:
            MoveBy(-kStep);
            return true;
        case plForward:
            MoveBy(kStep);
            return true;
        case plMarkSong:
            MarkSong();
            return true;
        default:
            return false;
    }
}

void TPlaySound::MoveBy(qint64 milliseconds) {
    const qint64 end = GetLength() > 0 ? GetLength() : std::numeric_limits<quint32>::max();
    SetPosition(static_cast<quint32>(std::clamp(GetPosition() + milliseconds, qint64{0}, end)));
}

void TPlaySound::MarkSong() {
    if (database_) database_->MarkSong(SongInDatabase());
}

// The song that plays; -1 when the collection does not have it. What plays can be a copy of what is listed.
SongIndex TPlaySound::SongInDatabase() const {
    if (!database_) return -1;
    const SongIndex song = database_->IndexOf(fileName_);
    if (song >= 0 || !playList_ || playList_->CurrentFile() != fileName_) return song;
    return database_->IndexOf(playList_->CurrentSong());
}
