#include "app/views/TagPreviewList.h"

#include <QAbstractListModel>
#include <QFont>

using namespace Qt::StringLiterals;

class TagPreviewList::Rows : public QAbstractListModel {
 public:
    using QAbstractListModel::QAbstractListModel;

    void Set(std::vector<TagPreviewRow> rows) {
        beginResetModel();
        rows_ = std::move(rows);
        endResetModel();
    }
    int rowCount(const QModelIndex& parent) const override {
        return parent.isValid() ? 0 : static_cast<int>(rows_.size());
    }
    QVariant data(const QModelIndex& index, int role) const override {
        if (!index.isValid()) return {};
        const TagPreviewRow& row = rows_[static_cast<std::size_t>(index.row())];
        const bool isFile = row.Field.isEmpty();
        switch (role) {
            case Qt::DisplayRole:
                return isFile ? PreviewLine(row) : u"    "_s + PreviewLine(row);
            case Qt::ToolTipRole:
                return isFile ? row.File : PreviewLine(row);
            case Qt::FontRole:
                return isFile ? BoldFont() : QVariant();
            default:
                return {};
        }
    }

 private:
    static QVariant BoldFont() {
        QFont font;
        font.setBold(true);
        font.setResolveMask(QFont::WeightResolved);
        return font;
    }

    std::vector<TagPreviewRow> rows_;
};

TagPreviewList::TagPreviewList(QWidget* parent) : QListView(parent), rows_(new Rows(this)) {
    setObjectName(u"tagPreview"_s);
    setAccessibleName(u"Vorschau"_s);
    setUniformItemSizes(true);  // a hundred thousand rows need not be measured one by one
    setTextElideMode(Qt::ElideMiddle);
    setEditTriggers(NoEditTriggers);
    setModel(rows_);
}

void TagPreviewList::SetRows(std::vector<TagPreviewRow> rows) {
    rows_->Set(std::move(rows));
}
