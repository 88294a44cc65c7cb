#include "app/models/FilteredSongs.h"

#include <gtest/gtest.h>

#include <QAbstractItemModelTester>
#include <QSignalSpy>
#include <random>

#include "app/models/SongColumns.h"
#include "tests/PrintQt.h"
#include "tests/app/Songs.h"

using namespace Qt::StringLiterals;

namespace {

class FilteredSongsTest : public testing::Test {
 protected:
    FilteredSongsTest() { database_.SetSortType(stTitle); }

    void AddSongs(const QStringList& titles) {
        for (const QString& title : titles)
            AddSong(database_, title);
        songs_.SyncViews();
    }
    QStringList Shown() const {
        QStringList titles;
        for (int row = 0; row < shown_.rowCount(); ++row)
            titles << shown_.SongAt(row)->Title;
        return titles;
    }
    // What must be shown, found in the simplest way.
    QStringList Expected(const QString& text, const FilteredSongs::Restriction& restriction) const {
        const SongFilter filter = SongFilter::Parse(text);
        std::vector<const TID3Tag*> songs;
        for (const auto& song : database_.Songs())
            if (filter.Matches(*song) && (!restriction || restriction(*song))) songs.push_back(song.get());
        if (const auto order = shown_.Order())
            std::ranges::stable_sort(songs,
                                     [backwards = order->Backwards](const TID3Tag* a, const TID3Tag* b) {
                                         return backwards ? a->Track > b->Track : a->Track < b->Track;
                                     });
        QStringList titles;
        for (const TID3Tag* song : songs)
            titles << song->Title;
        return titles;
    }

    TMusicDatabase database_;
    SongListModel songs_{database_};
    FilteredSongs shown_{songs_};
    QAbstractItemModelTester tester_{&shown_, QAbstractItemModelTester::FailureReportingMode::Fatal};
};

TEST_F(FilteredSongsTest, AChangeOfTheFilterIsToldInOneStep) {
    for (int i = 0; i < 1000; ++i)
        AddSong(database_, u"Lied %1"_s.arg(1000 + i));
    songs_.SyncViews();
    QSignalSpy inserted(&shown_, &QAbstractItemModel::rowsInserted);
    QSignalSpy removed(&shown_, &QAbstractItemModel::rowsRemoved);
    QSignalSpy laidOut(&shown_, &QAbstractItemModel::layoutChanged);
    shown_.SetText(u"7"_s);
    EXPECT_EQ(shown_.rowCount(), 271);
    EXPECT_EQ(removed.count() + laidOut.count(), 2);
    shown_.SetText(QString());
    EXPECT_EQ(shown_.rowCount(), 1000);
    EXPECT_EQ(inserted.count() + laidOut.count(), 3);
}

// Against the simplest way to filter: random edits of the collection, its order and the filter.
class RandomFilteringTest : public FilteredSongsTest, public testing::WithParamInterface<unsigned> {
 protected:
    int Pick(int count) { return std::uniform_int_distribution<int>(0, count - 1)(random_); }
    QString RandomTitle() {
        QString title;
        for (int i = 0; i < 4; ++i)
            title += QChar(u'a' + Pick(3));
        return title + QString::number(next_++);
    }
    void EditCollection() {
        const int row = Pick(std::max(1, database_.Count()));
        switch (database_.Count() < 3 ? 0 : Pick(5)) {
            case 0:
            case 1:
                AddSong(database_, RandomTitle());
                break;
            case 2:
                database_.RemoveEntry(row);
                break;
            case 3: {  // to another place
                TID3Tag song = database_.Song(row);
                song.Title = RandomTitle();
                database_.UpdateEntry(row, song);
                break;
            }
            default: {  // where it is, but perhaps no longer or newly let through
                TID3Tag song = database_.Song(row);
                song.Track = static_cast<quint8>(Pick(12));
                song.Comment = song.Comment.isEmpty() ? u"abc"_s : QString();
                database_.UpdateEntry(row, song);
            }
        }
    }
    void Wholesale() {
        switch (Pick(5)) {
            case 0:
                songs_.SetOrder({stTitle, sstGATL, Pick(2) == 0, 0});
                break;
            case 1:
                database_.SetSortBackwards(Pick(2) == 0);  // told as a reset
                break;
            case 2:
                restriction_ = Pick(2) == 0 ? FilteredSongs::Restriction()
                                            : [](const TID3Tag& song) { return song.Title.contains(u'b'); };
                shown_.SetRestriction(restriction_);
                break;
            case 3:
                if (Pick(3) == 0)
                    shown_.SetOrder(std::nullopt);
                else
                    shown_.SetOrder(ShownOrder{static_cast<int>(SongFieldId::Track), Pick(2) == 0});
                break;
            default:
                if (Pick(8) == 0) database_.Clear();
        }
    }
    void EditText() {
        static const QStringList kPieces = {u"a"_s,  u"b"_s,       u"c"_s, u" "_s,         u" -"_s,
                                            u"\""_s, u" titel:"_s, u"1"_s, u" länge:<6"_s, u".."_s};
        if (Pick(4) == 0) text_.chop(Pick(6));
        if (Pick(10) == 0) text_.clear();
        text_ += kPieces[Pick(static_cast<int>(kPieces.size()))];
        shown_.SetText(text_);
    }

    std::mt19937 random_{GetParam()};
    QString text_;
    FilteredSongs::Restriction restriction_;
    int next_ = 0;
};

TEST_P(RandomFilteringTest, ShowsWhatTheFilterLetsThroughAndHoldsOnToSongs) {
    for (int i = 0; i < 40; ++i)
        AddSong(database_, RandomTitle());
    songs_.SyncViews();
    int kept = 0;
    for (int round = 0; round < 400; ++round) {
        QPersistentModelIndex held;
        const TID3Tag* song = nullptr;
        if (shown_.rowCount() > 0) {
            held = shown_.index(Pick(shown_.rowCount()), 1);
            song = shown_.SongAt(held.row());
        }
        const int edits = Pick(4);
        for (int i = 0; i < edits; ++i)
            EditCollection();
        if (Pick(3) == 0) Wholesale();
        if (Pick(2) == 0) EditText();
        songs_.SyncViews();
        ASSERT_EQ(Shown(), Expected(text_, restriction_)) << text_.toStdString();
        if (held.isValid()) {
            ++kept;
            ASSERT_EQ(shown_.SongAt(held.row()), song);
            ASSERT_EQ(&database_.Song(shown_.IndexAt(held.row())), song);
        }
    }
    EXPECT_GT(kept, 20);  // the others were removed, hidden or forgotten in a reset
}

INSTANTIATE_TEST_SUITE_P(Seeds, RandomFilteringTest, testing::Values(1U, 2U, 3U));

}  // namespace
