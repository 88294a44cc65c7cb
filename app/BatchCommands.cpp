#include "app/BatchCommands.h"

#include <QMainWindow>
#include <QProcess>
#include <QStandardPaths>

#include "CommonRUKTools/BurningPrograms.h"
#include "CommonRUKTools/CommandDispatcher.h"
#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/batches/BatchReport.h"
#include "MusicManagment/database/batches/FlagBatch.h"
#include "MusicManagment/database/batches/MediaCommands.h"
#include "MusicManagment/database/batches/TagBatch.h"
#include "ReadMPEGHeader/DisplayTexts.h"
#include "app/SongChoice.h"
#include "app/dialogs/BannListDialog.h"
#include "app/dialogs/RenameDialog.h"
#include "app/dialogs/TagsFromNamesDialog.h"
#include "app/views/SongListWidget.h"
#include "app/views/WindowSettings.h"

using namespace Qt::StringLiterals;

namespace {

QString DiscardQuestion(const TMusicDatabase& database, const std::vector<SongHandle>& songs, bool banned) {
    const TID3Tag* only = songs.size() == 1 ? database.Songs().Find(songs.front()) : nullptr;
    const QString what = only != nullptr ? u'"' + ArtistAndTitle(*only) + u'"' : SongCountText(songs.size());
    const QString begin = (songs.size() == 1 ? u"Soll "_s : u"Sollen "_s) + what;
    return begin +
           (banned
                ? u" in die Bann-Liste aufgenommen, aus der Datenbank entfernt und in den Papierkorb gelegt "
                  "werden? Verbannte Songs werden nicht wieder aufgenommen."_s
                : u" aus der Datenbank entfernt und in den Papierkorb gelegt werden?"_s);
}

}  // namespace

BatchCommands::BatchCommands(TMusicDatabase& database, SongListWidget& list)
    : database_(database), list_(list) {
    database_.JoinSettings(*this);
    const auto handle = [this](int id, std::function<void()> run) {
        handlers_ += database_.Commands().Handle(id, {.Run = std::move(run)});
    };
    handle(mcTakeGenre, [this] { AdaptGenre(); });
    handle(mcVerifyLengths, [this] { VerifyLengths(); });
    handle(mcEnterLength, [this] { EnterLength(); });
    handle(mcRemoveTags, [this] { RemoveTags(); });
    handle(mcRereadTags, [this] { RereadTags(); });
    handle(mcRenameByPattern, [this] { RenameByPattern(); });
    handle(mcTagsFromNames, [this] { TakeTagsFromNames(); });
    handle(mcEditBannList, [this] { EditBannList(); });
    handle(mcCacheCdSongs, [this] {
        if (const auto songs = AskForSongs(database_, list_, u"Zwischenspeichern aller Songs"_s,
                                           u"Zwischenspeichern aller markierter Songs"_s, SongPreset::Marked))
            CacheSongsCommand(database_, *songs);
    });
    handle(mcDropCaches, [this] {
        if (const auto songs =
                AskForSongs(database_, list_, u"Zwischenspeicherung aller Songs entfernen"_s,
                            u"Zwischenspeicherung aller markierter Songs entfernen"_s, SongPreset::Nothing))
            DropCachesCommand(database_, *songs);
    });
    handle(mcPrepareBurning, [this] { PrepareBurning(); });
    for (const int id : {mcSetFlag, mcRemoveFlag})
        handle(id, [this, id] { ChangeFlag(id); });
    for (const int id : {mcRemoveFromDisk, mcBan})
        handle(id, [this, id] { Discard(id); });
}

BatchSongs BatchCommands::Chosen() const {
    return ChosenSongs(database_, list_);
}

void BatchCommands::AdaptGenre() {
    if (const BatchSongs songs = Chosen(); !songs.IsEmpty()) ReportAdaption(AdaptGenres(database_, songs));
}

void BatchCommands::VerifyLengths() {
    if (const BatchSongs songs = Chosen(); !songs.IsEmpty()) ReportLengths(::VerifyLengths(database_, songs));
}

void BatchCommands::EnterLength() {
    const SongIndex focused = list_.FocusedSong();
    if (focused >= 0) ReportBatch(::EnterLength(database_, database_.Songs().HandleOf(focused)));
}

