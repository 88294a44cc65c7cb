#include "app/models/SongListModel.h"

#include <gtest/gtest.h>

#include <QAbstractItemModelTester>
#include <QSignalSpy>
#include <random>

#include "app/models/SongColumns.h"
#include "tests/PrintQt.h"
#include "tests/app/Songs.h"

using namespace Qt::StringLiterals;

namespace {

QString Shown(const QAbstractItemModel& model, int row, SongFieldId column = SongFieldId::Title) {
    return model.index(row, static_cast<int>(column)).data().toString();
}

QStringList ShownTitles(const QAbstractItemModel& model) {
    QStringList titles;
    for (int row = 0; row < model.rowCount(); ++row)
        titles << Shown(model, row);
    return titles;
}

QStringList TitlesOf(const TMusicDatabase& database) {
    QStringList titles;
    for (const auto& song : database.Songs())
        titles << u"[CD] "_s + song->Title;
    return titles;
}

class SongListModelTest : public testing::Test {
 protected:
    SongListModelTest() { database_.SetSortType(stTitle); }

    void AddSongs(const QStringList& titles) {
        for (const QString& title : titles)
            AddSong(database_, title);
        model_.SyncViews();
    }

    TMusicDatabase database_;
    SongListModel model_{database_};
    QAbstractItemModelTester tester_{&model_, QAbstractItemModelTester::FailureReportingMode::Fatal};
};

TEST_F(SongListModelTest, ManyInsertionsAreToldInOneStep) {
    AddSongs({u"M"_s});
    QSignalSpy inserted(&model_, &QAbstractItemModel::rowsInserted);
    QSignalSpy laidOut(&model_, &QAbstractItemModel::layoutChanged);
    for (int i = 0; i < 500; ++i)
        AddSong(database_, (i % 2 == 0 ? u"A%1"_s : u"Z%1"_s).arg(i));
    EXPECT_EQ(model_.rowCount(), 1);
    EXPECT_EQ(ShownTitles(model_), QStringList{u"[CD] M"_s});

    model_.SyncViews();
    EXPECT_EQ(inserted.count(), 1);
    EXPECT_EQ(laidOut.count(), 1);
    EXPECT_EQ(ShownTitles(model_), TitlesOf(database_));
}

TEST_F(SongListModelTest, RowsShowTheirSongsWhateverHappensBetweenTwoSyncs) {
    std::mt19937 random(99);
    const auto pick = [&](int count) { return std::uniform_int_distribution<int>(0, count - 1)(random); };
    AddSongs({u"D"_s, u"H"_s, u"K"_s, u"P"_s, u"S"_s});
    for (int round = 0; round < 200; ++round) {
        QStringList expected = ShownTitles(model_);
        const QPersistentModelIndex held = model_.index(pick(model_.rowCount()), 0);
        const QString heldTitle = Shown(model_, held.row());
        for (int change = 0; change < 6; ++change) {
            const int kind = pick(5);
            if (kind < 3 || database_.Count() < 3) {
                AddSong(database_, u"%1%2"_s.arg(QChar(u'A' + pick(26))).arg(round * 10 + change));
                continue;
            }
            const int row = pick(database_.Count());
            const QString before = u"[CD] "_s + database_.Song(row).Title;
            QString after;  // a removed song's row shows nothing
            if (kind == 3) {
                database_.RemoveEntry(row);
            } else {
                TID3Tag song = database_.Song(row);
                song.Title = u"%1%2"_s.arg(QChar(u'A' + pick(26))).arg(round * 10 + change);
                after = u"[CD] "_s + song.Title;
                database_.UpdateEntry(row, song);
            }
            const auto at = expected.indexOf(before);
            if (at >= 0) expected[at] = after;
        }
        ASSERT_EQ(ShownTitles(model_), expected);
        const QString heldNow = Shown(model_, held.row());
        model_.SyncViews();
        ASSERT_EQ(ShownTitles(model_), TitlesOf(database_));
        ASSERT_EQ(held.isValid(), !heldNow.isEmpty()) << heldTitle.toStdString();
        if (held.isValid()) {
            ASSERT_EQ(Shown(model_, held.row()), heldNow);
        }
    }
}

TEST_F(SongListModelTest, WhatIsNotKnownIsShownAsNothing) {
    TID3Tag song;
    song.FileName = QCoreApplication::applicationFilePath();
    song.Title = u"Z"_s;
    song.Year = u"0000"_s;
    song.AddTime = 1;
    database_.AddEntry(QString(), song);
    model_.SyncViews();
    EXPECT_EQ(Shown(model_, 0), u"Z"_s) << "no mark of a CD";
    for (const SongFieldId column : {SongFieldId::Year, SongFieldId::Track, SongFieldId::Genre,
                                     SongFieldId::Channels, SongFieldId::Flags})
        EXPECT_EQ(Shown(model_, 0, column), QString());
}

}  // namespace
