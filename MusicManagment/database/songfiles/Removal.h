#pragma once

#include <QString>
#include <QStringList>
#include <vector>

#include "MusicManagment/database/SongList.h"

class Journal;
class TMusicDatabase;

// Takes songs out of the collection; their files stay. Songs that are not there are passed over. Each returns
// how many have gone.

// For good; none while the database takes no changes.
int RemoveSongs(TMusicDatabase& database, const QStringList& paths);
// So that it can be taken back, also when the files are gone by then; `caption` names it in the menu. Throws
// what FileBatch throws, and EStreamError when the journal cannot be written; the songs are still there then.
int RemoveSongs(Journal& journal, TMusicDatabase& database, const std::vector<SongHandle>& songs,
                const QString& caption);
