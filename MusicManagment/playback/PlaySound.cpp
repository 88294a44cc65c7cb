#include "MusicManagment/playback/PlaySound.h"

#include <QEventLoop>
#include <QScopeGuard>
#include <QThread>
#include <algorithm>
#include <limits>
#include <utility>

#include "CommonRUKTools/Clock.h"
#include "CommonRUKTools/CommandDispatcher.h"
#include "MusicManagment/playback/ExternalTarget.h"
#include "MusicManagment/playback/PlaySoundMenu.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kWaitRound = 250;  // ms
constexpr qint64 kStep = 10000;  // ms, of the menu's commands back and forward

}  // namespace

TPlaySound::TPlaySound(EngineTable engines, QObject* parent)
    : TPlaySoundContainer(parent),
      engines_(std::move(engines), settings_,
               {.FadesWanted = [this] { return FadesWanted(); },
                .TellRefusal = [this](const QString& text) { TellRefusal(text); }}),
      timers_({.Tick = [this] { RunHandler(&TPlaySound::Tick); },
               .EndOfSong = [this] { RunHandler(&TPlaySound::HandleEndOfSong); },
               .AutoStop = [this] { RunHandler(&TPlaySound::HandleAutoStop); },
               .Output = [this] { RunHandler(&TPlaySound::LookForOutput); }}) {
    ForwardEvents();
}

TPlaySound::~TPlaySound() {
    SetPlayList(nullptr);
    SetMusicDatabase(nullptr);
}

void TPlaySound::ForwardEvents() {
    const auto forward = [this](Listeners<>& event, TNotifyEvent TPlaySound::*member) {
        forwarding_ += event.Subscribe([this, member] {
            if (this->*member) (this->*member)(*this);
        });
    };
    forward(events_.Started, &TPlaySound::OnPlayingStarted);
    forward(events_.Stopped, &TPlaySound::OnPlayingStopped);
    forward(events_.Paused, &TPlaySound::OnPlayingPaused);
    forward(events_.Resumed, &TPlaySound::OnPlayingResumed);
    forward(events_.ReachedEnd, &TPlaySound::OnReachedEndOfSong);
    forward(events_.Crossover, &TPlaySound::OnCrossover);
    forwarding_ += events_.Playing.Subscribe([this](quint32 position) {
        if (OnPlaying) OnPlaying(*this, position);
    });
}

// --- Playing ---

void TPlaySound::Play() {
    PlayTarget& target = Reached(fileName_);
    if (waiting_) return GoOn();
    GuardOutput(false, [&] {
        switch (target.Play()) {
            case Carried::Out:
                StartTimers();
                return AnnounceSong();
            case Carried::OnItsWay:
                return RestartAutoStop();
            case Carried::Not:
                return;
        }
    });
}

void TPlaySound::AnnounceSong() {
    events_.Started.Tell();
    Feedback(fbStarted);
    ShowSong();
}

void TPlaySound::ShowSong() {
    if (panel_ != nullptr) panel_->ShowSong(fileName_);
    RedrawPanel();
    if (controller_ == nullptr) return;
    controller_->FeedbackFileName(fileName_);
    Feedback(fbStateChanged, 1);
}

void TPlaySound::Stop(StopMode mode) {
    if (playExtern_) timers_.StopAutoStop();
    if (waiting_ && !engines_.IsOpen()) {
        waiting_->Plays = false;
        waiting_->Position = 0;
        return FinishStop();
    }
    auto rest = qScopeGuard([this] { StopTimers(); });  // also when the engine refuses
    const Carried done = Chosen().Stop(mode);
    rest.dismiss();
    if (done != Carried::Out) return;
    waiting_.reset();
    FinishStop();
    if (timers_.TicksExist() && !timers_.Ticking()) RunTick(TickKind::Last);
}

// The timers rest before anybody is told, who may start another song.
void TPlaySound::FinishStop() {
    StopTimers();
    events_.Stopped.Tell();
    Feedback(fbStopped);
    StateChanged();
}

