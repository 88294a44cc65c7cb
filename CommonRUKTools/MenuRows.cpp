#include "CommonRUKTools/MenuRows.h"

std::unique_ptr<TMenuExItem> BuildMenu(QStringView caption, std::span<const MenuRow> rows) {
    using Kind = TMenuExItem::ItemKind;
    auto root = std::make_unique<TMenuExItem>(Kind::Submenu, caption.toString());
    for (const MenuRow& row : rows) {
        const Kind kind = row.Caption.isEmpty() ? Kind::Separator : Kind::Command;
        TMenuExItem& item = root->Add(kind, row.Caption.toString(), row.Id, row.Shortcut.toString());
        item.SetImageIndex(row.ImageIndex);
        item.SetIcon(row.Icon.toString());
    }
    return root;
}
