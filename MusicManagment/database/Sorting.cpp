#include "MusicManagment/database/Sorting.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <numeric>
#include <span>

#include "CommonRUKTools/Collation.h"
#include "MusicManagment/database/GroupLists.h"

namespace {

template <typename T>
int CompareNumbers(T a, T b) {
    return a < b ? -1 : a > b ? 1 : 0;
}

// A song on a catalogued CD is there (1) or not (2); any other song needs no medium (0).
int CacheKind(const TID3Tag& song) {
    return IsCdPath(song.FileName) ? 2 : 0;
}

quint32 CountedFlags(const SongOrder& order, quint32 flags) {
    return order.ShownFlag != 0 ? flags & order.ShownFlag : flags;
}

int ComparePaths(const QString& a, const QString& b) {
    if (IsCdPath(a) != IsCdPath(b)) return IsCdPath(a) ? 1 : -1;
    return Collation::CompareIgnoringCase(a, b);
}

// The text that the sort type compares; nullptr for types that compare numbers.
const QString* PrimaryText(TSortType type, const TID3Tag& song) {
    switch (type) {
        case stTitle:
            return &song.Title;
        case stArtist:
            return &song.Artist;
        case stAlbum:
            return &song.Album;
        case stComment:
            return &song.Comment;
        case stPath:
            return &song.FileName;
        default:
            return nullptr;
    }
}

bool ComparesText(TSortType type) {
    return PrimaryText(type, TID3Tag()) != nullptr;
}

// Maps a double to a number of the same order. A value that is none ranks as 0.
quint64 OrderedBits(double value) {
    if (std::isnan(value) || value == 0) value = 0;
    const auto bits = std::bit_cast<quint64>(value);
    constexpr quint64 kSign = quint64{1} << 63;
    return (bits & kSign) != 0 ? ~bits : bits | kSign;
}

// The value that a numeric sort type compares.
quint64 PrimaryNumber(const SongOrder& order, const TID3Tag& song) {
    switch (order.SortType) {
        case stYear:
            return static_cast<quint64>(YearNumber(song.Year) + (qint64{1} << 32));
        case stLength:
            return song.Length;
        case stGenre:
            return song.MainGenre;
        case stPlayCnt:
            return song.PlayCount;
        case stAddTime:
            return OrderedBits(song.AddTime);
        case stFlags:
            return CountedFlags(order, song.Flags);
        default:
            return static_cast<quint64>(CacheKind(song));
    }
}

int ComparePrimary(const SongOrder& order, const TID3Tag& a, const TID3Tag& b) {
    if (order.SortType == stPath) return ComparePaths(a.FileName, b.FileName);
    if (const QString* text = PrimaryText(order.SortType, a))
        return Collation::CompareIgnoringCase(*text, *PrimaryText(order.SortType, b));
    return CompareNumbers(PrimaryNumber(order, a), PrimaryNumber(order, b));
}

int CompareTies(TSubSortType type, const TID3Tag& a, const TID3Tag& b) {
    if (type == sstPath) return ComparePaths(a.FileName, b.FileName);
    int result = type == sstGATL ? CompareNumbers(a.MainGenre, b.MainGenre) : 0;
    if (result == 0) result = Collation::CompareIgnoringCase(a.Artist, b.Artist);
    if (result == 0) result = Collation::CompareIgnoringCase(a.Title, b.Title);
    return result != 0 ? result : CompareNumbers(a.Length, b.Length);
}

// --- Sorting everything: texts become ranks once, numbers are sorted ---

using Entries = std::span<const SongList::Entry>;

// What the full sort compares before it looks at single texts.
struct SortItem {
    quint64 Primary;
    quint64 Secondary;
    quint32 Index;  // place before sorting; keeps equal songs in their order

    bool SameKeys(const SortItem& other) const {
        return Primary == other.Primary && Secondary == other.Secondary;
    }
    bool operator<(const SortItem& other) const {
        if (Primary != other.Primary) return Primary < other.Primary;
        if (Secondary != other.Secondary) return Secondary < other.Secondary;
        return Index < other.Index;
    }
};

// Ranks of texts: texts that compare equal share one. Each different text goes through the collator once.
class TextRanks {
 public:
    explicit TextRanks(std::size_t expected) {
        ids_.reserve(static_cast<qsizetype>(std::min<std::size_t>(expected, 1 << 16)));
    }

