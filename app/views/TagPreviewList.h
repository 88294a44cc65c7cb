#pragma once

#include <QListView>

#include "app/models/TagPreview.h"

// Shows song by song what is about to be done.
class TagPreviewList : public QListView {
 public:
    explicit TagPreviewList(QWidget* parent = nullptr);

    void SetRows(std::vector<TagPreviewRow> rows);

 private:
    class Rows;
    Rows* rows_;
};
