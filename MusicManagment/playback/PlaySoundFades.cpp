#include <QFileInfo>

#include "MusicManagment/playback/ExternalTarget.h"
#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playback/PlaySoundMenu.h"

// Two songs at once.

namespace {

bool IsNextOnAlbum(const TID3Tag& song, const TID3Tag& next) {
    const auto folder = [](const TID3Tag& tag) { return QFileInfo(tag.FileName).path(); };
    return !song.Album.isEmpty() && song.Album == next.Album && song.Track > 0 &&
           next.Track == song.Track + 1 && (song.Artist == next.Artist || folder(song) == folder(next));
}

}  // namespace

TCrossover TPlaySound::Crossover() const {
    if (controller_ != nullptr) return controller_->AskCrossover();
    return panel_ != nullptr ? panel_->Crossover() : coAutoChange;
}

bool TPlaySound::FadesWanted() const {
    return settings_.FMODCrossoverTime >= kShortestFade && Crossover() != coNone;
}

// What plays can be a copy of what is listed.
std::optional<TID3Tag> TPlaySound::RecordOf(const QString& path) const {
    const bool listed = playList_ && playList_->CurrentFile() == path;
    const int entry = listed ? playList_->IndexOf() : -1;
    if (entry >= 0 && playList_->Entry(entry).Record) return *playList_->Entry(entry).Record;
    const TID3Tag* song = database_ ? database_->Songs().Find(path) : nullptr;
    return song != nullptr ? std::optional(*song) : std::nullopt;
}

bool TPlaySound::ContinuesAlbum(const QString& path) const {
    const auto next = ending_ ? RecordOf(path) : std::nullopt;
    return next && IsNextOnAlbum(*ending_, *next);
}

bool TPlaySound::PlayWithCrossFade(const QString& path) {
    if (ContinuesAlbum(path)) return false;
    const Carried done = Reached(fileName_).CrossFadeTo(path);
    if (done == Carried::Not) return false;
    // A song that is faded in counts as well, though its name does not go through SetFileName.
    if (path != fileName_ && done == Carried::Out) playCount_.Arm();
    fileName_ = path;
    released_.reset();
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

// --- What the user wishes ---

// How the user's wish for another song is carried out.
SongChange TPlaySound::ChangeOnDemand() const {
    return Crossover() >= coAllChanges ? SongChange::CrossFade : SongChange::Hard;
}

// How the user's wish to stop is carried out.
StopMode TPlaySound::StopOnDemand() const {
    return Crossover() == coAlways ? StopMode::Fade : StopMode::AtOnce;
}

namespace {

constexpr ComponentCommand<TPlaySound> kRows[] = {
    {.Id = plStop,
     .Caption = u"Stop",
     .Keys = u"F7",
     .Icon = u"media-playback-stop",
     .Run = [](TPlaySound& player, int) { player.Stop(player.StopOnDemand()); },
     .Image = 71},
    {.Id = plPrevious,
     .Caption = u"Vorheriges",
     .Keys = u"F9",
     .Icon = u"media-skip-backward",
     .Run =
         [](TPlaySound& player, int) {
             if (TPlayList* list = player.PlayList()) list->PlayPrevious(player.ChangeOnDemand());
         },
     .Image = 72},
    {.Id = plNext,
     .Caption = u"Nächstes",
     .Keys = u"F10",
     .Icon = u"media-skip-forward",
     .Run =
         [](TPlaySound& player, int) {
             if (TPlayList* list = player.PlayList()) list->PlayNext(player.ChangeOnDemand());
         },
     .Image = 73},
};

}  // namespace

constinit const PlayerCommands kFadeCommands = kRows;
