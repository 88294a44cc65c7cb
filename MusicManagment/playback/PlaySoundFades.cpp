#include <utility>

#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/playback/ExternalLink.h"
#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playback/backend/FadingBackend.h"

// Two songs at once.

TCrossover TPlaySound::Crossover() const {
    if (controller_ != nullptr) return controller_->AskCrossover();
    return panel_ != nullptr ? panel_->Crossover() : coAutoChange;
}

bool TPlaySound::CanFade() const {
    return settings_.FMODCrossoverTime >= kShortestFade && Crossover() != coNone;
}

bool TPlaySound::PlayWithCrossFade(const QString& path) {
    if (UseExternal()) {
        if (external_->SendText(ecPlayWithCrossFade, path) == 0) return false;
        fileName_ = path;
        RestartAutoStop();
        return true;
    }
    // In this order: whoever is asked for the mode may close the song.
    if (!CanFade() || AsFading(current_.get()) == nullptr) return false;
    if (!FileSource::Exists(path) || ChooseEngine(path, settings_) != TEngine::FMOD) return false;
    try {
        Backend next = MakeBackend(TEngine::FMOD, path);
        next->Open();
        return CrossFadeTo(std::move(next), path);
    } catch (const EFMODException&) {
        // The song that plays is worth more than the reason; the hard change that follows tells it.
        return false;
    }
}

// The new song is opened beside the current one and takes its place only once it plays, so that whatever goes
// wrong leaves the current one alone.
bool TPlaySound::CrossFadeTo(Backend next, const QString& path) {
    FadingBackend* fadingIn = AsFading(next.get());
    if (fadingIn == nullptr) return false;
    fadingIn->SetFadeTime(settings_.FMODCrossoverTime);
    fadingIn->StartFadeIn();
    next->Play();
    fadingIn->FadeStep();  // no moment at full volume before the first tick

    ++generation_;
    fading_ = std::exchange(current_, std::move(next));
    FadeOutFormer();

    // A song that is faded in counts as well, though its name does not go through SetFileName.
    if (path != fileName_) playCount_.Arm();
    fileName_ = path;
    coFileName_.clear();
    if (playList_) playList_->RedrawView();
    StartTimers();
    AnnounceSong();
    return true;
}

// One that is paused or stopped would only be heard again when the new song is paused and resumed.
void TPlaySound::FadeOutFormer() {
    if (fading_->GetStatus() != psPlaying) return fading_.reset();
    FadingBackend* former = AsFading(fading_.get());
    former->SetFadeTime(settings_.FMODCrossoverTime);
    former->StartFadeOut();
}

QString TPlaySound::COFileName() {
    const bool there = playExtern_ ? ExternalRuns() : fading_ != nullptr;
    return there ? coFileName_ : QString();
}

void TPlaySound::SetCOFileName(const QString& path) {
    fading_.reset();
    coFileName_ = path;
    if (path.isEmpty() || !CanFade()) {
        if (ExternalRuns()) external_->Send(ecCloseFading);
        return;
    }
    if (UseExternal()) {
        external_->Send(ecNewFading);
        external_->SendText(ecFadingFileName, path);
        external_->Send(ecOpenFading);
        external_->Send(ecFadingTime, settings_.FMODCrossoverTime);
        external_->Send(ecStartFading, 1);
        external_->Send(ecPlayFading);
        return;
    }
    Backend song = MakeBackend(TEngine::FMOD, path);
    song->Open();
    if (FadingBackend* fading = AsFading(song.get())) {
        fading->SetFadeTime(settings_.FMODCrossoverTime);
        fading->StartFadeOut();
    }
    song->Play();
    fading_ = std::move(song);
}
