#pragma once

#include <QAbstractTableModel>
#include <vector>

#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/SongFields.h"

// Some songs of the collection and some fields of them, as a small table; songs that go leave an empty row.
class SongRows : public QAbstractTableModel {
 public:
    SongRows(const TMusicDatabase& database, std::vector<SongFieldId> fields, QObject* parent = nullptr)
        : QAbstractTableModel(parent), database_(database), fields_(std::move(fields)) {}

    void SetSongs(std::vector<SongHandle> songs);

    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
    QVariant data(const QModelIndex& index, int role) const override;

 private:
    const SongField& FieldIn(int column) const { return FieldOf(fields_[static_cast<std::size_t>(column)]); }

    const TMusicDatabase& database_;
    std::vector<SongFieldId> fields_;
    std::vector<SongHandle> songs_;
};
