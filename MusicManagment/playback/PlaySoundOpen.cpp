#include <QScopeGuard>
#include <utility>

#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/playback/ExternalTarget.h"
#include "MusicManagment/playback/PlaySound.h"

// Opening a song, here or in the external player.

using namespace Qt::StringLiterals;

void TPlaySound::SetFileName(const QString& path) {
    if (path != fileName_ && !path.isEmpty()) playCount_.Arm();
    fileName_ = path;
    Close();
    if (fileName_.isEmpty()) return ClearPanel();
    // What shows the player must not go on showing the song before.
    auto show = qScopeGuard([this] { StateChanged(); });
    Open();
    if (autoPlay_) Play();
    show.dismiss();
}

void TPlaySound::Open() {
    if (playList_) playList_->RedrawView();
    if (!FileSource::Exists(fileName_)) return ClearPanel();
    RequireEngine(fileName_, settings_);
    StopTimers();
    PlayTarget& target = Reached(QString());
    GuardOutput(false, [&] { target.Open(fileName_); });
}

void TPlaySound::Close() {
    if (playExtern_) external_->Close();
    StopTimers();
    waiting_.reset();
    released_.reset();
    engines_.Close();
}

void TPlaySound::ClearPanel() {
    if (panel_ != nullptr) panel_->Clear();
    RedrawPanel();
}

// --- The external player ---

void TPlaySound::SetExternalPlayer(std::unique_ptr<ExternalPlayer> player) {
    if (playExtern_) SetPlayExtern(false);
    FeedbackReceiver& receiver = *this;
    external_ = player ? std::make_unique<ExternalTarget>(std::move(player), receiver, settings_) : nullptr;
}

void TPlaySound::SetPlayExtern(bool value) {
    if (value == playExtern_ || !external_) return;
    Close();
    playExtern_ = value;
    if (!fileName_.isEmpty()) Open();
}

// Where songs play now.
PlayTarget& TPlaySound::Chosen() {
    if (playExtern_) return *external_;
    return engines_;
}

// The same, ready for a command. An external player that has to be started anew gets the song first; one that
// cannot be reached gives it back.
PlayTarget& TPlaySound::Reached(const QString& song) {
    if (!Chosen().Reach(song)) {
        PlayInternally();
        if (!song.isEmpty()) Open();
    }
    return Chosen();
}

void TPlaySound::PlayInternally() {
    playExtern_ = false;
    StopTimers();
    engines_.Close();
    TellWhileOpening(MessageKind::Error,
                     u"Kann das Programm TSPlayer nicht starten. Der Sound wird intern abgespielt."_s);
}
