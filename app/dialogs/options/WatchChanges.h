#pragma once

#include <functional>

class QWidget;

// Tells whenever the user or the program changes a field within `page`. Fields that are made later are not
// seen.
void WatchChanges(QWidget& page, const std::function<void()>& changed);
