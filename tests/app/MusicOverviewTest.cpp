#include "app/views/MusicOverview.h"

#include <gtest/gtest.h>

#include <QComboBox>
#include <QHeaderView>
#include <QLineEdit>
#include <QTest>
#include <QTreeView>

#include "app/views/OverviewForm.h"
#include "tests/PrintQt.h"
#include "tests/app/Songs.h"

using namespace Qt::StringLiterals;

namespace {

class MusicOverviewTest : public testing::Test {
 protected:
    MusicOverviewTest() {
        for (const QString& artist : {u"Alpha"_s, u"Beta"_s, u"Gamma"_s}) {
            TID3Tag song = CdSong(artist);
            song.Artist = artist;
            song.MainGenre = 8;
            database_.AddEntry(QString(), song);
        }
        form_.resize(300, 500);
        form_.show();
        Sync();
        Overview().OnSelectionChanged = [this](const GroupSelection& selection) { told_ << selection; };
    }

    TMusicOverview& Overview() { return form_.Overview(); }
    QTreeView& List() { return *form_.findChild<QTreeView*>(u"overviewList"_s); }
    OverviewModel& Model() { return static_cast<OverviewModel&>(*List().model()); }
    void Sync() {
        Model().SyncViews();
        QApplication::processEvents();
    }
    void Click(int row, Qt::KeyboardModifiers modifiers = {}) {
        const QRect place = List().visualRect(Model().index(row, 0));
        QTest::mouseClick(List().viewport(), Qt::LeftButton, modifiers, place.center());
    }
    QSet<QString> LastCaptions() const { return told_.isEmpty() ? QSet<QString>() : told_.last().Captions; }

    TMusicDatabase database_;
    TOverviewForm form_{database_};
    QList<GroupSelection> told_;
};

TEST_F(MusicOverviewTest, ChosenGroupsAreTold) {
    Click(1);
    EXPECT_EQ(LastCaptions(), QSet<QString>({u"Alpha"_s}));
    Click(3, Qt::ControlModifier);
    EXPECT_EQ(LastCaptions(), QSet<QString>({u"Alpha"_s, u"Gamma"_s}));
    Click(OverviewModel::kAllRow, Qt::ControlModifier);
    EXPECT_TRUE(told_.last().IsEmpty());
    EXPECT_EQ(told_.size(), 3);
    Overview().ClearSelection();
    EXPECT_EQ(told_.size(), 3);
}

TEST_F(MusicOverviewTest, AChosenGroupThatGoesIsNoLongerChosen) {
    Click(2);
    ASSERT_TRUE(database_.RemoveEntry(database_.IndexOf(CdSong(u"Beta"_s).FileName)));
    Sync();
    ASSERT_EQ(told_.size(), 2);
    EXPECT_TRUE(told_.last().IsEmpty());
    EXPECT_FALSE(List().selectionModel()->hasSelection());
}

TEST_F(MusicOverviewTest, AChosenGroupStaysChosenWhileOthersCome) {
    Click(2);
    TID3Tag song = CdSong(u"Neu"_s);
    song.Artist = u"Aaa"_s;
    database_.AddEntry(QString(), song);
    Sync();
    EXPECT_EQ(told_.size(), 1);
    EXPECT_EQ(List().selectionModel()->selectedRows().value(0).data().toString(), u"Beta"_s);
}

TEST_F(MusicOverviewTest, AnotherListStartsWithNothingChosen) {
    Click(1);
    List().setFocus();
    form_.findChild<QLineEdit*>(u"overviewFilter"_s)->setText(u"alp"_s);
    form_.findChild<QComboBox*>()->setCurrentIndex(ovGenre);
    EXPECT_EQ(Overview().OVType(), ovGenre);
    ASSERT_EQ(told_.size(), 2);
    EXPECT_TRUE(told_.last().IsEmpty());
    EXPECT_EQ(Model().rowCount(), 1 + kMainGenreCount);
    Click(9);
    EXPECT_TRUE(told_.last().Genres.test(8));
    EXPECT_EQ(told_.last().Genres.count(), 1U);
}

// As a child of the main window it lives a little longer than the database there.
TEST(MusicOverview, MayOutliveTheDatabase) {
    auto database = std::make_unique<TMusicDatabase>();
    AddSong(*database, u"Lied"_s);
    TMusicOverview overview(*database);
    database.reset();
    overview.SetOVType(ovAlbum);
    EXPECT_EQ(overview.findChild<QTreeView*>()->model()->index(0, 0).data().toString(), u"Alle (0)"_s);
}

}  // namespace
