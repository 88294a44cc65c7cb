#pragma once

#include <QDialog>

#include "app/models/TagPreview.h"

// Shows song by song what a batch is about to do with tags; accepting it is what the user agrees to.
class TagPreviewDialog : public QDialog {
 public:
    // `agreement` is the button that agrees, with its letter.
    TagPreviewDialog(const QString& title, const QString& agreement, TagPreview preview,
                     QWidget* parent = nullptr);
};
