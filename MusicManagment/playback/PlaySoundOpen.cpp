#include <QScopeGuard>
#include <utility>

#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/playback/ExternalLink.h"
#include "MusicManagment/playback/PlaySound.h"

// Opening a song: in which engine, in which other engines when that one refuses, or in the external player.

using namespace Qt::StringLiterals;

void TPlaySound::SetFileName(const QString& path) {
    if (path != fileName_ && !path.isEmpty()) playCount_.Arm();
    fileName_ = path;
    Close();
    if (fileName_.isEmpty()) return ClearPanel();
    Open();
    if (autoPlay_) Play();
}

void TPlaySound::Open() {
    if (playList_) playList_->RedrawView();
    if (!FileSource::Exists(fileName_)) return ClearPanel();
    const auto engine = ChooseEngine(fileName_, settings_);
    if (!engine)
        throw EPlaySoundException(
            u"Keine Engine zum Verwenden freigegeben (UseFMOD, UseMCI, UseEldoS, UseWinAmp, ...)"_s);
    CreateBackend(*engine, QString());
}

void TPlaySound::Close() {
    ++generation_;
    if (ExternalRuns()) {
        external_->Send(ecClose);
        external_->Send(ecCloseFading);
    }
    CloseBackends();
}

void TPlaySound::CloseBackends() {
    StopTimers();
    current_.reset();
    opening_.reset();
    fading_.reset();
}

void TPlaySound::ClearPanel() {
    if (panel_ == nullptr) return;
    panel_->Clear();
    panel_->Redraw();
}

// --- Engines ---

TPlaySound::Backend TPlaySound::MakeBackend(TEngine engine, const QString& path) const {
    Backend backend = engineTable_.Create(engine, settings_);
    backend->SetBackendFile(path);
    return backend;
}

// Where others may close it while it waits for its engine. Full loudness is what engines begin with; another
// program that plays may have one of its own, which stays.
void TPlaySound::OpenBackend(TEngine engine) {
    const auto forget = qScopeGuard([this] { opening_.reset(); });
    opening_ = MakeBackend(engine, fileName_);
    opening_->Open();
    if (!opening_) throw EAbort();
    current_ = std::move(opening_);
    engine_ = engine;
    if (gain_ < 1) SetGain(gain_);
}

// A message tells why another engine has refused. An engine that refuses here hands over to those behind it.
void TPlaySound::CreateBackend(TEngine engine, const QString& message) {
    if (!message.isEmpty())
        TellWhileOpening(MessageKind::Warning, message + u"\r\nVersuche "_s + EngineName(engine));
    if (OpenExternally()) return;
    StopTimers();
    current_.reset();
    try {
        OpenBackend(engine);
    } catch (const EFMODException& error) {
        if (!CreateBackendsAfter(TEngine::FMOD, error.Message())) throw;
    } catch (const EEldoSException& error) {
        if (!CreateBackendsAfter(TEngine::EldoS, error.Message())) throw;
    } catch (const EMCIException& error) {
        if (!CreateBackendsAfter(TEngine::MCI, error.Message())) throw;
    }
}

// Deliberately goes on after the first engine that works: each replaces the one before, so that the last one
// that is allowed plays the song. False when there is none to go on with.
bool TPlaySound::CreateBackendsAfter(TEngine failed, const QString& message) {
    CloseBackends();
    const std::vector<TEngine> engines = EnginesAfter(failed, settings_);
    for (const TEngine engine : engines)
        CreateBackend(engine, message);
    return !engines.empty();
}

// --- The external player ---

void TPlaySound::SetExternalPlayer(std::unique_ptr<ExternalPlayer> player) {
    if (playExtern_) SetPlayExtern(false);
    FeedbackReceiver& receiver = *this;
    external_ = player ? std::make_unique<ExternalLink>(std::move(player), receiver) : nullptr;
}

void TPlaySound::SetPlayExtern(bool value) {
    if (value == playExtern_ || !external_) return;
    Close();
    playExtern_ = value;
    if (!fileName_.isEmpty()) Open();
}

bool TPlaySound::ExternalRuns() {
    return playExtern_ && external_->Runs();
}

// Hands the song over. False when songs are played here, be it from now on.
bool TPlaySound::OpenExternally() {
    if (!playExtern_) return false;
    if (external_->FindOrStart(settings_) == ExternalLink::Reached::No) {
        PlayInternally();
        return false;
    }
    external_->SendText(ecOpenFile, fileName_);
    return true;
}

// Whether an operation is the external player's. One that has to be started anew gets the song first.
bool TPlaySound::UseExternal() {
    if (!playExtern_) return false;
    const auto reached = external_->FindOrStart(settings_);
    if (reached == ExternalLink::Reached::No) {
        PlayInternally();
        if (!fileName_.isEmpty()) Open();
        return false;
    }
    if (reached == ExternalLink::Reached::New && !fileName_.isEmpty())
        external_->SendText(ecOpenFile, fileName_);
    return true;
}

void TPlaySound::PlayInternally() {
    playExtern_ = false;
    CloseBackends();
    TellWhileOpening(MessageKind::Error,
                     u"Kann das Programm TSPlayer nicht starten. Der Sound wird intern abgespielt."_s);
}

// Whoever opens or closes a song while the message stands has the last word.
void TPlaySound::TellWhileOpening(MessageKind kind, const QString& text) {
    const unsigned before = generation_;
    UserDialogs().ShowMessage(kind, text);
    if (generation_ != before) throw EAbort();
}
