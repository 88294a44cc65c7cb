#pragma once

#include <QTimer>
#include <memory>
#include <optional>

#include "CommonRUKTools/SettingsSchema.h"
#include "HTTPRetrieval/HTTPGet.h"
#include "HTTPRetrieval/SearchHit.h"

// Whom the search asks.
enum SearchService : int { ssPage, ssMusicBrainz };

struct OnlineServices {
    SearchService Service = ssPage;
    QString Host;  // of the service that answers with a page; there is none until the user names one
    QString MusicBrainz;
    QString CoverArt;
};

namespace OnlineSettings {

inline constexpr MemberSetting kService{
    Setting<int>{u"SearchService", ssPage, ssPage, ssMusicBrainz, ssMusicBrainz}, &OnlineServices::Service};
inline constexpr MemberSetting kHost{Setting<QString>{u"SearchHost"}, &OnlineServices::Host};
inline constexpr MemberSetting kMusicBrainz{
    Setting<QString>{u"MusicBrainzAddress", u"https://musicbrainz.org"}, &OnlineServices::MusicBrainz};
inline constexpr MemberSetting kCoverArt{Setting<QString>{u"CoverArtAddress", u"https://coverartarchive.org"},
                                         &OnlineServices::CoverArt};
inline constexpr std::tuple kAll{kService, kHost, kMusicBrainz, kCoverArt};

}  // namespace OnlineSettings

// How the program calls itself where the service wants to know who asks.
QString OnlineAgent();

// Asks the service of the user's choice for songs, one question at a time. Nothing is asked by itself.
class OnlineSearch {
 public:
    OnlineSearch();

    // Exactly one of these is raised for each question that no later one takes the place of.
    std::function<void(HitSource hits)> OnFound;
    std::function<void(const QString& reason)> OnError;  // German

    // May wait a moment, where the service wants that.
    void Ask(const OnlineServices& services, const QString& query);
    // That was asked last.
    SearchService Service() const { return service_; }
    bool IsRunning() const { return get_.IsRunning() || later_.isActive(); }

 private:
    void Fetch();
    void Take(const QByteArray& json);

    THTTPGet get_;
    QTimer later_;
    SearchService service_ = ssPage;
    std::optional<qint64> last_;  // when MusicBrainz was asked, as the clock ticks
};
