#include "MusicManagment/database/GroupLists.h"

#include <algorithm>
#include <initializer_list>
#include <vector>

using namespace Qt::StringLiterals;

namespace {

// Ranges of a number, each with its caption. The captions are made once, so that all songs of a bucket share
// one text.
class Buckets {
 public:
    struct Row {
        int From;  // first value; the range ends where the next begins
        QString Text;
    };

    Buckets(std::initializer_list<Row> rows) : rows_(rows) {}

    const QString& TextOf(int value) const {
        std::size_t row = rows_.size() - 1;
        while (row > 0 && value < rows_[row].From)
            --row;
        return rows_[row].Text;
    }
    // Texts that are no bucket come last.
    int Compare(QStringView a, QStringView b) const {
        const int difference = Rank(a) - Rank(b);
        return difference != 0 ? difference : a.compare(b);
    }

 private:
    int Rank(QStringView text) const {
        constexpr int kNoBucket = 255;
        for (std::size_t i = 0; i < rows_.size(); ++i)
            if (text == rows_[i].Text) return static_cast<int>(i);
        return kNoBucket;
    }

    std::vector<Row> rows_;
};

constexpr int kFarFuture = 2051;

const Buckets& YearBuckets() {
    static const Buckets buckets{{0, u"Unbekannt"_s},         {1, u"Vor 1900"_s},
                                 {1900, u"1900 bis 1949"_s},  {1950, u"In den 50ern"_s},
                                 {1960, u"In den 60ern"_s},   {1970, u"In den 70ern"_s},
                                 {1980, u"In den 80ern"_s},   {1990, u"In den 90ern"_s},
                                 {2000, u"2000 bis heute"_s}, {kFarFuture, u"In ferner Zukunft :)"_s}};
    return buckets;
}

const Buckets& LengthBuckets() {
    static const Buckets buckets{
        {0, u"Fehlerhafte Angabe"_s}, {1, u"Unter einer Minute"_s},        {60, u"1 bis 2 Minuten"_s},
        {120, u"2 bis 3 Minuten"_s},  {180, u"3 bis 4 Minuten"_s},         {240, u"4 bis 5 Minuten"_s},
        {300, u"5 bis 10 Minuten"_s}, {600, u"10 Minuten bis 1 Stunde"_s}, {3600, u"Über 1 Stunde"_s}};
    return buckets;
}

int CompareYears(QStringView a, QStringView b) {
    return YearBuckets().Compare(a, b);
}

int CompareLengths(QStringView a, QStringView b) {
    return LengthBuckets().Compare(a, b);
}

constexpr TOVType kTextTypes[] = {ovArtist, ovAlbum, ovYear, ovLength};

// A number from a file, so that two of them can be added and songs counted on without an overflow.
int PossibleCount(int count) {
    constexpr int kMost = 1 << 29;
    return std::clamp(count, 0, kMost);
}

}  // namespace

int YearNumber(const QString& year) {
    bool isNumber = false;
    const int number = year.toInt(&isNumber);
    return isNumber ? number : 0;
}

QString YearBucket(int year) {
    // A negative year is as wrong as one far ahead, and is shown with it.
    return YearBuckets().TextOf(year < 0 ? kFarFuture : year);
}

QString LengthBucket(int seconds) {
    return LengthBuckets().TextOf(seconds);
}

QString GroupCaption(TOVType type, const TID3Tag& song) {
    switch (type) {
        case ovArtist:
            return song.Artist;
        case ovAlbum:
            return song.Album;
        case ovYear:
            return YearBucket(YearNumber(song.Year));
        default:
            return LengthBucket(song.Length);
    }
}

int GenreRowOf(const TID3Tag& song) {
    return song.MainGenre < kMainGenreCount ? song.MainGenre : 0;
}

TYearList::TYearList() : SortedTextList(&CompareYears) {}
TLengthList::TLengthList() : SortedTextList(&CompareLengths) {}

