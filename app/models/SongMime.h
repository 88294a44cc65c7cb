#pragma once

#include <QMimeData>
#include <QStringList>
#include <vector>

#include "MusicManagment/database/SongTypes.h"

class TPlayList;

// A song on its way from one view to another.
struct SongRef {
    QString Name;         // as the database or the playlist has it
    SongIndex Hint = -1;  // where it probably stands in the database
};

// Songs as drag and drop and the clipboard carry them: their files for other programs, and for this one also
// those that lie on a CD. The texts are made when somebody asks for them.
class SongMimeData : public QMimeData {
 public:
    explicit SongMimeData(std::vector<SongRef> songs) : songs_(std::move(songs)) {}

    std::size_t Count() const { return songs_.size(); }

    QStringList formats() const override;

 protected:
    QVariant retrieveData(const QString& format, QMetaType type) const override;

 private:
    std::vector<SongRef> songs_;
};

// What a drop brings a playlist.
struct DroppedSongs {
    std::vector<SongRef> Songs{};  // dragged within this program
    QStringList Paths{};           // of files and folders from elsewhere

    bool IsEmpty() const { return Songs.empty() && Paths.isEmpty(); }
};

// The formats that ReadDrop understands.
QStringList DropFormats();
DroppedSongs ReadDrop(const QMimeData& data);
// Returns how many entries were inserted. Throws what TPlayList::InsertFiles throws.
int InsertDrop(TPlayList& list, int position, const DroppedSongs& drop);
