#include "MusicManagment/playback/winamp/WinAmpPlaySound.h"

#include <QDBusObjectPath>
#include <QFileInfo>
#include <QPointer>
#include <QUrl>
#include <cmath>
#include <limits>

#include "CommonRUKTools/Clock.h"
#include "MusicManagment/playback/winamp/Waiting.h"

using namespace Qt::StringLiterals;

namespace {

constexpr QStringView kDefaultClass = u"WinAmp v1.x";
constexpr QStringView kDefaultFile = u"WinAmp.exe";

// Milliseconds. Players take this long to tell what they have been told.
constexpr qint64 kAssumed = 1500;
// A position that has grown counts as playing for so long: some players call themselves stopped meanwhile.
constexpr qint64 kMoving = 1000;
// Further off than this the position cannot be, unless the player has not gone there yet.
constexpr qint64 kOff = 1500 * 1000;  // microseconds
constexpr qint64 kAskAgain = 50;
// A song that was left so close to its end has ended by itself.
constexpr qint64 kCloseToEnd = 2000 * 1000;  // microseconds

qint64 Now() {
    return CurrentClock().Ticks();
}

bool IsSameFile(const QString& one, const QString& other) {
    if (one == other) return true;
    const QString canonical = QFileInfo(one).canonicalFilePath();
    return !canonical.isEmpty() && canonical == QFileInfo(other).canonicalFilePath();
}

quint32 ToMilliseconds(qint64 microseconds) {
    return static_cast<quint32>(
        qBound(qint64{0}, microseconds / 1000, qint64{std::numeric_limits<quint32>::max()}));
}

QString Seconds(int milliseconds) {
    return QString::number((milliseconds + 999) / 1000);
}

[[noreturn]] void Throw(const QString& message) {
    throw EWinAmpException(message);
}

[[noreturn]] void ThrowMissing(const QString& message) {
    throw EWinAmpMissing(message);
}

// The place of a name on the bus among the players that are known to work, their number for another one.
qsizetype RankOf(const QString& name) {
    const QStringList known = KnownPlayers();
    const auto found =
        std::ranges::find_if(known, [&name](const QString& player) { return IsPlayerNamed(name, player); });
    return found - known.begin();
}

bool IsKnown(const QString& name) {
    return RankOf(name) < KnownPlayers().size();
}

}  // namespace

// Tells whether this song has been closed or destroyed since: then there is nothing to go on with.
std::function<bool()> TWinAmpPlaySound::Disturbance() const {
    return [self = QPointer(this), generation = generation_] {
        return self.isNull() || self->generation_ != generation;
    };
}

template <typename Waiting>
auto TWinAmpPlaySound::Undisturbed(Waiting waiting) {
    const std::function<bool()> disturbed = Disturbance();
    auto result = waiting();
    if (disturbed()) throw EAbort();
    return result;
}

TWinAmpPlaySound::TWinAmpPlaySound(const TWinAmpSettings& settings, QObject* parent)
    : TPlaySoundContainer(parent), settings_(settings) {
    holdTimer_.setSingleShot(true);
    connect(&holdTimer_, &QTimer::timeout, this, &TWinAmpPlaySound::Hold);
}

TWinAmpPlaySound::~TWinAmpPlaySound() {
    TWinAmpPlaySound::Close();
}

// A player begins to play what it opens. It is held as soon as nobody has asked to play it in the same
// breath.
void TWinAmpPlaySound::Open() {
    Close();
    Load();
    wish_ = Wish::Stopped;
    AssumePosition(0);
    holdTimer_.start(0);
}

void TWinAmpPlaySound::Close() {
    ++generation_;
    holdTimer_.stop();
    if (player_ && !over_) player_->Send(u"Stop"_s);
    player_.reset();
    asked_.reset();
    wish_ = Wish::Nothing;
    state_ = {};
    over_ = false;
}

