#include "MusicManagment/database/sorting/Sorting.h"

#include <algorithm>

#include "CommonRUKTools/Collation.h"
#include "MusicManagment/database/sorting/SortKeys.h"

namespace {

int ComparePaths(const QString& a, const QString& b) {
    if (IsCdPath(a) != IsCdPath(b)) return IsCdPath(a) ? 1 : -1;
    return Collation::CompareIgnoringCase(a, b);
}

int ComparePrimary(const SongOrder& order, const TID3Tag& a, const TID3Tag& b) {
    if (order.SortType == stPath) return ComparePaths(a.FileName, b.FileName);
    if (const QString* text = PrimaryText(order.SortType, a))
        return Collation::CompareIgnoringCase(*text, *PrimaryText(order.SortType, b));
    return CompareNumbers(PrimaryNumber(order, a), PrimaryNumber(order, b));
}

// As the songs of an album follow each other, also where another album has its name.
int CompareAlbumOrder(const TID3Tag& a, const TID3Tag& b) {
    int result = Collation::CompareIgnoringCase(a.Album, b.Album);
    if (result == 0) result = Collation::CompareIgnoringCase(FolderOf(a.FileName), FolderOf(b.FileName));
    if (result == 0) result = CompareNumbers(a.Track, b.Track);
    return result != 0 ? result : Collation::CompareIgnoringCase(a.FileName, b.FileName);
}

int CompareTies(TSubSortType type, const TID3Tag& a, const TID3Tag& b) {
    if (type == sstPath) return ComparePaths(a.FileName, b.FileName);
    int result = type == sstGATL ? CompareNumbers(a.MainGenre, b.MainGenre) : 0;
    if (result == 0) result = Collation::CompareIgnoringCase(a.Artist, b.Artist);
    if (result == 0) result = Collation::CompareIgnoringCase(a.Title, b.Title);
    return result != 0 ? result : CompareNumbers(a.Length, b.Length);
}

}  // namespace

int CompareSongs(const SongOrder& order, const TID3Tag& a, const TID3Tag& b) {
    const bool albums = order.SortType == stAlbumOrder;
    int result = albums ? CompareAlbumOrder(a, b) : ComparePrimary(order, a, b);
    if (result == 0 && !albums) result = CompareTies(order.SubSortType, a, b);
    return order.Backwards ? -result : result;
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
