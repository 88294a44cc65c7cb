#pragma once

#include <QStringView>
#include <memory>
#include <span>

#include "CommonRUKTools/MenuItem.h"

// A command in a menu of one level, written as a table.
struct MenuRow {
    QStringView Caption;  // empty: a separator
    int Id = 0;
    QStringView Shortcut{};
    int ImageIndex = -1;
    QStringView Icon{};  // its name in the freedesktop icon themes
};

std::unique_ptr<TMenuExItem> BuildMenu(QStringView caption, std::span<const MenuRow> rows);
