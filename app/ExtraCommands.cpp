#include "app/ExtraCommands.h"

#include "CommonRUKTools/CommandDispatcher.h"
#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/Volumes.h"
#include "MusicManagment/database/Command.h"
#include "app/ShellCommands.h"
#include "app/dialogs/BackupDialog.h"
#include "app/dialogs/SimilarArtistsForm.h"

using namespace Qt::StringLiterals;

namespace {

// The first that can be taken away; empty where there is none.
QString LikelyMedium() {
    for (const Volume& volume : CurrentVolumes().Mounted())
        if (volume.CanBeTakenAway()) return volume.MountPoint;
    return {};
}

QString ProposedName(const TMusicDatabase& database, const BackupMedium& medium) {
    const QString path = MakeCdPath(medium.Serial, u"/"_s);
    QString name = database.CDNameOf(path);
    if (name != path) return name;
    return medium.Label.isEmpty() ? SerialText(medium.Serial) : medium.Label;
}

}  // namespace

ExtraCommands::ExtraCommands(QWidget& window, TMusicDatabase& database)
    : window_(window), database_(database) {
    handlers_ += database_.Commands().Handle(mcFindSimilarArtists, {.Run = [this] { FindSimilarArtists(); }});
    handlers_ += database_.Commands().Handle(mcReadBackupCd, {.Run = [this] { ReadBackup(); }});
}

void ExtraCommands::FindSimilarArtists() {
    bool stopped = false;
    std::vector<SimilarArtists> pairs = ::FindSimilarArtists(database_, stopped);
    if (pairs.empty())
        return UserDialogs().ShowMessage(
            MessageKind::Information,
            stopped ? u"Die Suche wurde abgebrochen, bevor etwas gefunden war."_s
                    : u"Es gibt keine Artists, deren Namen ähnlich sind oder ähnlich klingen."_s);
    if (artists_ == nullptr) {
        artists_ = new SimilarArtistsForm(database_, &window_);
        artists_->setAttribute(Qt::WA_DeleteOnClose);
        artists_->OnCorrect = [this] { database_.ClickMenuItem(mcCorrectAll); };
        artists_->OnUndo = [this] { return database_.ClickMenuItem(scUndo); };
    }
    artists_->SetPairs(std::move(pairs), stopped);
    artists_->show();
    artists_->raise();
    artists_->activateWindow();
}

void ExtraCommands::ReadBackup() {
    const auto folder = UserDialogs().ChooseVolume(u"Songs von einer Backup-CD wieder einlesen"_s,
                                                   u"Wo liegt die Backup-CD?"_s, LikelyMedium());
    if (!folder || folder->isEmpty()) return;
    const BackupMedium medium = BackupMediumOf(database_, *folder);
    const BackupContents contents = ::ReadBackup(database_, medium, *folder);
    if (contents.Stopped) return;
    if (contents.Files.empty() && contents.Unreadable.isEmpty())
        return UserDialogs().ShowMessage(MessageKind::Information,
                                         contents.Known > 0
                                             ? u"Alle Songs des Datenträgers sind schon in der Datenbank."_s
                                             : u"Auf dem Datenträger sind keine Songs."_s);
    if (contents.Files.empty()) return ReportBackup({}, contents.Unreadable);
    const auto candidates = MatchBackup(database_, contents.Files);
    if (candidates.empty()) return;
    BackupDialog dialog(database_, contents.Files, candidates, ProposedName(database_, medium), &window_);
    if (dialog.exec() != QDialog::Accepted) return;
    ReportBackup(TakeBackup(database_, medium, dialog.MediumName(), contents.Files, dialog.Decisions()),
                 contents.Unreadable);
}
