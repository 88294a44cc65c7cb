#include "app/views/SongListWidget.h"

#include <gtest/gtest.h>

#include <QHeaderView>
#include <QMenu>
#include <QScrollBar>
#include <QTest>

#include "app/models/FilteredSongs.h"
#include "app/models/SongColumns.h"
#include "app/models/SongListModel.h"
#include "app/models/SongMime.h"
#include "tests/HandClock.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
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

    void ClickHeader(SongFieldId column) {
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
    QStringList MarkedTitles() const {
        QStringList titles;
        for (const SongIndex index : list_.MarkedSongs())
            titles << database_.Song(index).Title;
        return titles;
    }
    QString FirstTitle() const { return shown_.SongAt(0)->Title; }
    QString TopTitle() const { return shown_.SongAt(list_.rowAt(0))->Title; }

    TMusicDatabase database_;
    SongListModel model_{database_};
    FilteredSongs shown_{model_};
    SongListWidget list_{shown_, database_};
};

TEST_F(SongListWidgetTest, ClicksOnAHeaderSortForwardsThenBackwards) {
    for (const auto& [first, order] :
         {std::pair(u"Lied 399"_s, Qt::AscendingOrder), std::pair(u"Lied 100"_s, Qt::DescendingOrder)}) {
        ClickHeader(SongFieldId::Length);
        EXPECT_EQ(FirstTitle(), first);
        EXPECT_EQ(list_.horizontalHeader()->sortIndicatorSection(), static_cast<int>(SongFieldId::Length));
        EXPECT_EQ(list_.horizontalHeader()->sortIndicatorOrder(), order);
    }
    ClickHeader(SongFieldId::Title);
    EXPECT_EQ(database_.SortType(), stTitle);
    EXPECT_FALSE(database_.SortBackwards());
}

TEST_F(SongListWidgetTest, AColumnThatTheDatabaseDoesNotSortByIsSortedInTheList) {
    for (const int row : {7, 9, 40}) {
        TID3Tag song = database_.Song(row);
        song.BitRate = static_cast<quint16>(row * 10);
        database_.UpdateEntry(row, song);
    }
    model_.SyncViews();
    Focus(9);
    ClickHeader(SongFieldId::BitRate);
    ClickHeader(SongFieldId::BitRate);
    EXPECT_EQ(database_.SortType(), stTitle);
    EXPECT_EQ(list_.horizontalHeader()->sortIndicatorSection(), static_cast<int>(SongFieldId::BitRate));
    EXPECT_EQ(list_.horizontalHeader()->sortIndicatorOrder(), Qt::DescendingOrder);
    QStringList first;
    for (int row = 0; row < 4; ++row)
        first << shown_.SongAt(row)->Title;
    EXPECT_EQ(first, (QStringList{u"Lied 140"_s, u"Lied 109"_s, u"Lied 107"_s, u"Lied 100"_s}));
    EXPECT_EQ(FocusedTitle(), u"Lied 109"_s);
    list_.MarkAll();
    EXPECT_EQ(list_.DraggedSongs().front().Hint, 40) << "a drag takes the songs as the list shows them";

    ClickHeader(SongFieldId::Title);
    EXPECT_EQ(FirstTitle(), u"Lied 100"_s);
    EXPECT_FALSE(database_.SortBackwards());
}

TEST_F(SongListWidgetTest, TheListMovesSidewaysOnlyWhenTheUserMovesIt) {
    QScrollBar& bar = *list_.horizontalScrollBar();
    list_.resize(300, 400);
    QApplication::processEvents();
    bar.setValue(150);
    for (const auto& move : std::initializer_list<std::function<void()>>{
             [&] { Focus(200); }, [&] { QTest::keyClick(&list_, Qt::Key_End); }, [&] { list_.FocusSong(3); },
             [&] {
                 list_.SetOrder({stLength, sstGATL, false, 0});
             },
             [&] { QTest::mouseClick(list_.viewport(), Qt::LeftButton, {}, QPoint(295, 50)); }}) {
        move();
        EXPECT_EQ(bar.value(), 150);
    }
    QTest::keyClick(&list_, Qt::Key_Right);
    EXPECT_GT(bar.value(), 150);
}

TEST_F(SongListWidgetTest, TheFocusedSongStaysInSightOnlyWhenWanted) {
    for (const bool wanted : {true, false}) {
        database_.SetFollowFocus(wanted);
        list_.SetOrder({stTitle, sstGATL, false, 0});
        Focus(2);
        list_.scrollToTop();
        ClickHeader(SongFieldId::Length);
        EXPECT_EQ(FocusedTitle(), u"Lied 102"_s);
        EXPECT_EQ(FocusVisible(), wanted);
    }
}