void TWinAmpPlaySound::Play() {
    if (wish_ == Wish::Nothing || (wish_ == Wish::Playing && GetStatus() == psPlaying)) return;
    holdTimer_.stop();
    MprisState state;
    const auto answer = Undisturbed([player = player_, &state] { return player->ReadState(state); });
    const bool isThere = answer == MprisPlayer::Answer::Done && IsSameFile(state.File, BackendFile());
    if (isThere && !over_)
        TakeNew(state);
    else
        Load();
    if (state_.Status != "Playing"_L1) CallOrThrow(u"Play"_s);
    Assume(Wish::Playing);
}

// Not the player's own stop: some players forget the song then, or end.
void TWinAmpPlaySound::Stop() {
    if (wish_ == Wish::Nothing) return;
    holdTimer_.stop();
    if (!over_) {
        CallOrThrow(u"Pause"_s);
        if (!over_ && !TrySetPosition(0)) CallOrThrow(u"Stop"_s);
    }
    Assume(Wish::Stopped);
    AssumePosition(0);
}

void TWinAmpPlaySound::PauseResume() {
    const TPSStatus status = GetStatus();
    if (status == psPaused) return Play();
    if (status != psPlaying) return;
    CallOrThrow(u"Pause"_s);
    AssumePosition(PositionNow());
    Assume(Wish::Paused);
}

void TWinAmpPlaySound::SetPosition(quint32 milliseconds) {
    if (wish_ == Wish::Nothing) return;
    qint64 target = qint64{milliseconds} * 1000;
    if (state_.Length > 0) target = qMin(target, state_.Length);
    if (!TrySetPosition(target)) Throw(u"Fehler beim Setzen der neuen Position."_s);
    AssumePosition(target);
    soughtUntil_ = Now() + kAssumed;
}

quint32 TWinAmpPlaySound::GetPosition() {
    Follow();
    return ToMilliseconds(PositionNow());
}

quint32 TWinAmpPlaySound::GetLength() {
    Follow();
    return ToMilliseconds(state_.Length);
}

quint32 TWinAmpPlaySound::AskLength() {
    if (wish_ == Wish::Nothing) return 0;
    MprisState state = state_;
    const auto isKnown = [player = player_, file = BackendFile(), &state] {
        return state.Length > 0 || (player->ReadState(state) == MprisPlayer::Answer::Done &&
                                    IsSameFile(state.File, file) && state.Length > 0);
    };
    const bool told = Undisturbed([&isKnown, disturbed = Disturbance(), timeout = settings_.FileTimeout] {
        return WaitUntil([&] { return disturbed() || isKnown(); }, timeout);
    });
    if (!told)
        Throw(u"Der Player "_s + player_->PlainName() + u" nennt keine Länge der Datei "_s + BackendFile() +
              u"."_s);
    state_.Length = state.Length;
    return ToMilliseconds(state.Length);
}

// Players understand volume as it is set on a slider: about the root of the amplitude.
void TWinAmpPlaySound::SetGain(float gain) {
    if (player_) player_->SendVolume(std::sqrt(static_cast<double>(gain)));
}

TPSStatus TWinAmpPlaySound::GetStatus() {
    Follow();
    if (wish_ == Wish::Nothing) return psClosed;
    if (wish_ == Wish::Stopped || over_) return psStopped;
    if (IsPlaying()) return psPlaying;
    return IsAssumed() || state_.Status == "Paused"_L1 ? psPaused : psStopped;
}

void TWinAmpPlaySound::Load() {
    if (!settings_.Bus.isConnected())
        ThrowMissing(u"Es gibt keinen Sitzungsbus (D-Bus), über den ein Player gesteuert werden könnte."_s);
    Player player = FindPlayer();
    if (!player || !HandFileOver(player)) player = StartAndWait();
    // From here on it is to be stopped when the song is closed; without one the former stays.
    player_ = player;
    over_ = false;
    asked_.reset();
    WaitForFile(player);
}

