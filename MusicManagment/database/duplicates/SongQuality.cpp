#include "MusicManagment/database/duplicates/SongQuality.h"

#include <algorithm>
#include <cstdlib>
#include <unordered_map>

#include "ReadMPEGHeader/DisplayTexts.h"
#include "ReadMPEGHeader/Genres.h"

using namespace Qt::StringLiterals;

namespace {

int FieldsToldOf(const TID3Tag& song) {
    const bool told[] = {!song.Title.isEmpty(),
                         !song.Artist.isEmpty(),
                         !song.Album.isEmpty(),
                         !song.Comment.isEmpty(),
                         !song.Year.isEmpty() && song.Year != u"0000"_s,
                         song.Genre != kNoGenre,
                         song.Track != 0};
    return static_cast<int>(std::ranges::count(told, true));
}

QString Instead(const QString& better, const QString& worse, const QString& unit) {
    return u" ("_s + better + u" statt "_s + worse + unit + u')';
}

// What a song can be better in: more is better.
struct Quality {
    qint64 (*Value)(const TID3Tag& song);
    QString (*Reason)(qint64 better, qint64 worse);
    qint64 Tolerance = 0;
};

constexpr auto kLength = [](const TID3Tag& song) -> qint64 { return song.Length; };

const Quality kQualities[] = {
    {[](const TID3Tag& song) -> qint64 { return (song.Flags & sfDamaged) == 0 ? 1 : 0; },
     [](qint64, qint64) { return u"nicht als beschädigt gekennzeichnet"_s; }},
    {[](const TID3Tag& song) -> qint64 { return IsCdPath(song.FileName) ? 0 : 1; },
     [](qint64, qint64) { return u"nicht auf einem Medium, das fehlen kann"_s; }},
    {[](const TID3Tag& song) -> qint64 { return song.BitRate; },
     [](qint64 better, qint64 worse) {
         return u"höhere Bitrate"_s + Instead(QString::number(better), QString::number(worse), u" kBit/s"_s);
     }},
    {kLength,
     [](qint64 better, qint64 worse) {
         return u"länger"_s + Instead(FormatLength(static_cast<int>(better), true),
                                      FormatLength(static_cast<int>(worse), true), QString());
     },
     kSameLength},
    {[](const TID3Tag& song) -> qint64 { return FieldsToldOf(song); },
     [](qint64 better, qint64 worse) {
         return u"vollständigerer Tag"_s +
                Instead(QString::number(better), QString::number(worse), u" Feldern"_s);
     }},
    {[](const TID3Tag& song) -> qint64 { return song.PlayCount; },
     [](qint64 better, qint64 worse) {
         return u"öfter gespielt"_s + Instead(QString::number(better), QString::number(worse), u" Mal"_s);
     }},
};

bool IsSameRecording(const TID3Tag& first, const TID3Tag& second) {
    return std::abs(kLength(first) - kLength(second)) <= kSameLength;
}

// The songs of some pairs, and what each is like.
class Partners {
 public:
    Partners(const TMusicDatabase& database, std::span<const DuplicatePair> pairs) : database_(database) {
        for (const DuplicatePair& pair : pairs) {
            const TID3Tag* first = database.Songs().Find(pair.First);
            const TID3Tag* second = database.Songs().Find(pair.Second);
            if (first == nullptr || second == nullptr || !IsSameRecording(*first, *second)) continue;
            const std::size_t a = NumberOf(pair.First, *first);
            const std::size_t b = NumberOf(pair.Second, *second);
            songs_[a].Like.push_back({b, pair.Percent});
            songs_[b].Like.push_back({a, pair.Percent});
        }
    }

    // The safe ones first: a copy goes in favour of the song that it is one of, not of some other.
    std::vector<KeepSuggestion> Suggest() {
        const std::vector<std::size_t> order = BestFirst();
        std::vector<KeepSuggestion> suggestions;
        for (const int leastPercent : {KeepSuggestion::kSafePercent, 0})
            for (const std::size_t number : order)
                if (!songs_[number].Goes) SuggestFor(songs_[number], leastPercent, suggestions);
        return suggestions;
    }

 private:
    struct Partner {
        std::size_t Number = 0;
        double Percent = 0;
    };
    struct Song {
        SongHandle Handle{};
        const TID3Tag* Record = nullptr;
        SongIndex Place = 0;
        std::vector<Partner> Like{};
        bool Goes = false;
        bool Stays = false;
    };

    void SuggestFor(Song& kept, int leastPercent, std::vector<KeepSuggestion>& suggestions) {
        for (const Partner& partner : kept.Like) {
            Song& dropped = songs_[partner.Number];
            if (partner.Percent < leastPercent || dropped.Goes || dropped.Stays || IsBefore(dropped, kept))
                continue;
            dropped.Goes = true;
            kept.Stays = true;
            QString reason = CompareQuality(*kept.Record, *dropped.Record).Reason;
            suggestions.push_back({{.Kept = kept.Handle, .Dropped = dropped.Handle},
                                   partner.Percent,
                                   reason.isEmpty() ? u"gleich gut"_s : std::move(reason)});
        }
    }

    std::size_t NumberOf(SongHandle song, const TID3Tag& record) {
        const auto [known, isNew] = numbers_.try_emplace(song.Slot, songs_.size());
        if (isNew)
            songs_.push_back(
                {.Handle = song, .Record = &record, .Place = database_.Songs().PositionOf(song)});
        return known->second;
    }

    // Without the length, in which partners do not differ, this is one order for all of them.
    static bool IsBefore(const Song& a, const Song& b) {
        for (const Quality& quality : kQualities) {
            if (quality.Tolerance > 0) continue;
            const qint64 ofA = quality.Value(*a.Record);
            const qint64 ofB = quality.Value(*b.Record);
            if (ofA != ofB) return ofA > ofB;
        }
        return a.Place < b.Place;
    }

    std::vector<std::size_t> BestFirst() const {
        std::vector<std::size_t> order(songs_.size());
        for (std::size_t i = 0; i < order.size(); ++i)
            order[i] = i;
        std::ranges::sort(order,
                          [this](std::size_t a, std::size_t b) { return IsBefore(songs_[a], songs_[b]); });
        return order;
    }

    const TMusicDatabase& database_;
    std::vector<Song> songs_;
    std::unordered_map<quint32, std::size_t> numbers_;  // by slot
};

}  // namespace

SongVerdict CompareQuality(const TID3Tag& first, const TID3Tag& second) {
    for (const Quality& quality : kQualities) {
        const qint64 a = quality.Value(first);
        const qint64 b = quality.Value(second);
        if (std::abs(a - b) <= quality.Tolerance) continue;
        return {a > b ? SongVerdict::Side::First : SongVerdict::Side::Second,
                quality.Reason(std::max(a, b), std::min(a, b))};
    }
    return {};
}

std::vector<KeepSuggestion> SuggestKept(const TMusicDatabase& database,
                                        std::span<const DuplicatePair> pairs) {
    return Partners(database, pairs).Suggest();
}
