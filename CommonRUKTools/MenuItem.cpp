#include "CommonRUKTools/MenuItem.h"

TMenuExItem* TMenuExItem::Find(int id) {
    if (id == 0) return nullptr;
    if (id_ == id) return this;
    for (const auto& item : items_)
        if (TMenuExItem* found = item->Find(id)) return found;
    return nullptr;
}
