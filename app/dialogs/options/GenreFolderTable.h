#pragma once

#include <QStringList>
#include <QTableWidget>
#include <optional>

// The folder names of the 20 main genres, which the user can edit.
class GenreFolderTable : public QTableWidget {
 public:
    explicit GenreFolderTable(QWidget* parent = nullptr);

    // One name for each main genre.
    QStringList Names() const;
    void SetNames(const QStringList& names);
    // What is wrong with a name, for the user; the cell is then the current one.
    std::optional<QString> Fault();
};
