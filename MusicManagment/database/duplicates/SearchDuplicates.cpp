#include "MusicManagment/database/duplicates/SearchDuplicates.h"

#include <cmath>

#include "CommonRUKTools/Dialogs.h"

using namespace Qt::StringLiterals;

namespace {

constexpr double kLongSearch = 10;  // seconds

// A question that can do no harm.
bool Agrees(const QString& text, const QString& action) {
    return UserDialogs().Confirm(text, action, ReturnKey::Agrees);
}

// False when there is nothing to search.
bool OfferMarked(DuplicateQuery& query, std::size_t songs, const std::vector<SongHandle>& marked) {
    const QString most = QString::number(kMostComparedSongs);
    const QString limit =
        u"Es können höchstens %1 Songs miteinander verglichen werden, die Datenbank hat %2."_s.arg(
            most, QString::number(songs));
    if (marked.size() < 2 || marked.size() > kMostComparedSongs) {
        UserDialogs().ShowMessage(
            MessageKind::Information,
            limit + u" Markieren Sie 2 bis %1 Songs, um diese untereinander zu vergleichen."_s.arg(most));
        return false;
    }
    query.References = marked;
    query.AmongReferencesOnly = true;
    return Agrees(limit + u" Sollen nur die %1 markierten Songs untereinander verglichen werden?"_s.arg(
                              QString::number(marked.size())),
                  u"Vergleichen"_s);
}

QString DurationText(double seconds) {
    constexpr double kMinute = 60;
    constexpr double kHour = 60 * kMinute;
    const auto count = [](double value, const QString& one, const QString& many) {
        const auto number = std::llround(value);
        return QString::number(number) + (number == 1 ? one : many);
    };
    if (seconds < 2 * kMinute) return count(seconds, u" Sekunde"_s, u" Sekunden"_s);
    if (seconds < 2 * kHour) return count(seconds / kMinute, u" Minute"_s, u" Minuten"_s);
    return count(seconds / kHour, u" Stunde"_s, u" Stunden"_s);
}

// How many songs that are all compared with each other make as much work.
std::size_t WorkOf(const DuplicateQuery& query, std::size_t songs) {
    if (query.References.empty() || query.References.size() >= songs / 2) return songs;
    const double pairs = static_cast<double>(query.References.size()) * static_cast<double>(songs);
    return static_cast<std::size_t>(std::sqrt(2 * pairs));
}

bool MayTakeItsTime(const DuplicateQuery& query, std::size_t songs) {
    if (query.SameArtistOnly) return true;  // few songs are compared with each other
    const double seconds = ExpectedSearchTime(WorkOf(query, songs));
    if (seconds < kLongSearch) return true;
    return Agrees(
        u"Der Vergleich dauert etwa %1. Die Songs, die gefunden werden, erscheinen dabei nach und "
        "nach."_s.arg(DurationText(seconds)),
        u"Suchen"_s);
}

// Ends what a view has begun.
class ShownSearch {
 public:
    ShownSearch(DuplicateView& view, const DuplicateQuery& query) : view_(view), rows_(view.Begin(query)) {}
    ~ShownSearch() { view_.End(end_); }
    ShownSearch(const ShownSearch&) = delete;
    ShownSearch& operator=(const ShownSearch&) = delete;

    void Run(TMusicDatabase& database, const DuplicateQuery& query) {
        end_ = FindDuplicates(database, query, rows_, [this] { view_.ShowNewRows(); });
    }
    DuplicateEnd Result() const { return end_; }

 private:
    DuplicateView& view_;
    DuplicateRows& rows_;
    DuplicateEnd end_ = DuplicateEnd::Stopped;
};

}  // namespace

void SearchDuplicates(TMusicDatabase& database, DuplicateQuery query, const std::vector<SongHandle>& marked,
                      DuplicateView& view) {
    const auto songs = static_cast<std::size_t>(database.Count());
    if (songs == 0) return;
    if (!database.UnlimitedSearch() && songs > kMostComparedSongs) {
        if (!OfferMarked(query, songs, marked)) return;
    } else if (!MayTakeItsTime(query, songs)) {
        return;
    }
    DuplicateEnd end = DuplicateEnd::Stopped;
    {
        ShownSearch search(view, query);
        search.Run(database, query);
        end = search.Result();
    }
    if (end == DuplicateEnd::TooManyRows)
        UserDialogs().ShowMessage(MessageKind::Information,
                                  u"Es gibt mehr als %1 Paare; die Suche wurde beendet. Mit einer höheren "
                                  u"Mindestwahrscheinlichkeit "
                                  "werden es weniger."_s.arg(kMostDuplicateRows));
}
