#pragma once

#include <cstddef>
#include <vector>

// What has happened to the rows of a list since its views were last told. Until they are, they go on asking
// for the rows that they know; the journal says where those stand now.
class RowJournal {
 public:
    // Forgets everything; the views know `rowCount` rows from now on.
    void Start(int rowCount);

    void Insert(int row);
    void Remove(int row);
    void Move(int from, int to);  // `to` counted after the row has been taken out

    bool Empty() const { return !changed_; }
    int OldCount() const { return oldCount_; }
    int NewCount() const { return newCount_; }
    // Where a row that the views know stands now; -1 when it was removed.
    int NewRowOf(int oldRow) const;
    // True when all old rows are where they were.
    bool OldRowsStay() const;
    // Each change takes time in proportion to this number.
    std::size_t Size() const { return pieces_.size(); }

 private:
    // A run of neighbouring rows: old ones in their old order, or new ones.
    struct Piece {
        int OldRow;  // the first one's; -1 for new rows
        int Count;
        bool IsNew() const { return OldRow < 0; }
    };
    struct Place {
        int OldRow;
        int Count;
        int NewRow;
    };

    struct Position {
        std::size_t Piece;  // behind the last one for the end of the list
        int Offset;
    };

    Position Find(int row) const;
    // Cuts so that a piece begins at `row`; its number.
    std::size_t CutAt(int row);
    void NoteChange(int rows);
    const std::vector<Place>& Places() const;

    std::vector<Piece> pieces_;          // in the order of the list now
    mutable std::vector<Place> places_;  // by old row
    mutable bool placesCurrent_ = false;
    int oldCount_ = 0;
    int newCount_ = 0;
    bool changed_ = false;
};