    // A number for the text; its rank is known after Finish().
    quint32 Add(const QString& text) {
        // In a sorted collection neighbours share their artist.
        if (!texts_.empty() && text.constData() == texts_[last_].constData() &&
            text.size() == texts_[last_].size())
            return last_;
        const auto next = static_cast<quint32>(texts_.size());
        const auto [place, isNew] = ids_.tryInsert(text, next);
        if (isNew) texts_.push_back(text);
        return last_ = *place;
    }

    void Finish() {
        std::vector<QCollatorSortKey> keys;
        keys.reserve(texts_.size());
        for (const QString& text : texts_)
            keys.push_back(Collation::CaseInsensitive().sortKey(text));
        std::vector<quint32> sorted(texts_.size());
        std::iota(sorted.begin(), sorted.end(), 0u);
        std::sort(sorted.begin(), sorted.end(),
                  [&keys](quint32 a, quint32 b) { return keys[a].compare(keys[b]) < 0; });
        ranks_.resize(texts_.size());
        quint32 rank = 0;
        for (std::size_t i = 0; i < sorted.size(); ++i) {
            if (i > 0 && keys[sorted[i - 1]].compare(keys[sorted[i]]) != 0) ++rank;
            ranks_[sorted[i]] = rank;
        }
    }

    quint32 Rank(quint32 id) const { return ranks_[id]; }

 private:
    // QHash has no insertion that reports whether the key was new in one look-up.
    class Ids {
     public:
        void reserve(qsizetype count) { hash_.reserve(count); }
        std::pair<const quint32*, bool> tryInsert(const QString& text, quint32 id) {
            const auto before = hash_.size();
            quint32& place = hash_[text];
            const bool isNew = hash_.size() > before;
            if (isNew) place = id;
            return {&place, isNew};
        }

     private:
        QHash<QString, quint32> hash_;
    };

    Ids ids_;
    std::vector<QString> texts_;
    std::vector<quint32> ranks_;
    quint32 last_ = 0;
};

std::vector<quint32> RankAll(Entries entries, const QString& (*text)(const TID3Tag&)) {
    TextRanks ranks(entries.size());
    std::vector<quint32> result;
    result.reserve(entries.size());
    for (const auto& entry : entries)
        result.push_back(ranks.Add(text(*entry)));
    ranks.Finish();
    for (quint32& id : result)
        id = ranks.Rank(id);
    return result;
}

const QString& ArtistOf(const TID3Tag& song) {
    return song.Artist;
}

std::vector<quint32> PrimaryRanks(TSortType type, Entries entries) {
    switch (type) {
        case stTitle:
            return RankAll(entries, [](const TID3Tag& song) -> const QString& { return song.Title; });
        case stAlbum:
            return RankAll(entries, [](const TID3Tag& song) -> const QString& { return song.Album; });
        case stComment:
            return RankAll(entries, [](const TID3Tag& song) -> const QString& { return song.Comment; });
        case stPath:
            return RankAll(entries, [](const TID3Tag& song) -> const QString& { return song.FileName; });
        default:
            return RankAll(entries, &ArtistOf);
    }
}

void FillPrimary(const SongOrder& order, Entries entries, std::vector<SortItem>& items) {
    if (!ComparesText(order.SortType)) {
        for (SortItem& item : items)
            item.Primary = PrimaryNumber(order, *entries[item.Index]);
        return;
    }
    const auto ranks = PrimaryRanks(order.SortType, entries);
    // Paths on CDs come behind all others.
    const auto group = [&](quint32 i) {
        return order.SortType == stPath && IsCdPath(entries[i]->FileName) ? quint64{1} << 32 : 0;
    };
    for (SortItem& item : items)
        item.Primary = group(item.Index) | ranks[item.Index];
}

void FillSecondary(const SongOrder& order, Entries entries, std::vector<SortItem>& items) {
    if (order.SubSortType == sstPath) {
        for (SortItem& item : items)
            item.Secondary = IsCdPath(entries[item.Index]->FileName) ? 1 : 0;
        return;
    }
    const auto ranks = RankAll(entries, &ArtistOf);
    for (SortItem& item : items) {
        const quint64 genre = order.SubSortType == sstGATL ? entries[item.Index]->MainGenre : 0;
        item.Secondary = genre << 32 | ranks[item.Index];
    }
}

// Orders songs that are equal up to here by the last text of the sub sort type, then by length. The text is
// asked for here only: most runs are the songs of one artist, whose few keys stay in the processor's cache.
void SortRun(const SongOrder& order, Entries entries, std::span<SortItem> run, std::vector<quint32>& places) {
    struct Last {
        QCollatorSortKey Key;
        quint16 Length;
        quint32 Index;
    };
    const bool byPath = order.SubSortType == sstPath;
    std::vector<Last> last;
    last.reserve(run.size());
    for (const SortItem& item : run) {
        const TID3Tag& song = *entries[item.Index];
        last.push_back({Collation::CaseInsensitive().sortKey(byPath ? song.FileName : song.Title),
                        byPath ? quint16{0} : song.Length, item.Index});
    }
    const int sign = order.Backwards ? -1 : 1;
    std::sort(last.begin(), last.end(), [sign](const Last& a, const Last& b) {
        int result = a.Key.compare(b.Key);
        if (result == 0) result = CompareNumbers(a.Length, b.Length);
        return result != 0 ? sign * result < 0 : a.Index < b.Index;
    });
    for (const Last& item : last)
        places.push_back(item.Index);
}

// The old places of the entries, in their new order.
std::vector<quint32> SortedPlaces(const SongOrder& order, Entries entries) {
    std::vector<SortItem> items(entries.size());
    for (std::size_t i = 0; i < items.size(); ++i)
        items[i].Index = static_cast<quint32>(i);
    FillPrimary(order, entries, items);
    FillSecondary(order, entries, items);
    if (order.Backwards) {
        for (SortItem& item : items) {
            item.Primary = ~item.Primary;
            item.Secondary = ~item.Secondary;
        }
    }
    std::sort(items.begin(), items.end());

    std::vector<quint32> places;
    places.reserve(items.size());
    for (std::size_t first = 0; first < items.size();) {
        std::size_t end = first + 1;
        while (end < items.size() && items[end].SameKeys(items[first]))
            ++end;
        if (end - first == 1)
            places.push_back(items[first].Index);
        else
            SortRun(order, entries, std::span(items).subspan(first, end - first), places);
        first = end;
    }
    return places;
}

}  // namespace

