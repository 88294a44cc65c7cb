#include "app/models/GroupSelection.h"

#include "MusicManagment/database/GroupLists.h"

bool GroupSelection::Matches(const TID3Tag& song) const {
    if (IsEmpty()) return true;
    if (Type == ovGenre) return Genres.test(static_cast<std::size_t>(GenreRowOf(song)));
    return Captions.contains(GroupCaption(Type, song));
}
