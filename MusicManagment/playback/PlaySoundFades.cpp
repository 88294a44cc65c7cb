#include "MusicManagment/playback/ExternalTarget.h"
#include "MusicManagment/playback/PlaySound.h"

// Two songs at once.

TCrossover TPlaySound::Crossover() const {
    if (controller_ != nullptr) return controller_->AskCrossover();
    return panel_ != nullptr ? panel_->Crossover() : coAutoChange;
}

bool TPlaySound::FadesWanted() const {
    return settings_.FMODCrossoverTime >= kShortestFade && Crossover() != coNone;
}

bool TPlaySound::PlayWithCrossFade(const QString& path) {
    const Carried done = Reached(fileName_).CrossFadeTo(path);
    if (done == Carried::Not) return false;
    // A song that is faded in counts as well, though its name does not go through SetFileName.
    if (path != fileName_ && done == Carried::Out) playCount_.Arm();
    fileName_ = path;
    if (done == Carried::OnItsWay) return RestartAutoStop(), true;
    waiting_.reset();
    coFileName_.clear();
    if (playList_) playList_->RedrawView();
    StartTimers();
    AnnounceSong();
    return true;
}

QString TPlaySound::COFileName() {
    return Chosen().SoundsBeside() ? coFileName_ : QString();
}

void TPlaySound::SetCOFileName(const QString& path) {
    engines_.CloseBeside();
    coFileName_ = path;
    if (path.isEmpty() || !FadesWanted()) return Chosen().CloseBeside();
    Reached(fileName_).PlayBeside(path);
}
