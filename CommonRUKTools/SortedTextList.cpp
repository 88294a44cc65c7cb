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
    if (IsLastFound(text)) return lastFound_;
    const int row = LowerBound(text);
    if (row == Count() || At(row).Text != text) return -1;
    return lastFound_ = row;
}

int SortedTextList::Insert(const QString& text, int number) {
    if (IsLastFound(text)) return lastFound_;
    // Lists are mostly filled in their own order, from a file or a sorted collection.
    const bool behindLast = Count() > 0 && compare_(At(Count() - 1).Text, text) < 0;
    lastFound_ = behindLast ? Count() : LowerBound(text);
    if (lastFound_ == Count() || At(lastFound_).Text != text)
        rows_.insert(static_cast<std::size_t>(lastFound_), Row{text, number});
    return lastFound_;
}
