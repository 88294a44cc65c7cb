#pragma once

#include "MusicManagment/database/duplicates/DuplicateSearch.h"

// Shows the pairs of a search, while they are found.
class DuplicateView {
 public:
    virtual ~DuplicateView() = default;

    // A search begins: the rows, still empty, that it fills. Those of the one before are over.
    virtual DuplicateRows& Begin(const DuplicateQuery& query) = 0;
    virtual void ShowNewRows() = 0;
    // Of every search that has begun, also when it throws.
    virtual void End(DuplicateEnd end) = 0;
};

// The command of the user: nothing in an empty collection. Where all songs are too many, those of `marked`
// may be compared with one another; where it takes long, the user is asked (TMusicDatabase::UnlimitedSearch).
// Throws what FindDuplicates throws.
void SearchDuplicates(TMusicDatabase& database, DuplicateQuery query, const std::vector<SongHandle>& marked,
                      DuplicateView& view);
