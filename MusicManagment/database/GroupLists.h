#pragma once

#include <QHash>
#include <QString>
#include <array>

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

// Is told each change of a row.
class GroupListener {
 public:
    virtual ~GroupListener() = default;
    virtual void RowInserted(TOVType type, int row, const QString& caption, int count) = 0;
    virtual void RowDeleted(TOVType type, int row) = 0;
    virtual void RowUpdated(TOVType type, int row, int count) = 0;
};

// The five summary lists: how many songs each artist, album, year bucket, length bucket and main genre has.
class GroupLists {
 public:
    GroupLists();

    void Clear();  // genre rows stay, with count 0
    // Counts a song in or out; `listener` may be nullptr.
    void Add(const TID3Tag& song, GroupListener* listener);
    void Remove(const TID3Tag& song, GroupListener* listener);

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
    void CountUp(TOVType type, const QString& caption, GroupListener* listener);
    void CountDown(TOVType type, const QString& caption, GroupListener* listener);
    void CountGenre(const TID3Tag& song, int change, GroupListener* listener);

    std::array<SortedTextList, 4> lists_;
    GenreCounts genres_{};
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
