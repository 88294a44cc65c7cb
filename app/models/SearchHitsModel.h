#pragma once

#include <QAbstractTableModel>
#include <vector>

#include "HTTPRetrieval/SearchHit.h"

// What a search in the Internet has found, in the order of the service.
class SearchHitsModel : public QAbstractTableModel {
 public:
    enum Column { Artist, Title, Album, Year, Track, Length, ColumnCount };

    using QAbstractTableModel::QAbstractTableModel;

    void Append(const std::vector<SearchHit>& hits);
    const SearchHit& HitAt(int row) const { return hits_[static_cast<std::size_t>(row)]; }

    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
    QVariant data(const QModelIndex& index, int role) const override;

 private:
    std::vector<SearchHit> hits_;
};
