#include "app/views/SongListWidget.h"

#include <gtest/gtest.h>

#include <QHeaderView>
#include <QScrollBar>
#include <QTest>

#include "app/models/FilteredSongs.h"
#include "app/models/SongColumns.h"
#include "app/models/SongListModel.h"
#include "tests/PrintQt.h"
#include "tests/app/ScriptedDialogs.h"
#include "tests/app/Songs.h"

using namespace Qt::StringLiterals;

namespace {

class SongListWidgetTest : public testing::Test {
 protected:
    SongListWidgetTest() {
        database_.SetSortType(stTitle);
        for (int i = 100; i < 400; ++i)
            AddSong(database_, u"Lied %1"_s.arg(i), 1000 - i);
        model_.SyncViews();
        list_.resize(1200, 400);
        list_.show();
        QApplication::processEvents();
    }

    void ClickHeader(SongColumnId column) {
        QHeaderView* header = list_.horizontalHeader();
        const int x = header->sectionViewportPosition(static_cast<int>(column)) + 10;
        QTest::mouseClick(header->viewport(), Qt::LeftButton, {}, QPoint(x, header->height() / 2));
        QApplication::processEvents();
    }
    void Focus(int row) { list_.setCurrentIndex(shown_.index(row, 0)); }
    QString FocusedTitle() const { return shown_.SongAt(list_.currentIndex().row())->Title; }
    bool FocusVisible() const {
        return list_.viewport()->rect().contains(list_.visualRect(list_.currentIndex()).center());
    }
    QString FirstTitle() const { return shown_.SongAt(0)->Title; }
    QString TopTitle() const { return shown_.SongAt(list_.rowAt(0))->Title; }

    TMusicDatabase database_;
    SongListModel model_{database_};
    FilteredSongs shown_{model_};
    SongListWidget list_{shown_, database_};
};

TEST_F(SongListWidgetTest, ClicksOnAHeaderSortForwardsThenBackwards) {
    QHeaderView* header = list_.horizontalHeader();
    ClickHeader(SongColumnId::Length);
    EXPECT_EQ(FirstTitle(), u"Lied 399"_s);
    EXPECT_EQ(header->sortIndicatorSection(), static_cast<int>(SongColumnId::Length));
    EXPECT_EQ(header->sortIndicatorOrder(), Qt::AscendingOrder);

    ClickHeader(SongColumnId::Length);
    EXPECT_EQ(FirstTitle(), u"Lied 100"_s);
    EXPECT_TRUE(database_.SortBackwards());
    EXPECT_EQ(header->sortIndicatorOrder(), Qt::DescendingOrder);

    ClickHeader(SongColumnId::Title);
    EXPECT_EQ(database_.SortType(), stTitle);
    EXPECT_FALSE(database_.SortBackwards());
}

TEST_F(SongListWidgetTest, AColumnWithoutAnOrderDoesNotTakeTheArrow) {
    ClickHeader(SongColumnId::BitRate);
    EXPECT_EQ(database_.SortType(), stTitle);
    EXPECT_EQ(list_.horizontalHeader()->sortIndicatorSection(), static_cast<int>(SongColumnId::Title));
}

TEST_F(SongListWidgetTest, TheFocusedSongStaysInSightOnlyWhenWanted) {
    Focus(2);
    ClickHeader(SongColumnId::Length);
    EXPECT_EQ(FocusedTitle(), u"Lied 102"_s);
    EXPECT_TRUE(FocusVisible());

    database_.SetFollowFocus(false);
    ClickHeader(SongColumnId::Length);
    ClickHeader(SongColumnId::Length);
    list_.scrollToTop();
    ClickHeader(SongColumnId::Title);
    ClickHeader(SongColumnId::Title);
    EXPECT_EQ(FocusedTitle(), u"Lied 102"_s);
    EXPECT_FALSE(FocusVisible());
}

TEST_F(SongListWidgetTest, TheFocusOutlivesASortFromElsewhere) {
    Focus(5);
    database_.SetSortBackwards(true);
    EXPECT_EQ(FocusedTitle(), u"Lied 105"_s);
    EXPECT_TRUE(FocusVisible());
    EXPECT_EQ(list_.horizontalHeader()->sortIndicatorOrder(), Qt::DescendingOrder);
}

TEST_F(SongListWidgetTest, SongsThatComeInAboveDoNotPushTheVisibleOnesAway) {
    list_.verticalScrollBar()->setValue(150);
    const QString before = TopTitle();
    for (int i = 0; i < 40; ++i)
        AddSong(database_, u"Am Anfang %1"_s.arg(i));
    model_.SyncViews();
    EXPECT_EQ(TopTitle(), before);

    list_.scrollToTop();
    AddSong(database_, u"Aa"_s);
    model_.SyncViews();
    EXPECT_EQ(TopTitle(), u"Aa"_s);
}

TEST_F(SongListWidgetTest, HomeAndEndGoThroughTheRows) {
    Focus(20);
    QTest::keyClick(&list_, Qt::Key_End);
    EXPECT_EQ(list_.currentIndex().row(), 299);
    QTest::keyClick(&list_, Qt::Key_Home);
    EXPECT_EQ(list_.currentIndex().row(), 0);
}

TEST_F(SongListWidgetTest, ARefusedSortIsToldAndLeavesTheArrow) {
    ScriptedDialogs dialogs;
    database_.BeginBusy();
    ClickHeader(SongColumnId::Length);
    database_.EndBusy();
    EXPECT_EQ(dialogs.Messages, QStringList{u"Umsortieren der Datenbank ist momentan nicht möglich."_s});
    EXPECT_EQ(list_.horizontalHeader()->sortIndicatorSection(), static_cast<int>(SongColumnId::Title));
}

}  // namespace