void TPlaySound::PauseResume() {
    PlayTarget& target = Reached(fileName_);
    if (waiting_) return GoOn();
    GuardOutput(true, [&] {
        const Carried done = target.PauseResume();
        if (done == Carried::Not || playExtern_) return;
        const bool plays = done == Carried::Out;
        plays ? StartTimers() : StopTimers();
        (plays ? events_.Resumed : events_.Paused).Tell();
        Feedback(plays ? fbResumed : fbPaused);
        StateChanged();
    });
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

quint32 TPlaySound::GetPosition() {
    if (released_) return released_->Position;
    return waiting_ ? waiting_->Position : Chosen().Position();
}

void TPlaySound::SetPosition(quint32 milliseconds) {
    if (waiting_) waiting_->Position = milliseconds;
    GuardOutput(true, [&] {
        Chosen().SetPosition(milliseconds);
        NoticeResumed();
    });
    events_.Seeked.Tell(milliseconds);
}

// Some engines play on from where they are sent, also when they were paused.
void TPlaySound::NoticeResumed() {
    if (playExtern_ || waiting_ || timers_.Ticking() || engines_.Status() != psPlaying) return;
    StartTimers();
    events_.Resumed.Tell();
    Feedback(fbResumed);
    StateChanged();
}

quint32 TPlaySound::GetLength() {
    if (released_) return released_->Length;
    return waiting_ ? waiting_->Length : Chosen().Length();
}

TPSStatus TPlaySound::GetStatus() {
    if (released_) return released_->Status;
    if (waiting_) return waiting_->Plays ? psPaused : psStopped;
    return Chosen().Status();
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
    if (playExtern_) external_->TellChanges(former);
}

void TPlaySound::SetGain(float gain) {
    engines_.SetGain(gain);
}

// --- Wiring ---

void TPlaySound::SetMusicDatabase(TMusicDatabase* database) {
    if (database == database_) return;
    renaming_.End();
    if (database_) {
        database_->LeaveSettings(*this);
        if (database_->PlaySound() == this) {
            database_->SetPlaySound(nullptr);
            database_->OnReleaseFile = nullptr;
            database_->OnMeasureLength = nullptr;
        }
    }
    database_ = database;
    if (database == nullptr) return;
    database->SetPlaySound(this);
    database->JoinSettings(*this);
    database->OnReleaseFile = [this](const QString& path) { return ReleaseFile(path); };
    database->OnMeasureLength = [this](const QString& path) { return MeasureLength(path); };
    renaming_ =
        database->Events().Renamed.Subscribe([this](const PathChanges& renamed) { FollowRenamed(renamed); });
}

quint32 TPlaySound::MeasureLength(const QString& path) const {
    if (!engines_.Table().AskLength) throw ENoLengthMeasure(u"Dieses Programm hat keinen Weg dorthin."_s);
    // The other player has one song at a time.
    if (engines_.Engine() == TEngine::WinAmp)
        throw ENoLengthMeasure(u"Der Player spielt dort gerade einen Song ab."_s);
    try {
        return engines_.Table().AskLength(path, settings_);
    } catch (const EWinAmpMissing& error) {
        throw ENoLengthMeasure(error.Message());
    }
}

void TPlaySound::SetPlayList(TPlayList* playList) {
    if (playList == playList_) return;
    if (playList_ && playList_->PlaySound() == this) playList_->SetPlaySound(nullptr);
    playList_ = playList;
    if (playList != nullptr) playList->SetPlaySound(this);
}

void TPlaySound::RedrawPanel() {
    if (panel_ != nullptr) panel_->Redraw();
    events_.Changed.Tell();
}

// --- Commands ---

void TPlaySound::MoveBy(qint64 milliseconds) {
    const qint64 end = GetLength() > 0 ? GetLength() : std::numeric_limits<quint32>::max();
    SetPosition(static_cast<quint32>(std::clamp(GetPosition() + milliseconds, qint64{0}, end)));
}

void TPlaySound::MarkSong() {
    if (database_) database_->MarkSong(SongInDatabase());
}

// What plays can be a copy of what is listed.
SongIndex TPlaySound::SongInDatabase() const {
    if (!database_) return -1;
    const SongIndex song = database_->IndexOf(fileName_);
    if (song >= 0 || !playList_ || playList_->CurrentFile() != fileName_) return song;
    return database_->IndexOf(playList_->CurrentSong());
}

namespace {

constexpr ComponentCommand<TPlaySound> kRows[] = {
    {.Id = plPlay,
     .Caption = u"Play",
     .Keys = u"F5",
     .Icon = u"media-playback-start",
     .Run = [](TPlaySound& player, int) { player.Play(); },
     .Image = 69},
    {.Id = plPause,
     .Caption = u"Pause",
     .Keys = u"F6",
     .Icon = u"media-playback-pause",
     .Run = [](TPlaySound& player, int) { player.PauseResume(); },
     .Image = 70},
    {.Id = plBack,
     .Caption = u"10 Sek zurück",
     .Keys = u"Alt+Left",
     .Icon = u"media-seek-backward",
     .Run = [](TPlaySound& player, int) { player.MoveBy(-kStep); },
     .Image = 74},
    {.Id = plForward,
     .Caption = u"10 Sek vor",
     .Keys = u"Alt+Right",
     .Icon = u"media-seek-forward",
     .Run = [](TPlaySound& player, int) { player.MoveBy(kStep); },
     .Image = 75},
    {.Id = plMarkSong,
     .Caption = u"Aktuelles Lied markieren",
     .Icon = u"go-jump",
     .Run = [](TPlaySound& player, int) { player.MarkSong(); },
     .Image = 76},
};

}  // namespace

constinit const PlayerCommands kSongCommands = kRows;