TEST_F(SongListWidgetTest, FocusAndMarksOutliveASortFromElsewhere) {
    Focus(5);
    list_.selectionModel()->select(shown_.index(8, 0),
                                   QItemSelectionModel::Select | QItemSelectionModel::Rows);
    database_.SetSortBackwards(true);
    EXPECT_EQ(FocusedTitle(), u"Lied 105"_s);
    EXPECT_EQ(MarkedTitles(), QStringList({u"Lied 108"_s, u"Lied 105"_s}));
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

TEST_F(SongListWidgetTest, ARefusedSortIsToldAndLeavesTheArrow) {
    ScriptedDialogs dialogs;
    database_.BeginBusy();
    ClickHeader(SongFieldId::Length);
    database_.EndBusy();
    EXPECT_EQ(dialogs.Messages, QStringList{u"Umsortieren der Datenbank ist momentan nicht möglich."_s});
    EXPECT_EQ(list_.horizontalHeader()->sortIndicatorSection(), static_cast<int>(SongFieldId::Title));
}

// --- Focus and marks ---

TEST_F(SongListWidgetTest, OnlyShownSongsAreMarked) {
    ScriptedDialogs dialogs;
    shown_.SetText(u"11"_s);
    dialogs.Inputs = {u"-5"_s};
    list_.MarkByFilter();
    EXPECT_EQ(MarkedTitles().join(u','),
              u"Lied 110,Lied 111,Lied 112,Lied 113,Lied 114,Lied 116,Lied 117,Lied 118,Lied 119,Lied 211,"
              "Lied 311"_s);
    list_.InvertMarks();
    EXPECT_EQ(MarkedTitles(), QStringList{u"Lied 115"_s});

    list_.MarkByFilter();  // cancelled
    EXPECT_EQ(MarkedTitles(), QStringList{u"Lied 115"_s});
    shown_.SetText(QString());
    EXPECT_EQ(MarkedTitles(), QStringList{u"Lied 115"_s});
    Focus(7);
    list_.MarkAll();
    list_.InvertMarks();
    EXPECT_TRUE(list_.MarkedSongs().empty());
    EXPECT_EQ(list_.FocusedSong(), 7) << "the focus is no mark";
    list_.MarkAll();
    shown_.SetText(u"399"_s);
    EXPECT_EQ(list_.MarkedSongs(), std::vector<SongIndex>{299});
}

TEST_F(SongListWidgetTest, MarksAreToldWhereSongsStandNow) {
    Focus(10);
    AddSong(database_, u"Aa"_s);
    EXPECT_EQ(list_.FocusedSong(), 11);
    EXPECT_EQ(list_.MarkedSongs(), std::vector<SongIndex>{11});
    database_.RemoveEntry(11);
    EXPECT_EQ(list_.FocusedSong(), -1);
    EXPECT_TRUE(list_.MarkedSongs().empty());
}

TEST_F(SongListWidgetTest, AHiddenSongGetsTheFocusBackUnlessAnotherHasIt) {
    Focus(250);
    shown_.SetText(u"-350"_s);
    EXPECT_EQ(list_.FocusedSong(), -1);
    shown_.SetText(QString());
    EXPECT_EQ(list_.FocusedSong(), 250);
    EXPECT_TRUE(FocusVisible());

    shown_.SetText(u"-350"_s);
    list_.Enter();
    EXPECT_EQ(list_.FocusedSong(), 0);
    shown_.SetText(QString());
    EXPECT_EQ(list_.FocusedSong(), 0);
}

TEST_F(SongListWidgetTest, FindingGoesOnFromTheFocusRoundTheEnd) {
    const SongFilter filter = SongFilter::Parse(u"99"_s);
    for (const SongIndex expected : {99, 199, 299, 99}) {
        EXPECT_TRUE(list_.FocusNext(filter));
        EXPECT_EQ(list_.FocusedSong(), expected);
    }
    EXPECT_FALSE(list_.FocusNext(SongFilter::Parse(u"Walzer"_s)));
    EXPECT_EQ(list_.FocusedSong(), 99);
    EXPECT_TRUE(FocusVisible());
}

TEST_F(SongListWidgetTest, LettersFindTheTextOfTheSortColumn) {
    HandClock clock;
    AddSong(database_, u"Ärger"_s);
    AddSong(database_, u"Alle"_s);
    model_.SyncViews();
    const auto type = [&](const QString& text) {
        clock.Milliseconds += 10'000;
        QTest::keyClicks(&list_, text);
        return FocusedTitle();
    };
    EXPECT_EQ(type(u"a"_s), u"Alle"_s);
    EXPECT_EQ(type(u"a"_s), u"Ärger"_s);
    EXPECT_EQ(type(u"a"_s), u"Alle"_s);
    EXPECT_EQ(type(u"ar"_s), u"Ärger"_s);
    EXPECT_EQ(type(u"lied 2"_s), u"Lied 200"_s);
    EXPECT_EQ(type(u"ll"_s), u"Lied 202"_s);      // the same letter again: the next but one
    EXPECT_EQ(type(u"lied x"_s), u"Lied 203"_s);  // the first letter has gone on, the last finds nothing
    database_.SetSortType(stLength);
    model_.SyncViews();
    EXPECT_EQ(type(u"14:1"_s), u"Lied 150"_s);
}

// --- Columns ---

TEST_F(SongListWidgetTest, ColumnsAreKeptAndRefused) {
    QHeaderView* header = list_.horizontalHeader();
    const QByteArray atFirst = list_.SaveColumns();
    const int album = static_cast<int>(SongFieldId::Album);
    const int title = static_cast<int>(SongFieldId::Title);
    header->moveSection(header->visualIndex(album), 0);
    header->resizeSection(album, 333);
    header->hideSection(static_cast<int>(SongFieldId::Year));
    const QByteArray changed = list_.SaveColumns();

    list_.ResetColumns();
    EXPECT_EQ(list_.SaveColumns(), atFirst);
    EXPECT_TRUE(list_.RestoreColumns(changed));
    EXPECT_EQ(list_.SaveColumns(), changed);
    EXPECT_EQ(header->visualIndex(album), 0);
    EXPECT_EQ(header->sectionSize(album), 333);
    EXPECT_TRUE(header->isSectionHidden(static_cast<int>(SongFieldId::Year)));

    for (qsizetype length = 0; length < changed.size(); ++length)
        EXPECT_EQ(list_.RestoreColumns(changed.left(length)), length > 4 && (length - 4) % 9 == 0) << length;
    EXPECT_TRUE(list_.RestoreColumns(changed));
    QByteArray broken = changed;
    broken[7] = 99;  // a column that there is not
    EXPECT_FALSE(list_.RestoreColumns(broken));
    EXPECT_EQ(list_.SaveColumns(), changed);

    header->hideSection(title);
    EXPECT_TRUE(list_.RestoreColumns(list_.SaveColumns()));
    EXPECT_FALSE(header->isSectionHidden(title));
}

TEST_F(SongListWidgetTest, TheMenuOfTheHeaderChoosesColumns) {
    QHeaderView* header = list_.horizontalHeader();
    const auto choose = [&](const QString& caption) {
        Q_EMIT header->customContextMenuRequested(QPoint(5, 5));
        const std::unique_ptr<QMenu> menu(list_.findChild<QMenu*>(u"columnMenu"_s));
        for (QAction* action : menu->actions())
            if (action->text().remove(u'&') == caption) return action->trigger();
        ADD_FAILURE() << caption.toStdString();
    };
    const QByteArray before = list_.SaveColumns();
    choose(u"Kanäle"_s);
    EXPECT_FALSE(header->isSectionHidden(static_cast<int>(SongFieldId::Channels)));
    choose(u"Titel"_s);
    EXPECT_FALSE(header->isSectionHidden(0));
    const int width = header->sectionSize(0);
    choose(u"Spaltenbreite anpassen"_s);
    EXPECT_LT(header->sectionSize(0), width);
    choose(u"Alle Spalten zurücksetzen"_s);
    EXPECT_EQ(list_.SaveColumns(), before);
}

TEST_F(SongListWidgetTest, AChosenFlagIsAMarkThatAClickChangesAndThatIsSortedBy) {
    TID3Tag song = database_.Song(7);
    song.Flags = sfBurned | sfDamaged;
    database_.UpdateEntry(7, song);
    model_.SyncViews();
    const QModelIndex mark = shown_.index(7, static_cast<int>(SongFieldId::Flags));
    EXPECT_EQ(mark.data(Qt::CheckStateRole), QVariant());
    list_.ShowFlag(sfDamaged);
    EXPECT_EQ(list_.model()->headerData(mark.column(), Qt::Horizontal), u"Beschädigt"_s);
    EXPECT_EQ(mark.data().toString() + mark.siblingAtRow(8).data().toString(), QString());
    EXPECT_EQ(mark.data(Qt::CheckStateRole).toInt(), Qt::Checked);
    EXPECT_EQ(mark.siblingAtRow(8).data(Qt::CheckStateRole).toInt(), Qt::Unchecked);

    std::vector<std::pair<SongHandle, bool>> clicks;
    model_.OnFlagClick = [&](SongHandle handle, bool on) { clicks.emplace_back(handle, on); };
    list_.scrollTo(mark);
    list_.horizontalScrollBar()->setValue(list_.horizontalScrollBar()->maximum());
    QStyleOptionViewItem option;
    option.rect = list_.visualRect(mark);
    option.features = QStyleOptionViewItem::HasCheckIndicator;
    const QRect box = list_.style()->subElementRect(QStyle::SE_ItemViewItemCheckIndicator, &option, &list_);
    QTest::mouseClick(list_.viewport(), Qt::LeftButton, {}, box.center());
    ASSERT_EQ(clicks.size(), 1U);
    EXPECT_EQ(clicks[0].first, database_.Songs().HandleOf(7));
    EXPECT_FALSE(clicks[0].second);
    EXPECT_EQ(database_.Song(7).Flags, song.Flags);  // whoever is told changes it

    database_.SetOrder(
        {.SortType = stFlags, .SubSortType = sstATL, .Backwards = true, .ShownFlag = sfDamaged});
    EXPECT_EQ(database_.Song(0).Title, song.Title);
    list_.ShowFlag(sfRemixed);
    EXPECT_NE(database_.Song(0).Title, song.Title);
}

}  // namespace
