#include "app/models/SimilarArtistsModel.h"

#include "MusicManagment/database/duplicates/DuplicateSearch.h"

using namespace Qt::StringLiterals;

SimilarArtistsModel::SimilarArtistsModel(const TMusicDatabase& database, QObject* parent)
    : QAbstractTableModel(parent), database_(database) {}

void SimilarArtistsModel::SetPairs(std::vector<SimilarArtists> pairs) {
    beginResetModel();
    pairs_ = std::move(pairs);
    settled_.assign(pairs_.size(), false);
    endResetModel();
}

bool SimilarArtistsModel::IsOpen(int row) const {
    const SimilarArtists& pair = PairAt(row);
    return settled_[static_cast<std::size_t>(row)] == 0 && pair.FirstSongs > 0 && pair.SecondSongs > 0;
}

void SimilarArtistsModel::Recount() {
    const SortedTextList& artists = database_.Artists();
    const auto songsOf = [&artists](const QString& artist) {
        const int place = artists.IndexOf(artist);
        return place >= 0 ? artists.At(place).Number : 0;
    };
    for (SimilarArtists& pair : pairs_) {
        pair.FirstSongs = songsOf(pair.First);
        pair.SecondSongs = songsOf(pair.Second);
    }
    if (!pairs_.empty()) Q_EMIT dataChanged(index(0, 0), index(rowCount() - 1, ColumnCount - 1));
}

int SimilarArtistsModel::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(pairs_.size());
}

int SimilarArtistsModel::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : ColumnCount;
}

QVariant SimilarArtistsModel::headerData(int section, Qt::Orientation orientation, int role) const {
    if (orientation != Qt::Horizontal || role != Qt::DisplayRole) return {};
    static const QStringList captions = {u"Warsch."_s, u"Artist 1"_s, u"Songs"_s, u"Artist 2"_s, u"Songs"_s};
    return captions[section];
}

QVariant SimilarArtistsModel::data(const QModelIndex& index, int role) const {
    const SimilarArtists& pair = PairAt(index.row());
    const bool isNumber = index.column() != FirstArtist && index.column() != SecondArtist;
    if (role == Qt::TextAlignmentRole && isNumber) return QVariant(Qt::AlignRight | Qt::AlignVCenter);
    if (role == Qt::ToolTipRole && isNumber) return {};
    if (role != Qt::DisplayRole && role != Qt::ToolTipRole && role != kSortRole) return {};
    switch (index.column()) {
        case Percent:
            return role == kSortRole ? QVariant(pair.Percent) : SimilarityText(pair.Percent);
        case FirstArtist:
            return pair.First;
        case FirstSongs:
            return pair.FirstSongs;
        case SecondArtist:
            return pair.Second;
        default:
            return pair.SecondSongs;
    }
}
