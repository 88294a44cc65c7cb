#include "MusicManagment/playback/OwnEngines.h"

#include <algorithm>
#include <utility>

#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/playback/backend/EngineErrors.h"
#include "MusicManagment/playback/backend/GainBackend.h"

OwnEngines::OwnEngines(EngineTable engines, const EngineSettings& settings, Hooks hooks)
    : settings_(settings),
      hooks_(std::move(hooks)),
      opener_(std::move(engines), settings, [this](const QString& text) { hooks_.TellRefusal(text); }) {}

// Full loudness is what engines begin with; another program that plays may have one of its own, which stays.
void OwnEngines::Open(const QString& path) {
    opener_.Abandon();
    pair_.SetCurrent(nullptr);
    SongOpener::Opened opened = opener_.Open(path);
    pair_.SetCurrent(std::move(opened.Song));
    engine_ = opened.Engine;
    openedWith_ = settings_;
    if (gain_ < 1) SetGain(gain_);
}

void OwnEngines::Close() {
    pair_.Clear();
    opener_.Abandon();
}

Carried OwnEngines::Play() {
    if (!IsOpen() || pair_.EndFades() || !FileSource::Exists(Song().BackendFile())) return Carried::Not;
    pair_.Play();
    return Carried::Out;
}

Carried OwnEngines::Stop(StopMode mode) {
    if (!IsOpen()) return Carried::Not;
    const bool fade = mode == StopMode::Fade && settings_.FMODCrossoverTime >= kShortestFade;
    // A fade-out runs on the ticks of the player, which rest unless the song plays.
    if (fade && Status() == psPlaying && pair_.StartFadingStop(settings_.FMODCrossoverTime))
        return Carried::OnItsWay;
    pair_.Stop();
    return Carried::Out;
}

Carried OwnEngines::PauseResume() {
    if (!IsOpen()) return Carried::Not;
    return pair_.PauseResume() ? Carried::Out : Carried::OnItsWay;
}

void OwnEngines::SetPosition(quint32 milliseconds) {
    if (IsOpen()) Song().SetPosition(milliseconds);
}

quint32 OwnEngines::Position() {
    try {
        return IsOpen() ? Song().GetPosition() : 0;
    } catch (const ERukException&) {
        return 0;
    }
}

quint32 OwnEngines::Length() {
    try {
        return IsOpen() ? Song().GetLength() : 0;
    } catch (const ERukException&) {
        return 0;
    }
}

TPSStatus OwnEngines::Status() {
    try {
        return IsOpen() ? Song().GetStatus() : psClosed;
    } catch (const EOutputException&) {
        return psPaused;
    } catch (const ERukException&) {
        return psClosed;
    }
}

// The sound library begins anew with these, and takes its songs with it.
bool OwnEngines::LibraryStays() const {
    return openedWith_.FMODSoundOutputTypes == settings_.FMODSoundOutputTypes &&
           openedWith_.FMODMixRate == settings_.FMODMixRate &&
           openedWith_.FMODSoftChannels == settings_.FMODSoftChannels;
}

Carried OwnEngines::CrossFadeTo(const QString& path) {
    // In this order: whoever is asked for the mode may close the song.
    if (!hooks_.FadesWanted() || !CanFade() || !LibraryStays()) return Carried::Not;
    if (!FileSource::Exists(path) || ChooseEngine(path, settings_) != TEngine::FMOD) return Carried::Not;
    try {
        auto next = opener_.OpenIn(TEngine::FMOD, path);
        if (AsFading(next.get()) == nullptr) return Carried::Not;
        pair_.CrossTo(std::move(next), settings_.FMODCrossoverTime);
    } catch (const EFMODException&) {
        // The song that plays is worth more than the reason; the hard change that follows tells it.
        return Carried::Not;
    } catch (const EOutputException&) {
        return Carried::Not;
    }
    opener_.Abandon();
    engine_ = TEngine::FMOD;
    return Carried::Out;
}

// A song of another library setting would end the one that plays.
void OwnEngines::PlayBeside(const QString& path) {
    if (IsOpen() && !LibraryStays()) return;
    auto song = opener_.OpenIn(TEngine::FMOD, path);
    if (FadingBackend* fading = AsFading(song.get())) {
        fading->SetFadeTime(settings_.FMODCrossoverTime);
        fading->StartFadeOut();
    }
    song->Play();
    pair_.SetLeaving(std::move(song));
}

// Another program goes on knowing the file by the name that it was given.
void OwnEngines::FollowRenamed(const QString& path) {
    if (IsOpen() && engine_ != TEngine::WinAmp) Song().SetBackendFile(path);
}

void OwnEngines::SetGain(float gain) {
    gain_ = std::clamp(gain, 0.0F, 1.0F);
    if (opener_.Table().SetSharedGain) opener_.Table().SetSharedGain(gain_);
    if (GainBackend* current = AsGain(pair_.Current())) current->SetGain(gain_);
}
