#include "MusicManagment/database/duplicates/KeptPairs.h"

#include "MusicManagment/database/MusicManagment.h"

using namespace Qt::StringLiterals;

namespace {

const QString kSection = u"distinct"_s;

}  // namespace

std::vector<std::pair<QString, QString>> KeptPairs(const TMusicDatabase& database) {
    std::vector<std::pair<QString, QString>> pairs;
    for (SideRow& row : database.Side().Rows(kSection))
        pairs.emplace_back(std::move(row.Song), std::move(row.Value));
    return pairs;
}

void SetKeptPair(TMusicDatabase& database, const TID3Tag& first, const TID3Tag& second, bool kept) {
    SideFile& side = database.Side();
    if (kept) {
        side.Add(kSection, {first.FileName, second.FileName});
    } else {
        side.Remove(kSection, {first.FileName, second.FileName});
        side.Remove(kSection, {second.FileName, first.FileName});
    }
    // Read-only: for this run of the program.
    if (!database.ReadOnly()) side.Save();
}
