#include "app/OnlineCommands.h"

#include <QWidget>

#include "CommonRUKTools/CommandDispatcher.h"
#include "CommonRUKTools/Dialogs.h"
#include "HTTPRetrieval/MusicBrainz.h"
#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/SongFields.h"
#include "app/dialogs/OnlineSearchForm.h"
#include "app/models/CoverPictures.h"
#include "app/views/TagForm.h"

using namespace Qt::StringLiterals;

namespace {

// What a record can hold of a hit.
std::vector<std::pair<SongFieldId, QString>> FieldsOf(const SearchHit& hit) {
    const std::pair<SongFieldId, QString> texts[] = {
        {SongFieldId::Title, hit.Title},
        {SongFieldId::Artist, hit.Artist},
        {SongFieldId::Album, hit.Album},
        {SongFieldId::Year, hit.Year},
        {SongFieldId::Track, hit.Track > 0 ? QString::number(hit.Track) : QString()},
    };
    std::vector<std::pair<SongFieldId, QString>> fields;
    TID3Tag nobody;
    for (const auto& [field, text] : texts)
        if (!text.isEmpty() && FieldOf(field).Set(nobody, text)) fields.emplace_back(field, text);
    return fields;
}

}  // namespace

OnlineCommands::OnlineCommands(QWidget& window, TMusicDatabase& database, TID3TagForm& tags)
    : window_(window), tags_(tags) {
    ForEachSetting(OnlineSettings::kAll,
                   [this](const auto& setting) { setting.SetOf(services_, DefaultValue(setting.Row)); });
    database.JoinSettings(*this);
    handlers_ += database.Commands().Handle(mcFindOnline, {.Run = [this] { Search(); }});
    search_.OnFound = [this](HitSource hits) { Show(std::move(hits)); };
    search_.OnError = [this](const QString& reason) {
        Notice(reason);
        UserDialogs().ShowMessage(MessageKind::Error,
                                  u"Fehler beim Stellen einer Such-Anfrage im Internet"_s);
    };
    cover_.SetAgent(OnlineAgent());
    cover_.OnDoneBytes = [this](const QByteArray& picture) { TakeCover(picture); };
    cover_.OnError = [this](const QString& reason) {
        Notice(QString());
        UserDialogs().ShowMessage(MessageKind::Warning, u"Das Cover lässt sich nicht holen. "_s + reason);
    };
}

void OnlineCommands::LoadSettings(const TRWReg& settings) {
    LoadSettingsOf(services_, OnlineSettings::kAll, settings);
}

void OnlineCommands::SaveSettings(TRWReg& settings) const {
    SaveSettingsOf(services_, OnlineSettings::kAll, settings);
}

void OnlineCommands::Search() {
    if (services_.Service == ssPage && services_.Host.trimmed().isEmpty())
        return UserDialogs().ShowMessage(
            MessageKind::Information,
            u"Es ist kein Such-Dienst eingestellt. Nennen Sie einen unter Extras > Einstellungen > "
            "Internet, oder wählen Sie dort MusicBrainz."_s);
    const auto query = UserDialogs().Input(u"Suchen im Internet"_s, u"Suchen nach:"_s, {}, query_);
    if (!query) return;
    query_ = *query;
    Notice(u"Suche im Internet nach „%1“ ..."_s.arg(query_));
    search_.Ask(services_, query_);
}

void OnlineCommands::Show(HitSource hits) {
    Notice(QString());
    auto* form = new OnlineSearchForm(std::move(hits),
                                      search_.Service() == ssPage ? OnlineSearchForm::Details::ArtistAndTitle
                                                                  : OnlineSearchForm::Details::Album,
                                      &window_);
    form->setAttribute(Qt::WA_DeleteOnClose);
    form->OnTake = [this](const SearchHit& hit) { Take(hit); };
    form->OnTakeCover = [this](const SearchHit& hit) { FetchCover(hit); };
    form->show();
}

void OnlineCommands::Take(const SearchHit& hit) {
    if (OnNeedChoice) OnNeedChoice();
    tags_.Propose({.Fields = FieldsOf(hit), .Cover = {}});
}

// --- Covers ---

void OnlineCommands::FetchCover(const SearchHit& hit) {
    if (OnNeedChoice) OnNeedChoice();
    coverSong_ = tags_.SongToProposeTo();
    cover_.SetURL(CoverUrl(services_.CoverArt, hit.Release));
    Notice(u"Das Cover von „%1“ wird geholt ..."_s.arg(hit.Album));
    cover_.GetBytes();
}

// The user may have gone to another song meanwhile.
void OnlineCommands::TakeCover(const QByteArray& picture) {
    Notice(QString());
    const CoverPicture cover = PictureOf(picture);
    if (OnNeedChoice) OnNeedChoice();
    if (tags_.SongToProposeTo() != coverSong_)
        return Notice(u"Inzwischen ist ein anderer Song gewählt; das Cover wurde nicht übernommen."_s);
    tags_.Propose({.Fields = {}, .Cover = cover});
}

void OnlineCommands::Notice(const QString& sentence) const {
    if (OnNotice) OnNotice(sentence);
}
