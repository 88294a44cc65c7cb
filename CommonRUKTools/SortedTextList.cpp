#include "CommonRUKTools/SortedTextList.h"

#include "CommonRUKTools/Collation.h"

SortedTextList::SortedTextList(Comparison compare)
    : compare_(compare != nullptr ? compare : &Collation::CompareExactly) {}

int SortedTextList::LowerBound(QStringView text) const {
    int low = 0;
    int high = Count();
    while (low < high) {
        const int middle = low + (high - low) / 2;
        if (compare_(At(middle).Text, text) < 0)
            low = middle + 1;
        else
            high = middle;
    }
    return low;
}

int SortedTextList::IndexOf(QStringView text) const {
    const int row = LowerBound(text);
    return row < Count() && At(row).Text == text ? row : -1;
}

int SortedTextList::Insert(const QString& text, int number) {
    // Lists are mostly filled in their own order, from a file or a sorted collection.
    const bool behindLast = Count() > 0 && compare_(At(Count() - 1).Text, text) < 0;
    const int row = behindLast ? Count() : LowerBound(text);
    if (row < Count() && At(row).Text == text) return row;
    rows_.insert(static_cast<std::size_t>(row), Row{text, number});
    return row;
}
