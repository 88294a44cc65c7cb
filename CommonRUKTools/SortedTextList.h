#pragma once

#include <QString>
#include <QStringView>

#include "CommonRUKTools/BlockedList.h"

// Texts, each with a number, kept in order; no text stands twice. Rows are found in O(log n).
class SortedTextList {
 public:
    struct Row {
        QString Text;
        int Number = 0;
    };
    using Comparison = int (*)(QStringView a, QStringView b);

    // `compare` must be a total order in which only equal texts are equal. Without one: as a reader of the
    // user's language orders texts, upper and lower case apart.
    explicit SortedTextList(Comparison compare = nullptr);

    int Count() const { return static_cast<int>(rows_.size()); }
    const Row& At(int index) const { return rows_[static_cast<std::size_t>(index)]; }
    auto begin() const { return rows_.begin(); }
    auto end() const { return rows_.end(); }

    // -1 when the text is not in the list.
    int IndexOf(QStringView text) const;
    bool Contains(QStringView text) const { return IndexOf(text) >= 0; }
    // Returns the row's place; a text that is there already stays as it is.
    int Insert(const QString& text, int number = 0);
    void SetNumber(int index, int number) { rows_[static_cast<std::size_t>(index)].Number = number; }
    void RemoveAt(int index) { rows_.removeAt(static_cast<std::size_t>(index)); }
    void Clear() { rows_.clear(); }

 private:
    int LowerBound(QStringView text) const;
    bool IsLastFound(QStringView text) const { return lastFound_ < Count() && At(lastFound_).Text == text; }

    Comparison compare_;
    BlockedList<Row> rows_;
    // Row found last, if it is still there: the songs of a folder mostly share artist and album.
    mutable int lastFound_ = 0;
};