int CompareSongs(const SongOrder& order, const TID3Tag& a, const TID3Tag& b) {
    int result = ComparePrimary(order, a, b);
    if (result == 0) result = CompareTies(order.SubSortType, a, b);
    return order.Backwards ? -result : result;
}

void SortSongs(const SongOrder& order, std::vector<SongList::Entry>& entries) {
    const auto places = SortedPlaces(order, entries);
    std::vector<SongList::Entry> sorted;
    sorted.reserve(entries.size());
    for (const quint32 place : places)
        sorted.push_back(std::move(entries[place]));
    entries = std::move(sorted);
}

bool IsSorted(const SongOrder& order, const SongList& songs) {
    const TID3Tag* previous = nullptr;
    for (const auto& entry : songs) {
        if (previous != nullptr && CompareSongs(order, *previous, *entry) > 0) return false;
        previous = entry.get();
    }
    return true;
}

SongIndex TargetPosition(const SongOrder& order, const SongList& songs, SongIndex index) {
    const auto count = static_cast<SongIndex>(songs.Count());
    if (count < 2) return index;
    const TID3Tag& moving = songs.At(index);
    const auto compare = [&](SongIndex position) { return CompareSongs(order, moving, songs.At(position)); };

    SongIndex start = (count - 1) / 2;
    if (index > 0) {
        if (compare(index - 1) >= 0) {
            if (index == count - 1 || compare(index + 1) <= 0) return index;
            start = index + 2;
        } else {
            start = index - 2;
        }
    }
    if (start < 0) return 0;

    // Positions without the moving entry's own: others[k] for k in 0 to count - 2.
    const auto other = [index](SongIndex k) { return k < index ? k : k + 1; };
    const auto firstWhere = [&](SongIndex low, SongIndex high, auto predicate) {
        while (low < high) {
            const SongIndex middle = low + (high - low) / 2;
            if (predicate(other(middle)))
                high = middle;
            else
                low = middle + 1;
        }
        return low;
    };
    const SongIndex othersBelowStart = start <= index ? start : start - 1;
    if (start < count && compare(start) < 0) {
        const SongIndex k =
            firstWhere(0, othersBelowStart, [&](SongIndex position) { return compare(position) < 0; });
        return k == 0 ? 0 : other(k - 1) + 1;
    }
    const SongIndex from = std::min(othersBelowStart, count - 1);
    const SongIndex k =
        firstWhere(from, count - 1, [&](SongIndex position) { return compare(position) <= 0; });
    return k == count - 1 ? count : other(k);
}
