#include "HTTPRetrieval/OnlineSearch.h"

#include <QCoreApplication>
#include <algorithm>

#include "CommonRUKTools/Clock.h"
#include "CommonRUKTools/CommandRunner.h"
#include "HTTPRetrieval/MusicBrainz.h"
#include "HTTPRetrieval/SearchPage.h"

using namespace Qt::StringLiterals;

namespace {

HitSource SourceOf(std::vector<SearchHit> hits) {
    const auto kept = std::make_shared<const std::vector<SearchHit>>(std::move(hits));
    return [kept, next = std::size_t{0}]() mutable -> std::optional<SearchHit> {
        return next < kept->size() ? std::optional((*kept)[next++]) : std::nullopt;
    };
}

HitSource SourceOf(const QString& page) {
    const auto kept = std::make_shared<SearchPage>(page);
    return [kept] { return kept->Next(); };
}

}  // namespace

QString OnlineAgent() {
    return u"Tunestead/%1 ( de.tunestead.Tunestead )"_s.arg(QCoreApplication::applicationVersion());
}

OnlineSearch::OnlineSearch() {
    get_.OnDoneString = [this](const QString& page) {
        if (OnFound) OnFound(SourceOf(page));
    };
    get_.OnDoneBytes = [this](const QByteArray& json) { Take(json); };
    get_.OnError = [this](const QString& reason) {
        if (OnError) OnError(reason);
    };
    later_.setSingleShot(true);
    later_.setTimerType(Qt::PreciseTimer);  // another may be early
    later_.callOnTimeout(&get_, Guarded([this] { Fetch(); }));
}

void OnlineSearch::Ask(const OnlineServices& services, const QString& query) {
    get_.Cancel();
    service_ = services.Service;
    const bool isPage = service_ == ssPage;
    get_.SetAgent(isPage ? u"Tunestead INetSearch"_s : OnlineAgent());
    get_.SetURL(isPage ? SearchPageUrl(services.Host, query) : MusicBrainzUrl(services.MusicBrainz, query));
    const qint64 pause = isPage || !last_ ? 0 : *last_ + kMusicBrainzPause - CurrentClock().Ticks();
    later_.start(static_cast<int>(std::clamp<qint64>(pause, 0, kMusicBrainzPause)));
}

void OnlineSearch::Fetch() {
    if (service_ == ssPage) return get_.GetString();
    last_ = CurrentClock().Ticks();
    get_.GetBytes();
}

void OnlineSearch::Take(const QByteArray& json) {
    auto hits = ReadMusicBrainz(json);
    if (!hits) {
        if (OnError) OnError(u"Der Such-Dienst hat etwas Unverständliches geantwortet."_s);
    } else if (OnFound) {
        OnFound(SourceOf(std::move(*hits)));
    }
}
