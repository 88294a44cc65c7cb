#include "MusicManagment/playback/SongOpener.h"

#include <QScopeGuard>
#include <utility>

#include "MusicManagment/playback/backend/EngineErrors.h"

using namespace Qt::StringLiterals;

TEngine RequireEngine(const QString& path, const EngineSettings& settings) {
    const auto engine = ChooseEngine(path, settings);
    if (!engine)
        throw EPlaySoundException(
            u"Keine Engine zum Verwenden freigegeben (UseFMOD, UseMCI, UseEldoS, UseWinAmp, ...)"_s);
    return *engine;
}

SongOpener::SongOpener(EngineTable table, const EngineSettings& settings,
                       std::function<void(const QString&)> tell)
    : table_(std::move(table)), settings_(settings), tell_(std::move(tell)) {}

SongOpener::Opened SongOpener::Open(const QString& path) {
    const auto forget = qScopeGuard([this] { opened_.reset(); });
    OpenWithFallBack(RequireEngine(path, settings_), path);
    return {std::move(opened_), engine_};
}

std::unique_ptr<TPlaySoundContainer> SongOpener::OpenIn(TEngine engine, const QString& path) {
    Song song = Make(engine, path);
    song->Open();
    return song;
}

void SongOpener::Abandon() {
    ++generation_;
    opening_.reset();
    opened_.reset();
}

SongOpener::Song SongOpener::Make(TEngine engine, const QString& path) const {
    Song song = table_.Create(engine, settings_);
    song->SetBackendFile(path);
    return song;
}

// An engine that refuses here hands over to those behind it. While a song waits for its engine others may
// abandon it.
void SongOpener::OpenWithFallBack(TEngine engine, const QString& path) {
    const auto forget = qScopeGuard([this, before = generation_] {
        if (generation_ == before) opening_.reset();
    });
    opened_.reset();
    try {
        opening_ = Make(engine, path);
        const unsigned before = generation_;
        opening_->Open();
        if (generation_ != before) throw EAbort();
        opened_ = std::move(opening_);
        engine_ = engine;
    } catch (const EFMODException& error) {
        if (!OpenInEnginesAfter(TEngine::FMOD, path, error.Message())) throw;
    } catch (const EEldoSException& error) {
        if (!OpenInEnginesAfter(TEngine::EldoS, path, error.Message())) throw;
    } catch (const EMCIException& error) {
        if (!OpenInEnginesAfter(TEngine::MCI, path, error.Message())) throw;
    }
}

// Deliberately goes on after the first engine that works: each replaces the one before, so that the last one
// that is allowed plays the song. False when there is none to go on with.
bool SongOpener::OpenInEnginesAfter(TEngine failed, const QString& path, const QString& message) {
    opening_.reset();
    const std::vector<TEngine> engines = EnginesAfter(failed, settings_);
    for (const TEngine engine : engines) {
        const unsigned before = generation_;
        tell_(message + u"\r\nVersuche "_s + EngineName(engine));
        if (generation_ != before) throw EAbort();
        OpenWithFallBack(engine, path);
    }
    return !engines.empty();
}
