#include "app/views/SongMarks.h"

#include <QItemSelectionModel>
#include <algorithm>

namespace {

void Append(RowRanges& ranges, const RowRange& next) {
    if (!ranges.empty() && next.First <= ranges.back().Last + 1)
        ranges.back().Last = std::max(ranges.back().Last, next.Last);
    else
        ranges.push_back(next);
}

}  // namespace

RowRanges RangesOf(const std::vector<int>& rows) {
    RowRanges ranges;
    for (const int row : rows)
        Append(ranges, {row, row});
    return ranges;
}

RowRanges Complement(const RowRanges& ranges, int rowCount) {
    RowRanges others;
    int next = 0;
    for (const RowRange& range : ranges) {
        if (range.First > next) others.push_back({next, range.First - 1});
        next = range.Last + 1;
    }
    if (next < rowCount) others.push_back({next, rowCount - 1});
    return others;
}

RowRanges MarkedRows(const QItemSelectionModel& selection) {
    RowRanges selected;
    for (const QItemSelectionRange& range : selection.selection())
        selected.push_back({range.top(), range.bottom()});
    std::ranges::sort(selected, {}, &RowRange::First);
    RowRanges merged;
    for (const RowRange& range : selected)
        Append(merged, range);
    return merged;
}

// The old selection goes first: for one that replaces another the selection model compares every range with
// every other.
void MarkRows(QItemSelectionModel& selection, const RowRanges& ranges) {
    selection.clearSelection();
    const QAbstractItemModel& model = *selection.model();
    const int lastColumn = model.columnCount() - 1;
    QItemSelection rows;
    rows.reserve(static_cast<qsizetype>(ranges.size()));
    for (const RowRange& range : ranges)
        rows.append(QItemSelectionRange(model.index(range.First, 0), model.index(range.Last, lastColumn)));
    selection.select(rows, QItemSelectionModel::Select);
}
