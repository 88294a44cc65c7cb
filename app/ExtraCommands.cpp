#include "app/ExtraCommands.h"

#include "CommonRUKTools/CommandDispatcher.h"
#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/Command.h"
#include "app/ShellCommands.h"
#include "app/dialogs/SimilarArtistsForm.h"

using namespace Qt::StringLiterals;

ExtraCommands::ExtraCommands(QWidget& window, TMusicDatabase& database)
    : window_(window), database_(database) {
    handlers_ += database_.Commands().Handle(mcFindSimilarArtists, {.Run = [this] { FindSimilarArtists(); }});
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
        artists_->OnUndo = [this] { database_.Commands().Run(scUndo); };
    }
    artists_->SetPairs(std::move(pairs), stopped);
    artists_->show();
    artists_->raise();
    artists_->activateWindow();
}
