#pragma once

#include <QTreeWidget>
#include <vector>

#include "app/models/SongProperties.h"

// Rows of names and values under headings, which can be copied as text.
class PropertyTree : public QTreeWidget {
 public:
    explicit PropertyTree(QWidget* parent = nullptr);

    // Headings without rows are left out; folded headings stay folded.
    void SetGroups(const std::vector<PropertyGroup>& groups);
    // The chosen rows as text; a chosen heading stands for its rows.
    QString ChosenText() const;
    QString AllText() const { return PropertyText(groups_); }
    void CopyChosen() const;
    void CopyAll() const;

 protected:
    bool event(QEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void contextMenuEvent(QContextMenuEvent* event) override;
    void changeEvent(QEvent* event) override;

 private:
    void FitToFont();

    std::vector<PropertyGroup> groups_;
};
