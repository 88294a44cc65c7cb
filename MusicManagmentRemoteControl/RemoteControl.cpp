#include "MusicManagmentRemoteControl/RemoteControl.h"

#include <utility>

#include "CommonRUKTools/CodePage.h"
#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/database/CdPath.h"
#include "MusicManagment/database/commands/DatabaseSettings.h"
#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playlist/PlayList.h"
#include "MusicManagmentRemoteControl/LineDialogs.h"
#include "MusicManagmentRemoteControl/MessageTable.h"

using namespace Qt::StringLiterals;

TRemoteControl::TRemoteControl(std::unique_ptr<RemoteChannel> channel, QObject* parent)
    : QObject(parent), channel_(std::move(channel)) {
    channel_->Open(*this);
}

TRemoteControl::~TRemoteControl() {
    SetPlaySound(nullptr);
    SetPlayList(nullptr);
    SetMusicDatabase(nullptr);
    channel_->Close();
}

// --- Wiring ---

void TRemoteControl::SetMusicDatabase(TMusicDatabase* database) {
    if (database == database_) return;
    if (database_) {
        database_->LeaveSettings(*this);
        if (database_->RemoteControl() == this) database_->SetRemoteControl(nullptr);
    }
    database_ = database;
    if (database == nullptr) return;
    database->SetRemoteControl(this);
    database->JoinSettings(*this);
}

void TRemoteControl::SetPlayList(TPlayList* playList) {
    if (playList == playList_) return;
    if (playList_ && playList_->RemoteControl() == this) playList_->SetRemoteControl(nullptr);
    playList_ = playList;
    if (playList != nullptr) playList->SetRemoteControl(this);
}

void TRemoteControl::SetPlaySound(TPlaySound* player) {
    if (player == playSound_) return;
    player_.End();
    if (playSound_) {
        disconnect(playSound_, nullptr, this, nullptr);
        if (playSound_->RemoteControl() == this) playSound_->SetRemoteControl(nullptr);
    }
    EndWaiting(0);
    playSound_ = player;
    if (player == nullptr) return;
    player->SetRemoteControl(this);
    connect(player, &QObject::destroyed, this, [this] { EndWaiting(0); });
    PlayerEvents& events = player->Events();
    player_ += events.ReachedEnd.Subscribe([this] { EndWaiting(1); });
    player_ += events.Stopped.Subscribe([this] { EndWaiting(1); });
    player_ += events.Changed.Subscribe([this] { LookAtSong(); });
}

void TRemoteControl::LoadSettings(const TRWReg& settings) {
    SetEnabled(ReadSetting(settings, DatabaseSettings::kRCEnabled).value_or(Enabled()));
}

void TRemoteControl::SaveSettings(TRWReg& settings) const {
    WriteSetting(settings, DatabaseSettings::kRCEnabled, Enabled());
}

// --- Messages ---

template <typename Action>
void TRemoteControl::Carry(Action&& action) {
    std::optional<LineDialogs> lines;
    if (OnTell) lines.emplace(OnTell);
    RunCommand(action);
}

std::optional<qint32> TRemoteControl::Receive(quint32 message, quint32 p, quint32 l) {
    if (!enabled_) return HandleByDefault(message);
    std::optional<qint32> answer = 0;
    Carry([&] { answer = Handle(message, p, l); });
    return answer;
}

// What happens to every message that nobody handles.
qint32 TRemoteControl::HandleByDefault(quint32 message) {
    if (message == rmClose) channel_->Close();
    return 0;
}

std::optional<qint32> TRemoteControl::Handle(quint32 message, quint32 p, quint32 l) {
    std::optional<qint32> answer = 0;
    switch (message) {
        case rmClose:
            if (OnCloseProgram) OnCloseProgram();
            break;
        case rmEndRemote:
            return HandleByDefault(rmClose);
        case rmWaitForEnd:
            answer = WaitForEnd();
            break;
        default: {
            const RemoteParts parts{database_, playList_, playSound_,
                                    [this](quint32 window, quint32 code, const QByteArray& bytes) {
                                        return channel_->SendCopyData(window, code, bytes);
                                    }};
            answer = HandleRemoteMessage(parts, message, p, l);
            if (!answer) return HandleByDefault(message);
        }
    }
    if (OnEventFired) OnEventFired(*this);
    return answer;
}

// As from other programs a text may end with a 0.
qint32 TRemoteControl::ReceiveCopyData(quint32 code, const QByteArray& bytes) {
    if (!enabled_ || code != kRemoteOpenFile) return HandleByDefault(rmCopyData);
    if (!playSound_) return 0;
    qint32 answer = 0;
    Carry([&] {
        const QByteArray text = bytes.split('\0').first();
        const QString name = CodePage::FromLegacy(
            {reinterpret_cast<const std::uint8_t*>(text.constData()), static_cast<std::size_t>(text.size())});
        playSound_->SetFileName(name);
        // The player passes over it without a word.
        if (!name.isEmpty() && !IsCdPath(name) && !FileSource::Exists(name))
            throw ERemoteControlException(u"Datei nicht gefunden: "_s + name);
        answer = 1;
        if (OnEventFired) OnEventFired(*this);
    });
    return answer;
}

// --- Waiting for the end of the song ---

std::optional<qint32> TRemoteControl::WaitForEnd() {
    if (!playSound_) return 0;
    LookAtSong();
    if (awaited_.isEmpty()) awaited_ = playSound_->FileName();
    if (!SongIsOver()) return std::nullopt;
    awaited_.clear();
    return 1;
}

// Also when another one has begun: by a cross-fade a song goes without reaching its end.
bool TRemoteControl::SongIsOver() const {
    const TPSStatus status = playSound_->GetStatus();
    return status == psClosed || status == psStopped || playSound_->FileName() != awaited_;
}

void TRemoteControl::LookAtSong() {
    if (!awaited_.isEmpty() && SongIsOver()) EndWaiting(1);
}

void TRemoteControl::EndWaiting(qint32 answer) {
    if (std::exchange(awaited_, {}).isEmpty()) return;
    channel_->AnswerWaiting(answer);
}
