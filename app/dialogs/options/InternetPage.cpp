#include "app/dialogs/options/InternetPage.h"

#include <QComboBox>
#include <QFormLayout>
#include <QLineEdit>

#include "HTTPRetrieval/OnlineSearch.h"
#include "HTTPRetrieval/SearchPage.h"
#include "HTTPRetrieval/WebAddress.h"
#include "app/desktop/Icons.h"

using namespace Qt::StringLiterals;

InternetPage::InternetPage()
    : OptionsPage(u"Internet"_s, ThemeIcon(u"internet-services"_s, QStyle::SP_DriveNetIcon)) {
    QFormLayout& group = AddGroup(u"Suchen im Internet"_s);
    service_ = AddField(group, u"SearchService"_s, u"Gesucht wird &bei"_s, new QComboBox);
    service_->addItems({u"dem Such-Dienst"_s, u"MusicBrainz"_s});
    fields_.Bind(service_, OnlineSettings::kService.Row);
    host_ = AddField(group, u"SearchHost"_s, u"Such-&Dienst"_s, new QLineEdit,
                     u"Der Name des Rechners, der die Seite mit den Treffern liefert"_s);
    fields_.Bind(host_, OnlineSettings::kHost.Row);
    musicBrainz_ = AddField(group, u"MusicBrainzAddress"_s, u"&MusicBrainz"_s, new QLineEdit);
    fields_.Bind(musicBrainz_, OnlineSettings::kMusicBrainz.Row);
    coverArt_ = AddField(group, u"CoverArtAddress"_s, u"&Cover"_s, new QLineEdit,
                         u"Das Cover Art Archive, aus dem Cover geholt werden"_s);
    fields_.Bind(coverArt_, OnlineSettings::kCoverArt.Row);
    AddText(group,
            u"Verbunden wird nur, wenn Sie eine Suche beginnen oder ein Cover übernehmen. "
            "Dabei erfährt der Dienst, wonach Sie suchen, und die Adresse Ihres Anschlusses."_s);
}

std::optional<OptionsFault> InternetPage::Check() {
    const QString host = host_->text().trimmed();
    if (!host.isEmpty() && !IsWebAddress(QUrl(SearchPageUrl(host, {}))))
        return OptionsFault{
            u"\"%1\" ist kein Rechner im Internet; erwartet wird ein Name wie musik.example."_s.arg(
                host_->text()),
            host_};
    for (QLineEdit* field : {musicBrainz_, coverArt_})
        if (!IsWebAddress(QUrl(field->text().trimmed())))
            return OptionsFault{
                u"\"%1\" ist keine Adresse im Internet; sie beginnt mit https://."_s.arg(field->text()),
                field};
    return std::nullopt;
}