GroupLists::GroupLists() : lists_{SortedTextList(), SortedTextList(), TYearList(), TLengthList()} {}

void GroupLists::Clear() {
    for (SortedTextList& list : lists_)
        list.Clear();
    genres_.fill(0);
}

void GroupLists::Add(const TID3Tag& song) {
    for (const TOVType type : kTextTypes)
        CountUp(type, GroupCaption(type, song));
    CountGenre(GenreRowOf(song), 1);
}

void GroupLists::Remove(const TID3Tag& song) {
    for (const TOVType type : kTextTypes)
        CountDown(type, GroupCaption(type, song));
    CountGenre(GenreRowOf(song), -1);
}

void GroupLists::Change(const TID3Tag& before, const TID3Tag& after) {
    for (const TOVType type : kTextTypes) {
        const QString caption = GroupCaption(type, after);
        if (caption == GroupCaption(type, before)) continue;
        CountDown(type, GroupCaption(type, before));
        CountUp(type, caption);
    }
    if (GenreRowOf(before) == GenreRowOf(after)) return;
    CountGenre(GenreRowOf(before), -1);
    CountGenre(GenreRowOf(after), 1);
}

void GroupLists::AddRow(TOVType type, const QString& caption, int count) {
    SortedTextList& list = lists_[type];
    const int before = list.Count();
    const int number = PossibleCount(count);
    const int row = list.Insert(caption, number);
    if (list.Count() == before) list.SetNumber(row, PossibleCount(list.At(row).Number + number));
}

void GroupLists::SetGenreCount(int genre, int count) {
    genres_[static_cast<std::size_t>(genre)] = PossibleCount(count);
}

int GroupLists::RowCount(TOVType type) const {
    return type == ovGenre ? kMainGenreCount : lists_[type].Count();
}

QString GroupLists::RowCaption(TOVType type, int row) const {
    return type == ovGenre ? MainGenreLongName(row) : lists_[type].At(row).Text;
}

int GroupLists::RowSongCount(TOVType type, int row) const {
    return type == ovGenre ? genres_[static_cast<std::size_t>(row)] : lists_[type].At(row).Number;
}

void GroupLists::CountUp(TOVType type, const QString& caption) {
    SortedTextList& list = lists_[type];
    const int before = list.Count();
    const int row = list.Insert(caption, 1);
    if (list.Count() > before) return events_.Inserted.Tell(type, row, caption, 1);
    const int count = list.At(row).Number + 1;
    list.SetNumber(row, count);
    events_.Updated.Tell(type, row, count);
}

void GroupLists::CountDown(TOVType type, const QString& caption) {
    SortedTextList& list = lists_[type];
    const int row = list.IndexOf(caption);
    if (row < 0) return;  // the lists came from a file that counted differently
    const int left = list.At(row).Number - 1;
    if (left > 0) {
        list.SetNumber(row, left);
        return events_.Updated.Tell(type, row, left);
    }
    list.RemoveAt(row);
    events_.Deleted.Tell(type, row);
}

void GroupLists::CountGenre(int row, int change) {
    int& count = genres_[static_cast<std::size_t>(row)];
    count = std::max(0, count + change);
    events_.Updated.Tell(ovGenre, row, count);
}

void GroupTally::Add(const TID3Tag& song) {
    for (const TOVType type : kTextTypes)
        ++captions_[type][GroupCaption(type, song)];
    ++genres_[static_cast<std::size_t>(GenreRowOf(song))];
}

void GroupTally::WriteTo(GroupLists& lists) const {
    for (const TOVType type : kTextTypes)
        for (auto row = captions_[type].cbegin(); row != captions_[type].cend(); ++row)
            lists.AddRow(type, row.key(), row.value());
    for (int genre = 0; genre < kMainGenreCount; ++genre)
        lists.SetGenreCount(genre, genres_[static_cast<std::size_t>(genre)]);
}
