#pragma once

#include <QMenu>
#include <functional>

class QHeaderView;

// The menu of a header: which columns are shown, and how wide they are.
class ColumnMenu : public QMenu {
 public:
    // `section` is the column that was clicked, -1 for none.
    ColumnMenu(QHeaderView& header, int section, QWidget* parent = nullptr);

    // Adds the choice of the flag that the column of the flags shows; 0 is all of them.
    void AddFlags(quint32 shown, std::function<void(quint32)> choose);

    std::function<void(int section)> OnFit;
    std::function<void()> OnReset;

 private:
    void AddColumns(QHeaderView& header);
};
