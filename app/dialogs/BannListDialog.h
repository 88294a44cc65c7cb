#pragma once

#include <QDialog>
#include <QStringListModel>

#include "CommonRUKTools/SortedTextList.h"

class QLineEdit;
class QListView;
class QSortFilterProxyModel;

// Shows the ban list, finds, adds and removes entries, and exchanges them with files. It works on a copy: the
// list is what the user has accepted.
class BannListDialog : public QDialog {
 public:
    explicit BannListDialog(const SortedTextList& list, QWidget* parent = nullptr);

    // As it is to be.
    const SortedTextList& List() const { return list_; }

 private:
    void SetUpLayout();
    void Show();
    void Add();
    void RemoveChosen();
    void Import();
    void Export() const;

    SortedTextList list_;
    QStringListModel entries_;
    QSortFilterProxyModel* shown_;
    QLineEdit* filter_;
    QListView* view_;
};
