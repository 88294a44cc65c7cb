#include "app/models/SongRows.h"

void SongRows::SetSongs(std::vector<SongHandle> songs) {
    beginResetModel();
    songs_ = std::move(songs);
    endResetModel();
}

int SongRows::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(songs_.size());
}

int SongRows::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(fields_.size());
}

QVariant SongRows::headerData(int section, Qt::Orientation orientation, int role) const {
    if (orientation != Qt::Horizontal || role != Qt::DisplayRole) return {};
    return QString::fromUtf16(FieldIn(section).ShortCaption);
}

QVariant SongRows::data(const QModelIndex& index, int role) const {
    const TID3Tag* song = database_.Songs().Find(songs_[static_cast<std::size_t>(index.row())]);
    if (song == nullptr) return {};
    const SongField& field = FieldIn(index.column());
    switch (role) {
        case Qt::DisplayRole:
            return field.Text(*song);
        case Qt::ToolTipRole:
            return song->FileName;
        case Qt::TextAlignmentRole:
            return field.Number != nullptr ? QVariant(Qt::AlignRight | Qt::AlignVCenter) : QVariant();
        default:
            return {};
    }
}
