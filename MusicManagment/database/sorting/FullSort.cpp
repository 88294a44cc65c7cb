#include <algorithm>
#include <numeric>
#include <span>

#include "CommonRUKTools/Collation.h"
#include "MusicManagment/database/sorting/SortKeys.h"
#include "MusicManagment/database/sorting/Sorting.h"

// Sorting everything: texts become ranks once, numbers are sorted.

namespace {

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

// A text's key, which orders as Collation::CompareIgnoringCase does.
class TextKey {
 public:
    explicit TextKey(const QString& text)
        : key_(Collation::CaseInsensitive().sortKey(text)), empty_(text.isEmpty()) {}

    int Compare(const TextKey& other) const {
        // The collator puts the empty text before texts of control characters alone; their keys are the same.
        if (empty_ != other.empty_) return empty_ ? -1 : 1;
        return key_.compare(other.key_);
    }

 private:
    QCollatorSortKey key_;
    bool empty_;
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
        std::vector<TextKey> keys;
        keys.reserve(texts_.size());
        for (const QString& text : texts_)
            keys.emplace_back(text);
        std::vector<quint32> sorted(texts_.size());
        std::iota(sorted.begin(), sorted.end(), 0u);
        std::sort(sorted.begin(), sorted.end(),
                  [&keys](quint32 a, quint32 b) { return keys[a].Compare(keys[b]) < 0; });
        ranks_.resize(texts_.size());
        quint32 rank = 0;
        for (std::size_t i = 0; i < sorted.size(); ++i) {
            if (i > 0 && keys[sorted[i - 1]].Compare(keys[sorted[i]]) != 0) ++rank;
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

template <typename TextOf>
std::vector<quint32> RankAll(Entries entries, TextOf text) {
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

bool ComparesText(TSortType type) {
    return PrimaryText(type, TID3Tag()) != nullptr;
}

void FillAlbumOrder(Entries entries, std::vector<SortItem>& items) {
    const auto albums = RankAll(entries, [](const TID3Tag& song) -> const QString& { return song.Album; });
    const auto folders = RankAll(entries, [](const TID3Tag& song) { return FolderOf(song.FileName); });
    for (SortItem& item : items) {
        item.Primary = quint64{albums[item.Index]} << 32 | folders[item.Index];
        item.Secondary = entries[item.Index]->Track;
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

// One song of a run whose songs are equal up to the last text of the sub sort type.
struct RunItem {
    const QString* Text;
    quint16 Length;
    quint32 Index;     // place before sorting
    quint32 Position;  // place in the run, before sorting
};

template <typename CompareTexts>
void SortItems(std::vector<RunItem>& items, bool backwards, CompareTexts compareTexts) {
    const int sign = backwards ? -1 : 1;
    std::sort(items.begin(), items.end(), [&](const RunItem& a, const RunItem& b) {
        int result = compareTexts(a, b);
        if (result == 0) result = CompareNumbers(a.Length, b.Length);
        return result != 0 ? sign * result < 0 : a.Index < b.Index;
    });
}

void SortLongRun(std::vector<RunItem>& items, bool backwards) {
    std::vector<TextKey> keys;
    keys.reserve(items.size());
    for (const RunItem& item : items)
        keys.emplace_back(*item.Text);
    SortItems(items, backwards, [&keys](const RunItem& a, const RunItem& b) {
        return keys[a.Position].Compare(keys[b.Position]);
    });
}

void SortShortRun(std::vector<RunItem>& items, bool backwards) {
    SortItems(items, backwards, [](const RunItem& a, const RunItem& b) {
        return Collation::CompareIgnoringCase(*a.Text, *b.Text);
    });
}

// A sort key costs as much as several comparisons of short texts, so a run of a few songs goes without. The
// bound also limits the loss with scripts that the collator compares slowly.
constexpr std::size_t kShortRun = 16;

// Orders songs that are equal up to here by the last text of the sub sort type, then by length.
void SortRun(const SongOrder& order, Entries entries, std::span<SortItem> run, std::vector<quint32>& places) {
    const bool byPath = order.SubSortType == sstPath || order.SortType == stAlbumOrder;
    std::vector<RunItem> items;
    items.reserve(run.size());
    for (const SortItem& item : run) {
        const TID3Tag& song = *entries[item.Index];
        items.push_back({byPath ? &song.FileName : &song.Title, byPath ? quint16{0} : song.Length, item.Index,
                         static_cast<quint32>(items.size())});
    }
    if (items.size() <= kShortRun)
        SortShortRun(items, order.Backwards);
    else
        SortLongRun(items, order.Backwards);
    for (const RunItem& item : items)
        places.push_back(item.Index);
}

// The old places of the entries, in their new order.
std::vector<quint32> SortedPlaces(const SongOrder& order, Entries entries) {
    std::vector<SortItem> items(entries.size());
    for (std::size_t i = 0; i < items.size(); ++i)
        items[i].Index = static_cast<quint32>(i);
    if (order.SortType == stAlbumOrder) {
        FillAlbumOrder(entries, items);
    } else {
        FillPrimary(order, entries, items);
        FillSecondary(order, entries, items);
    }
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

void SortSongs(const SongOrder& order, std::vector<SongList::Entry>& entries) {
    const auto places = SortedPlaces(order, entries);
    std::vector<SongList::Entry> sorted;
    sorted.reserve(entries.size());
    for (const quint32 place : places)
        sorted.push_back(std::move(entries[place]));
    entries = std::move(sorted);
}
