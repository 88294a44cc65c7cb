#include "app/models/OverviewModel.h"

#include <gtest/gtest.h>

#include <QAbstractItemModelTester>
#include <QSignalSpy>

#include "MusicManagment/database/GroupLists.h"
#include "app/models/GroupSelection.h"
#include "tests/PrintQt.h"
#include "tests/app/Songs.h"

using namespace Qt::StringLiterals;

namespace {

TID3Tag SongOf(const QString& artist, const QString& title) {
    TID3Tag song = CdSong(artist + title);
    song.Artist = artist;
    return song;
}

QStringList Captions(const QAbstractItemModel& model) {
    QStringList captions;
    for (int row = 0; row < model.rowCount(); ++row)
        captions << model.index(row, 0).data().toString();
    return captions;
}

QString CountOf(const QAbstractItemModel& model, int row) {
    return model.index(row, OverviewModel::SongsColumn).data().toString();
}

class OverviewModelTest : public testing::Test {
 protected:
    void Add(const QStringList& artists) {
        for (const QString& artist : artists)
            database_.AddEntry(QString(), SongOf(artist, QString::number(++titles_)));
    }

    int titles_ = 0;
    TMusicDatabase database_;
    OverviewModel model_{database_};
    QAbstractItemModelTester tester_{&model_, QAbstractItemModelTester::FailureReportingMode::Fatal};
};

TEST_F(OverviewModelTest, ShowsEachArtistWithItsSongs) {
    Add({u"Beta"_s, u"Alpha"_s, QString(), u"Beta"_s});
    model_.SyncViews();
    EXPECT_EQ(Captions(model_), QStringList({u"Alle (3)"_s, u"(ohne Angabe)"_s, u"Alpha"_s, u"Beta"_s}));
    EXPECT_EQ(CountOf(model_, 0), u"4"_s);
    EXPECT_EQ(CountOf(model_, 3), u"2"_s);
    EXPECT_EQ(model_.GroupCaptionOf(1), QString());
    EXPECT_TRUE(model_.index(1, 0).data(Qt::FontRole).value<QFont>().italic());
    EXPECT_FALSE(model_.index(2, 0).data(Qt::FontRole).isValid());
}

TEST_F(OverviewModelTest, ManyChangesAreToldInOneStep) {
    Add({u"M"_s});
    model_.SyncViews();
    QSignalSpy inserted(&model_, &QAbstractItemModel::rowsInserted);
    QSignalSpy laidOut(&model_, &QAbstractItemModel::layoutChanged);
    for (int i = 0; i < 300; ++i)
        Add({(i % 2 == 0 ? u"A%1"_s : u"Z%1"_s).arg(i)});
    EXPECT_TRUE(model_.SyncPending());
    EXPECT_EQ(Captions(model_), QStringList({u"Alle (1)"_s, u"M"_s}));
    EXPECT_EQ(inserted.count(), 0);

    model_.SyncViews();
    EXPECT_FALSE(model_.SyncPending());
    EXPECT_EQ(model_.rowCount(), 302);
    EXPECT_EQ(inserted.count(), 1);
    EXPECT_EQ(laidOut.count(), 1);
}

TEST_F(OverviewModelTest, TheFilterFindsFoldedTextAndKeepsTheTotals) {
    Add({u"Mötley"_s, u"Straße"_s, u"Abba"_s, QString()});
    model_.SetFilter(u"MOTL"_s);
    EXPECT_EQ(Captions(model_), QStringList({u"Alle (4)"_s, u"Mötley"_s}));
    model_.SetFilter(u"ohne"_s);
    EXPECT_EQ(Captions(model_), QStringList({u"Alle (4)"_s, u"(ohne Angabe)"_s}));
    Add({u"Die Ohnen"_s});
    model_.SyncViews();
    EXPECT_EQ(Captions(model_), QStringList({u"Alle (5)"_s, u"(ohne Angabe)"_s, u"Die Ohnen"_s}));
    EXPECT_EQ(CountOf(model_, 0), u"5"_s);
    model_.SetFilter(QString());
    EXPECT_EQ(model_.rowCount(), 6);
}

// The songs that a group matches must be those that its list counts.
TEST(GroupSelection, MatchesTheSongsThatTheListsCount) {
    std::vector<TID3Tag> songs;
    for (const auto& [artist, year, seconds, genre] :
         {std::tuple(u"A"_s, u"1985"_s, 100, 3), std::tuple(u"a"_s, u"1989"_s, 119, 8),
          std::tuple(QString(), u"kein Jahr"_s, 0, 0), std::tuple(u"A"_s, u"-5"_s, 4000, 200)}) {
        TID3Tag song;
        song.Artist = song.Album = artist;
        song.Year = year;
        song.Length = static_cast<quint16>(seconds);
        song.MainGenre = static_cast<quint8>(genre);
        songs.push_back(song);
    }
    GroupLists lists;
    for (const TID3Tag& song : songs)
        lists.Add(song);
    for (int type = 0; type < kOverviewTypeCount; ++type) {
        for (int row = 0; row < lists.RowCount(static_cast<TOVType>(type)); ++row) {
            GroupSelection selection;
            selection.Type = static_cast<TOVType>(type);
            if (type == ovGenre)
                selection.Genres.set(static_cast<std::size_t>(row));
            else
                selection.Captions.insert(lists.RowCaption(selection.Type, row));
            const auto matches = [&](const TID3Tag& song) { return selection.Matches(song); };
            EXPECT_FALSE(selection.IsEmpty());
            EXPECT_EQ(std::ranges::count_if(songs, matches), lists.RowSongCount(selection.Type, row))
                << lists.RowCaption(selection.Type, row).toStdString();
        }
    }
}

}  // namespace
