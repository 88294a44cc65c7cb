#pragma once

#include <QHash>
#include <QString>
#include <array>

#include "CommonRUKTools/Listeners.h"
#include "CommonRUKTools/SortedTextList.h"
#include "MusicManagment/database/SongTypes.h"
#include "ReadMPEGHeader/Genres.h"
#include "ReadMPEGHeader/ID3Tag.h"

// Numbers of songs of the 20 main genres.
using GenreCounts = std::array<int, kMainGenreCount>;

// The year as a number: 0 when the text is empty or no number.
int YearNumber(const QString& year);
// Captions of the buckets, for example "In den 80ern" and "2 bis 3 Minuten".
QString YearBucket(int year);
QString LengthBucket(int seconds);
// The caption under which a song is counted in a text list.
QString GroupCaption(TOVType type, const TID3Tag& song);
// The row of the genres in which it is counted.
int GenreRowOf(const TID3Tag& song);

// Sorted lists whose order is that of the buckets; texts that are no bucket come last.
class TYearList : public SortedTextList {
 public:
    TYearList();
};
class TLengthList : public SortedTextList {
 public:
    TLengthList();
};

// What happens to the rows of the lists.
struct GroupEvents {
    Listeners<TOVType, int, const QString&, int> Inserted;  // row, caption, number of songs
    Listeners<TOVType, int> Deleted;                        // row
    Listeners<TOVType, int, int> Updated;                   // row, number of songs
    Listeners<> Rebuilt;                                    // all of them
};

// The five summary lists: how many songs each artist, album, year bucket, length bucket and main genre has.
class GroupLists {
 public:
    GroupLists();

    GroupEvents& Events() { return events_; }

    // Nobody is told of a Clear and of added rows until TellRebuilt.
    void Clear();  // genre rows stay, with count 0
    void TellRebuilt() const { events_.Rebuilt.Tell(); }

    // Counts a song in or out.
    void Add(const TID3Tag& song);
    void Remove(const TID3Tag& song);
    // The same for a song that changes; rows in which it stays are left alone.
    void Change(const TID3Tag& before, const TID3Tag& after);

    // Rows as a database file gives them; a text that is there already adds to its number. A number that no
    // collection can reach is taken as the nearest that one can.
    void AddRow(TOVType type, const QString& caption, int count);
    void SetGenreCount(int genre, int count);

    const SortedTextList& Artists() const { return lists_[ovArtist]; }
    const SortedTextList& Albums() const { return lists_[ovAlbum]; }
    const SortedTextList& Years() const { return lists_[ovYear]; }
    const SortedTextList& Lengths() const { return lists_[ovLength]; }
    const GenreCounts& Genres() const { return genres_; }

    // The same by type; genre rows are captioned with the long names of the main genres.
    int RowCount(TOVType type) const;
    QString RowCaption(TOVType type, int row) const;
    int RowSongCount(TOVType type, int row) const;

 private:
    void CountUp(TOVType type, const QString& caption);
    void CountDown(TOVType type, const QString& caption);
    void CountGenre(int row, int change);

    std::array<SortedTextList, 4> lists_;
    GenreCounts genres_{};
    GroupEvents events_;
};

// Counts many songs at once: a row is looked for once for each caption instead of once for each song.
class GroupTally {
 public:
    void Add(const TID3Tag& song);
    // Adds a row for each caption to `lists` and sets its genres.
    void WriteTo(GroupLists& lists) const;

 private:
    std::array<QHash<QString, int>, 4> captions_;
    GenreCounts genres_{};
};
