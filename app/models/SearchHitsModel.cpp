#include "app/models/SearchHitsModel.h"

#include "ReadMPEGHeader/DisplayTexts.h"

using namespace Qt::StringLiterals;

namespace {

QString TextOf(const SearchHit& hit, int column) {
    switch (column) {
        case SearchHitsModel::Artist:
            return hit.Artist;
        case SearchHitsModel::Title:
            return hit.Title;
        case SearchHitsModel::Album:
            return hit.Album;
        case SearchHitsModel::Year:
            return hit.Year;
        case SearchHitsModel::Track:
            return hit.Track > 0 ? QString::number(hit.Track) : QString();
        default:
            return hit.Length > 0 ? FormatLength(hit.Length, true) : QString();
    }
}

}  // namespace

void SearchHitsModel::Append(const std::vector<SearchHit>& hits) {
    if (hits.empty()) return;
    const int first = rowCount();
    beginInsertRows({}, first, first + static_cast<int>(hits.size()) - 1);
    hits_.insert(hits_.end(), hits.begin(), hits.end());
    endInsertRows();
}

int SearchHitsModel::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(hits_.size());
}

int SearchHitsModel::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : ColumnCount;
}

QVariant SearchHitsModel::headerData(int section, Qt::Orientation orientation, int role) const {
    if (orientation != Qt::Horizontal || role != Qt::DisplayRole) return {};
    static const QStringList captions = {u"Artist"_s, u"Titel"_s, u"Album"_s,
                                         u"Jahr"_s,   u"Track"_s, u"Länge"_s};
    return captions[section];
}

QVariant SearchHitsModel::data(const QModelIndex& index, int role) const {
    if (role == Qt::DisplayRole || role == Qt::ToolTipRole) return TextOf(HitAt(index.row()), index.column());
    if (role == Qt::TextAlignmentRole && index.column() >= Year)
        return QVariant(Qt::AlignRight | Qt::AlignVCenter);
    return {};
}
