#pragma once

#include <memory>

#include "app/models/SongMime.h"

class QWidget;

// Lets the user drag songs from `source`, with their number at the pointer; returns when they are dropped.
// What comes of it is the business of the target.
void DragSongs(QWidget& source, std::unique_ptr<SongMimeData> songs, Qt::DropActions actions);
