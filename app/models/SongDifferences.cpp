#include "app/models/SongDifferences.h"

#include <algorithm>

using namespace Qt::StringLiterals;

std::vector<DifferenceRow> FieldDifferences(const TID3Tag& first, const TID3Tag& second) {
    std::vector<DifferenceRow> rows;
    for (const SongField& field : SongFields()) {
        DifferenceRow row{QString::fromUtf16(field.ShortCaption), field.Text(first), field.Text(second)};
        if (!row.First.isEmpty() || !row.Second.isEmpty()) rows.push_back(std::move(row));
    }
    return rows;
}

std::vector<DifferenceRow> FileDifferences(const FileDetails& first, const FileDetails& second) {
    std::vector<DifferenceRow> rows;
    for (const PropertyRow& property : first.File)
        rows.push_back({property.Name, property.Value, {}});
    for (const PropertyRow& property : second.File) {
        const auto known = std::ranges::find(rows, property.Name, &DifferenceRow::Name);
        if (known != rows.end())
            known->Second = property.Value;
        else
            rows.push_back({property.Name, {}, property.Value});
    }
    if (!first.Error.isEmpty() || !second.Error.isEmpty())
        rows.push_back({u"Fehler"_s, first.Error, second.Error});
    return rows;
}