TWinAmpPlaySound::Player TWinAmpPlaySound::FindPlayer() {
    const int timeout = settings_.AnswerTimeout;
    const bool any = settings_.ClassName == kDefaultClass;
    QStringList names = Undisturbed([bus = settings_.Bus, timeout] { return RunningPlayers(bus, timeout); });
    if (!any)
        names.removeIf([this](const QString& name) { return !IsPlayerNamed(name, settings_.ClassName); });
    std::ranges::stable_sort(names, {}, RankOf);
    for (const QString& name : names) {
        auto player = std::make_shared<const MprisPlayer>(settings_.Bus, name, timeout);
        // A web browser, for instance, is a player on the bus that opens no files. Some that do name only the
        // addresses that they take besides.
        if (!any || IsKnown(name) || Undisturbed([player] { return player->TakesFiles(); })) return player;
    }
    return nullptr;
}

PlayerProgram TWinAmpPlaySound::ProgramToStart() const {
    QString name = settings_.File;
    if (name == kDefaultFile) {
        if (settings_.ClassName == kDefaultClass) {
            if (auto program = FindKnownPlayer()) return *program;
            ThrowMissing(u"Es läuft kein Player, und keiner von diesen ist installiert: "_s +
                         KnownPlayers().join(u", "_s) + u"."_s);
        }
        name = settings_.ClassName.toLower();
    }
    if (auto program = FindPlayerProgram(name)) return *program;
    ThrowMissing(u"Kann den Player "_s + name + u" nicht finden."_s);
}

TWinAmpPlaySound::Player TWinAmpPlaySound::StartAndWait() {
    const PlayerProgram program = ProgramToStart();
    const std::optional<qint64> process = StartPlayer(program, BackendFile());
    if (!process) ThrowMissing(u"Kann den Player "_s + program.Path + u" nicht starten."_s);
    Player player;
    Undisturbed([this, &player, disturbed = Disturbance(), timeout = settings_.StartTimeout] {
        return WaitUntil([&] { return disturbed() || (player = FindPlayer()) != nullptr; }, timeout);
    });
    if (player) return player;
    EndPlayer(program, *process);
    ThrowMissing(u"Der Player "_s + program.Path + u" hat sich nicht innerhalb von "_s +
                 Seconds(settings_.StartTimeout) + u" Sekunden gemeldet."_s);
}

// False when the player has gone.
bool TWinAmpPlaySound::HandFileOver(const Player& player) {
    const QString address = QString::fromUtf8(QUrl::fromLocalFile(BackendFile()).toEncoded());
    const auto answer = Undisturbed([player, &address] { return player->Call(u"OpenUri"_s, {address}); });
    switch (answer) {
        case MprisPlayer::Answer::Done:
            return true;
        case MprisPlayer::Answer::NotSupported:
            StartAgainWithFile(*player);
            return true;
        case MprisPlayer::Answer::Gone:
            return false;
        case MprisPlayer::Answer::Failed:
            break;
    }
    Throw(u"Der Player "_s + player->PlainName() + u" nimmt die Datei "_s + BackendFile() + u" nicht an."_s);
}

// A second start of such a player hands the file to the one that runs.
void TWinAmpPlaySound::StartAgainWithFile(const MprisPlayer& player) {
    const QString name = settings_.File == kDefaultFile ? player.PlainName() : settings_.File;
    const std::optional<PlayerProgram> program = FindPlayerProgram(name);
    if (!program || !StartPlayer(*program, BackendFile()))
        ThrowMissing(u"Kann den Player "_s + name + u" nicht starten."_s);
}

void TWinAmpPlaySound::WaitForFile(const Player& player) {
    MprisState state;
    const auto hasFile = [player, file = BackendFile(), &state] {
        return player->ReadState(state) == MprisPlayer::Answer::Done && IsSameFile(state.File, file);
    };
    const bool opened = Undisturbed([&hasFile, disturbed = Disturbance(), timeout = settings_.FileTimeout] {
        return WaitUntil([&] { return disturbed() || hasFile(); }, timeout);
    });
    if (!opened) {
        Throw(u"Der Player "_s + player->PlainName() + u" hat die Datei "_s + BackendFile() +
              u" nicht innerhalb von "_s + Seconds(settings_.FileTimeout) + u" Sekunden geöffnet."_s);
    }
    TakeNew(state);
}

