#include "CommonRUKTools/MenuItem.h"

const TMenuExItem* TMenuExItem::Find(int id) const {
    if (id == 0) return nullptr;
    if (id_ == id) return this;
    for (const auto& item : items_)
        if (const TMenuExItem* found = std::as_const(*item).Find(id)) return found;
    return nullptr;
}