void BatchCommands::ChangeFlag(int id) {
    const BatchSongs songs = Chosen();
    if (songs.IsEmpty()) return;
    const FlagChange change = id == mcSetFlag ? FlagChange::Set : FlagChange::Remove;
    if (const auto flag = AskForFlag(change)) ReportBatch(::ChangeFlag(database_, songs, *flag, change));
}

void BatchCommands::RemoveTags() {
    const BatchSongs songs = Chosen();
    if (!songs.IsEmpty() && MayRemoveTags(songs.Range)) ReportBatch(::RemoveTags(database_, songs));
}

void BatchCommands::RereadTags() {
    const BatchSongs songs = Chosen();
    if (!songs.IsEmpty() && MayRereadTags(songs.Range)) ReportBatch(::RereadTags(database_, songs));
}

void BatchCommands::Discard(int id) {
    const std::vector<SongHandle> songs = list_.ChosenHandles();
    if (songs.empty()) return;
    const bool banned = id == mcBan;
    if (!UserDialogs().Confirm(DiscardQuestion(database_, songs, banned),
                               banned ? u"Verbannen"_s : u"In den Papierkorb"_s))
        return;
    const SongHandle next = list_.NextAfter(songs);
    const QString caption = SongCountText(songs.size()) + (banned ? u" verbannen"_s : u" löschen"_s);
    const BatchResult result =
        DiscardSongs(database_, caption, songs, banned ? Banning::Banned : Banning::NotBanned);
    list_.FocusSong(database_.Songs().PositionOf(next), QAbstractItemView::EnsureVisible);
    ReportBatch(result);
}

void BatchCommands::RenameByPattern() {
    const BatchSongs songs = Chosen();
    if (songs.IsEmpty()) return;
    RenameDialog dialog(database_, songs.Songs, list_.window());
    dialog.exec();
    const std::vector<SongMove> moves = dialog.Moves();
    if (!moves.empty())
        ReportBatch(MoveSongs(database_, SongCountText(moves.size()) + u" umbenennen"_s, moves));
}

void BatchCommands::PrepareBurning() {
    const auto songs =
        AskForSongs(database_, list_, u"Alle Songs"_s, u"Markierte Songs"_s, SongPreset::Marked);
    const QString folder = songs ? PrepareBurningCommand(database_, *songs) : QString();
    if (!folder.isEmpty()) OfferBurning(folder);
}

void BatchCommands::OfferBurning(const QString& folder) {
    auto* window = qobject_cast<QMainWindow*>(list_.window());
    const auto call =
        FindBurningProgram(folder, [](const QString& name) { return QStandardPaths::findExecutable(name); });
    if (window == nullptr || !call) return;
    burn_.Show(*window, u"Mit "_s + call->Name + u" brennen"_s,
               u"Öffnet "_s + folder + u" in "_s + call->Name, [call] {
                   if (!QProcess::startDetached(call->Program, call->Arguments))
                       throw EMusicDatabaseException(call->Name + u" lässt sich nicht starten."_s);
               });
}

void BatchCommands::TakeTagsFromNames() {
    const BatchSongs songs = Chosen();
    if (songs.IsEmpty()) return;
    TagsFromNamesDialog dialog(database_, songs.Songs,
                               tagPattern_.isEmpty() ? database_.MP3NamePattern() : tagPattern_,
                               list_.window());
    if (dialog.exec() != QDialog::Accepted) return;
    tagPattern_ = dialog.Pattern();
    ReportBatch(::TakeTagsFromNames(database_, songs, NameMatcher(tagPattern_)));
}

void BatchCommands::LoadSettings(const TRWReg& settings) {
    tagPattern_ = ReadSetting(settings, WindowSettings::kTagsFromNamesPattern).value_or(tagPattern_);
}

void BatchCommands::SaveSettings(TRWReg& settings) const {
    WriteSetting(settings, WindowSettings::kTagsFromNamesPattern, tagPattern_);
}

void BatchCommands::EditBannList() {
    BannListDialog dialog(database_.BannList(), list_.window());
    if (dialog.exec() != QDialog::Accepted) return;
    database_.BannList() = dialog.List();
    database_.Events().BannListChanged.Tell();
}
