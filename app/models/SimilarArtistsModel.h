#pragma once

#include <QAbstractTableModel>
#include <vector>

#include "MusicManagment/database/duplicates/SimilarArtists.h"

// Pairs of artists that may be one, with the numbers of songs that they have now.
class SimilarArtistsModel : public QAbstractTableModel {
 public:
    enum Column { Percent, FirstArtist, FirstSongs, SecondArtist, SecondSongs, ColumnCount };
    static constexpr int kSortRole = Qt::UserRole;

    explicit SimilarArtistsModel(const TMusicDatabase& database, QObject* parent = nullptr);

    void SetPairs(std::vector<SimilarArtists> pairs);
    const SimilarArtists& PairAt(int row) const { return pairs_[static_cast<std::size_t>(row)]; }
    // Whether both artists are in the collection, and the user has not said that they are two.
    bool IsOpen(int row) const;
    // The user has said that these are two.
    void Settle(int row) { settled_[static_cast<std::size_t>(row)] = true; }
    // Counts the songs of the artists anew, after the collection has changed.
    void Recount();

    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
    QVariant data(const QModelIndex& index, int role) const override;

 private:
    const TMusicDatabase& database_;
    std::vector<SimilarArtists> pairs_;
    std::vector<char> settled_;
};
