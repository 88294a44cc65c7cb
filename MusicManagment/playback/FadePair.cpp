#include "MusicManagment/playback/FadePair.h"

#include <utility>

void FadePair::Clear() {
    current_.reset();
    leaving_.reset();
}

void FadePair::Play() {
    current_->Play();
    ResumeLeaving();
}

// One that has come to its end in the meantime would begin anew.
void FadePair::ResumeLeaving() {
    if (leaving_ && leaving_->GetStatus() != psStopped) leaving_->Play();
}

void FadePair::Stop() {
    current_->Stop();
    leaving_.reset();
}

bool FadePair::PauseResume() {
    if (current_->GetStatus() == psPaused) {
        Play();
        return true;
    }
    current_->PauseResume();
    if (leaving_) leaving_->PauseResume();
    return false;
}

bool FadePair::EndFades() {
    FadingBackend* current = CurrentFades();
    if (current == nullptr || current_->GetStatus() != psPlaying) return false;
    current->CancelFades();
    current->SetVolume(100);
    if (FadingBackend* leaving = AsFading(leaving_.get())) leaving->CutFadeOut();
    return true;
}

bool FadePair::StartFadingStop(quint32 milliseconds) {
    FadingBackend* current = CurrentFades();
    if (current == nullptr || current->IsFadingOut()) return false;
    current->SetFadeTime(milliseconds);
    current->StartFadeOut();
    return true;
}

bool FadePair::IsStopping() const {
    const FadingBackend* current = CurrentFades();
    return current != nullptr && current->IsFadingOut();
}

void FadePair::CrossTo(Song next, quint32 milliseconds) {
    FadingBackend* fadingIn = AsFading(next.get());
    // One that is paused or stopped would only be heard again when the new song is paused and resumed.
    const bool formerSounds = current_->GetStatus() == psPlaying;
    fadingIn->SetFadeTime(milliseconds);
    fadingIn->StartFadeIn();
    next->Play();
    fadingIn->FadeStep();  // no moment at full volume before the first tick
    leaving_ = std::exchange(current_, std::move(next));
    if (!formerSounds) return leaving_.reset();
    FadingBackend* former = AsFading(leaving_.get());
    former->SetFadeTime(milliseconds);
    former->StartFadeOut();
}

bool FadePair::FadeStep() {
    FadingBackend* current = CurrentFades();
    if (current != nullptr && current->FadeStep()) return true;
    FadingBackend* leaving = AsFading(leaving_.get());
    if (leaving != nullptr && leaving->FadeStep()) leaving_.reset();
    return false;
}
