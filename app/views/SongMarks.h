#pragma once

#include <vector>

class QItemSelectionModel;

// Neighbouring rows of a list, both ends included.
struct RowRange {
    int First;
    int Last;

    bool operator==(const RowRange&) const = default;
};

// Ranges in ascending order that neither touch nor overlap.
using RowRanges = std::vector<RowRange>;

// Ranges of rows given in ascending order.
RowRanges RangesOf(const std::vector<int>& rows);
// The rows below `rowCount` that are in none of the ranges.
RowRanges Complement(const RowRanges& ranges, int rowCount);

// The rows that are selected.
RowRanges MarkedRows(const QItemSelectionModel& selection);
// Selects these rows and no others; the focus stays. Linear also where the rows are scattered.
void MarkRows(QItemSelectionModel& selection, const RowRanges& ranges);
