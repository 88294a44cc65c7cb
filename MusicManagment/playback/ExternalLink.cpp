#include "MusicManagment/playback/ExternalLink.h"

#include "MusicManagment/playback/backend/EngineErrors.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kLooks = 30;
constexpr int kLookEvery = 100;  // ms

#ifdef Q_OS_WIN
constexpr QStringView kProgram = u"TSPlayer.exe";
#else
constexpr QStringView kProgram = u"TSPlayer";
#endif

}  // namespace

ExternalLink::Reached ExternalLink::Find(const EngineSettings& settings) {
    const auto found = player_->Find();
    if (!found) return Reached::No;
    if (known_ == found) return Reached::Known;
    Greet(settings);
    known_ = found;
    return Reached::New;
}

ExternalLink::Reached ExternalLink::FindOrStart(const EngineSettings& settings) {
    const Reached running = Find(settings);
    if (running != Reached::No || !Start()) return running;
    for (int look = 0; look < kLooks; ++look) {
        player_->Wait(kLookEvery);
        const Reached reached = Find(settings);
        if (reached != Reached::No) return reached;
    }
    return Reached::No;
}

bool ExternalLink::Start() {
    const QString program = kProgram.toString();
    const QString argument = u"/NoVisible"_s;
    return player_->Start(program, argument) || player_->Start(u"TSPlayer/"_s + program, argument);
}

void ExternalLink::Greet(const EngineSettings& settings) {
    MakeFeedback();
    Send(ecFeedbackHandle, *feedback_);
    ForEachSetting(PlayerSettings::kEngines,
                   [&](const auto& setting) { SendSetting(setting.Command, setting.Of(settings)); });
}

void ExternalLink::MakeFeedback() {
    if (feedback_) return;
    if (!player_->RegisterFeedback())
        throw EPlaySoundException(
            u"Fehler beim Erstellen eines Hilfs-Fensters für EPS-FeedBacks (RegisterClass fehlgeschlagen)"_s);
    feedback_ = player_->CreateFeedback(receiver_);
    if (!feedback_)
        throw EPlaySoundException(
            u"Fehler beim Erstellen eines Hilfs-Fensters für EPS-FeedBacks (CreateWindow fehlgeschlagen)"_s);
}

void ExternalLink::SendChanges(const EngineSettings& before, const EngineSettings& after) {
    if (!Runs()) return;  // a new one is told everything when it is met
    ForEachSetting(PlayerSettings::kEngines, [&](const auto& setting) {
        if (setting.Of(before) != setting.Of(after)) SendSetting(setting.Command, setting.Of(after));
    });
}