// A player that has gone has stopped playing: that is no failure.
void TWinAmpPlaySound::CallOrThrow(const QString& method) {
    const auto answer = Undisturbed([player = player_, &method] { return player->Call(method); });
    if (answer == MprisPlayer::Answer::Gone) EndSong();
    if (answer == MprisPlayer::Answer::Done || answer == MprisPlayer::Answer::Gone) return;
    Throw(u"Der Player "_s + player_->PlainName() + u" führt den Befehl „"_s + method + u"“ nicht aus."_s);
}

bool TWinAmpPlaySound::TrySetPosition(qint64 microseconds) {
    // A track may have got its identifier since.
    MprisState state;
    const auto told = Undisturbed([player = player_, &state] { return player->ReadState(state); });
    if (told != MprisPlayer::Answer::Done || state.TrackId.isEmpty() || !state.CanSeek) return false;
    const QVariantList arguments{QVariant::fromValue(QDBusObjectPath(state.TrackId)), microseconds};
    return Undisturbed([player = player_, &arguments] {
               return player->Call(u"SetPosition"_s, arguments);
           }) == MprisPlayer::Answer::Done;
}

void TWinAmpPlaySound::Hold() {
    player_->Send(u"Pause"_s);
    if (!state_.TrackId.isEmpty())
        player_->Send(u"SetPosition"_s, {QVariant::fromValue(QDBusObjectPath(state_.TrackId)), qint64{0}});
}

// Takes the answer to the last question and asks the next one; waits for nothing.
void TWinAmpPlaySound::Follow() {
    if (over_ || (wish_ != Wish::Playing && wish_ != Wish::Paused)) return;
    if (asked_) {
        if (!asked_->isFinished()) return;
        MprisState state;
        const auto answer = MprisPlayer::TakeState(asked_->reply(), state);
        asked_.reset();
        if (answer == MprisPlayer::Answer::Gone) return EndSong();
        // A player that is busy tells more the next time.
        if (answer == MprisPlayer::Answer::Done) Take(state);
    }
    if (!over_ && Now() - stateTime_ >= kAskAgain) asked_ = player_->AskState();
}

void TWinAmpPlaySound::Take(const MprisState& state) {
    const bool ours = IsSameFile(state.File, BackendFile());
    if (ours && state.Position > state_.Position) movingUntil_ = Now() + kMoving;
    const bool stopped = state.Status == "Stopped"_L1 && Now() >= movingUntil_;
    if (!ours || stopped) {
        if (!IsAssumed()) EndSong();
        return;
    }
    const qint64 position = PositionNow();
    TakeNew(state);
    if (Now() < soughtUntil_ && qAbs(state.Position - position) > kOff) state_.Position = position;
}

void TWinAmpPlaySound::TakeNew(const MprisState& state) {
    state_ = state;
    stateTime_ = Now();
}

void TWinAmpPlaySound::EndSong() {
    const qint64 position = PositionNow();
    if (state_.Length == 0 || position >= state_.Length - kCloseToEnd)
        state_.Position = state_.Length = qMax(position, state_.Length);
    else
        state_.Position = position;
    over_ = true;
}

// Answers to what was asked before are of no use any more.
void TWinAmpPlaySound::Assume(Wish wish) {
    wish_ = wish;
    assumedUntil_ = Now() + kAssumed;
    asked_.reset();
}

void TWinAmpPlaySound::AssumePosition(qint64 microseconds) {
    state_.Position = microseconds;
    stateTime_ = Now();
    asked_.reset();
}

bool TWinAmpPlaySound::IsAssumed() const {
    return Now() < assumedUntil_;
}

bool TWinAmpPlaySound::IsPlaying() const {
    if (over_ || (wish_ != Wish::Playing && wish_ != Wish::Paused)) return false;
    if (IsAssumed()) return wish_ == Wish::Playing;
    return state_.Status == "Playing"_L1 || (state_.Status == "Stopped"_L1 && Now() < movingUntil_);
}

qint64 TWinAmpPlaySound::PositionNow() const {
    if (!IsPlaying()) return state_.Position;
    const qint64 position = state_.Position + (Now() - stateTime_) * 1000;
    return state_.Length > 0 ? qMin(position, state_.Length) : position;
}
