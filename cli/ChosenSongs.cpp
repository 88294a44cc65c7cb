#include "cli/ChosenSongs.h"

#include "CommonRUKTools/AbsolutePath.h"
#include "MusicManagment/database/search/SongFilter.h"

using namespace Qt::StringLiterals;

namespace {

std::vector<SongHandle> FilteredSongs(const TMusicDatabase& database, const SongFilter& filter) {
    std::vector<SongHandle> songs;
    for (SongIndex i = 0; i < database.Count(); ++i)
        if (filter.Matches(database.Song(i))) songs.push_back(database.Songs().HandleOf(i));
    return songs;
}

SongFilter FilterOf(const QString& text) {
    const QStringList unknown = SongFilter::UnknownFields(text);
    if (!unknown.isEmpty())
        throw EUsageError(u"Der Filter kennt dieses Feld nicht: "_s + unknown.join(u", "_s) +
                          u". Möglich sind: "_s + SongFilter::FieldNames().join(u", "_s));
    return SongFilter::Parse(text);
}

}  // namespace

ChosenSongs NamedSongs(const TMusicDatabase& database, const QStringList& paths, Console& console) {
    ChosenSongs chosen;
    for (const QString& path : paths) {
        const TID3Tag* song = database.Songs().Find(IsCdPath(path) ? path : AbsolutePath(path));
        if (song != nullptr) {
            chosen.Songs.push_back(database.Songs().HandleOf(*song));
            continue;
        }
        chosen.AllFound = false;
        console.Message(u"Nicht in der Sammlung: "_s + Printable(path));
    }
    return chosen;
}

ChosenSongs ChooseSongs(const TMusicDatabase& database, const Arguments& arguments, Console& console) {
    const bool all = arguments.Has(kAllOption.Name);
    const bool byFilter = arguments.Has(kFilterOption.Name);
    const bool named = !arguments.Operands().isEmpty();
    if (int{all} + int{byFilter} + int{named} != 1)
        throw EUsageError(u"Anzugeben ist genau eines: --all, --filter oder die Songs."_s);
    if (named) return NamedSongs(database, arguments.Operands(), console);
    const QString filter = arguments.Value(kFilterOption.Name);
    return {.Songs = FilteredSongs(database, all ? SongFilter() : FilterOf(filter))};
}
