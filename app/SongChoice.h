#pragma once

#include <optional>

#include "MusicManagment/database/batches/BatchSongs.h"

class SongListWidget;

// Which songs of the list a batch is about.

// The marked ones up to the limit.
BatchSongs MarkedIn(const TMusicDatabase& database, const SongListWidget& list);
// The same; the user is told of those beyond the limit.
BatchSongs ChosenSongs(const TMusicDatabase& database, const SongListWidget& list);
enum class SongPreset { Marked, Nothing };  // the answer of the Return key
// All songs or the marked ones, as the user says where some are marked; `all` and `marked` are what the
// buttons say. Nothing on cancel.
std::optional<BatchSongs> AskForSongs(const TMusicDatabase& database, const SongListWidget& list,
                                      const QString& all, const QString& marked, SongPreset preset);
