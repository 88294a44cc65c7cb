#include "app/views/VisPlayList.h"

#include <gtest/gtest.h>

#include <QComboBox>
#include <QDropEvent>
#include <QHeaderView>
#include <QLabel>
#include <QMimeData>
#include <QSpinBox>
#include <QTest>
#include <QToolButton>
#include <QUrl>

#include "app/views/PlaylistForm.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/app/Songs.h"
#include "tests/database/SongFolder.h"
#include "tests/playlist/ScriptedPlayer.h"

using namespace Qt::StringLiterals;

namespace {

void DropOn(QWidget& widget, const QMimeData& data, const QPoint& place) {
    QDragEnterEvent enter(place, Qt::CopyAction | Qt::MoveAction, &data, Qt::LeftButton, Qt::NoModifier);
    QApplication::sendEvent(&widget, &enter);
    EXPECT_TRUE(enter.isAccepted());
    EXPECT_EQ(enter.dropAction(), Qt::CopyAction);
    QDropEvent drop(place, Qt::CopyAction | Qt::MoveAction, &data, Qt::LeftButton, Qt::NoModifier);
    QApplication::sendEvent(&widget, &drop);
    QApplication::processEvents();
}

class VisPlayListTest : public testing::Test {
 protected:
    VisPlayListTest() {
        list_.SetPlaySound(&player_);
        Fill(6);
        view_.resize(400, 300);
        view_.show();
        QApplication::processEvents();
        view_.OnPlay = [this](int index) { played_ << index; };
    }
    ~VisPlayListTest() override { list_.SetPlaySound(nullptr); }

    void Fill(int count) {
        for (int i = 0; i < count; ++i)
            list_.Insert(list_.Count(), {.Name = u"/Musik/%1.mp3"_s.arg(i), .Record = CdSong({}, 60)});
    }
    void Select(const QList<int>& rows) {
        view_.clearSelection();
        for (const int row : rows)
            view_.selectionModel()->select(view_.model()->index(row, 1),
                                           QItemSelectionModel::Select | QItemSelectionModel::Rows);
        view_.selectionModel()->setCurrentIndex(view_.model()->index(rows.value(0), 1),
                                                QItemSelectionModel::NoUpdate);
    }
    void Press(int key, Qt::KeyboardModifiers modifiers = Qt::NoModifier) {
        QTest::keyClick(&view_, static_cast<Qt::Key>(key), modifiers);
    }
    // "021" for the files 0, 2 and 1.
    QString Order() const {
        QString order;
        for (int i = 0; i < list_.Count(); ++i)
            order += QFileInfo(list_.Entry(i).Name).completeBaseName();
        return order;
    }
    QPoint Above(int row) const {
        return view_.visualRect(view_.model()->index(row, 1)).topLeft() + QPoint(5, 2);
    }
    void Drop(const QMimeData& data, const QPoint& place) { DropOn(*view_.viewport(), data, place); }

    TPlayList list_;
    ScriptedPlayer player_;
    TVisPlayList view_{list_};
    QList<int> played_;
};

TEST_F(VisPlayListTest, ReturnAndADoubleClickPlayTheFocusedEntry) {
    Select({4});
    Press(Qt::Key_Return);
    QTest::mouseDClick(view_.viewport(), Qt::LeftButton, {}, Above(2));
    EXPECT_EQ(played_, QList<int>({4, 2}));
}

TEST_F(VisPlayListTest, SelectedEntriesMoveByKeysAndStaySelected) {
    Select({2, 4});
    Press(Qt::Key_Up, Qt::AltModifier);
    EXPECT_EQ(Order(), u"024135"_s);
    EXPECT_EQ(view_.SelectedEntries(), std::vector<int>({1, 2}));
    Press(Qt::Key_Up, Qt::AltModifier);
    Press(Qt::Key_Up, Qt::AltModifier);
    EXPECT_EQ(Order(), u"240135"_s);
    Press(Qt::Key_Down, Qt::AltModifier);
    EXPECT_EQ(Order(), u"024135"_s);
    Select({5});
    Press(Qt::Key_Down, Qt::AltModifier);
    EXPECT_EQ(Order(), u"024135"_s);
}

TEST_F(VisPlayListTest, SelectedEntriesGoIntoTheQueueAndOutOfIt) {
    Select({3, 1});
    Press(Qt::Key_Return, Qt::ControlModifier);
    EXPECT_EQ(list_.Queue(), QStringList({u"/Musik/1.mp3"_s, u"/Musik/3.mp3"_s}));
    Select({1});
    Press(Qt::Key_Backspace, Qt::ControlModifier);
    EXPECT_EQ(list_.Queue(), QStringList(u"/Musik/3.mp3"_s));
    EXPECT_TRUE(played_.isEmpty());
}

TEST_F(VisPlayListTest, ADropGoesBetweenTheEntriesOrToTheEnd) {
    Drop(SongMimeData({{.Name = u"/Musik/x.mp3"_s}, {.Name = u"/Musik/y.mp3"_s}}), Above(2));
    EXPECT_EQ(Order(), u"01xy2345"_s);
    EXPECT_EQ(view_.SelectedEntries(), std::vector<int>({2, 3}));
    Drop(SongMimeData({{.Name = u"/Musik/z.mp3"_s}}), QPoint(20, view_.viewport()->height() - 2));
    EXPECT_EQ(Order(), u"01xy2345z"_s);
}

TEST_F(VisPlayListTest, AListThatShrinksWhileADropIsReadGetsItAtItsEnd) {
    const SongFolder folder;
    folder.Add(u"7.mp3"_s);
    QMimeData data;
    data.setUrls({QUrl::fromLocalFile(folder.Path())});
    QTimer::singleShot(0, [this] { list_.Remove({0, 1, 2, 3}); });  // before the drop is looked at
    Drop(data, QPoint(20, view_.viewport()->height() - 2));
    EXPECT_EQ(Order(), u"457"_s);
    EXPECT_EQ(view_.SelectedEntries(), std::vector<int>({2}));
}

TEST_F(VisPlayListTest, ADamagedPlayListIsToldAndChangesNothing) {
    ScriptedDialogs dialogs;
    const SongFolder folder;
    QMimeData data;  // a version that nobody knows
    data.setUrls({QUrl::fromLocalFile(folder.Put(u"kaputt.rukpl"_s, "RUKPLYLST??"))});
    Drop(data, Above(0));
    EXPECT_EQ(dialogs.Messages.size(), 1);
    EXPECT_EQ(Order(), u"012345"_s);
}

TEST_F(VisPlayListTest, MarksAndFocusGoAlongWithTheirEntries) {
    Select({1, 3});
    list_.Insert(0, {.Name = u"/Musik/9.mp3"_s});
    list_.Events().CurrentChanged.Tell();
    list_.Enqueue(0);
    list_.Remove(6);
    EXPECT_EQ(view_.SelectedEntries(), std::vector<int>({2, 4}));
    list_.Move({0}, 3);  // by someone else
    list_.RefreshRecord(0);
    EXPECT_EQ(view_.SelectedEntries(), std::vector<int>({1, 4}));
    EXPECT_EQ(view_.CurrentEntry(), 1);
}

// --- The tool window ---

TEST(PlaylistFormTest, TellsHowLongTheListPlays) {
    TPlayList list;
    TPlaylistForm form(list);
    const auto* totals = form.findChild<QLabel*>(u"playListTotals"_s);
    EXPECT_EQ(totals->text(), u"0 Songs, Spielzeit 0:00"_s);
    for (int i = 0; i < 3; ++i)
        list.Insert(0, {.Name = u"/x"_s, .Record = CdSong({}, 100)});
    EXPECT_EQ(totals->text(), u"3 Songs, Spielzeit 5:00"_s);
    list.Remove(0);
    EXPECT_EQ(totals->text(), u"2 Songs, Spielzeit 3:20"_s);
}

TEST(PlaylistFormTest, WhatIsDroppedAnywhereOnTheWindowComesIn) {
    TPlayList list;
    TPlaylistForm form(list);
    form.show();
    QString expected;
    for (QWidget* target : {form.View().viewport(), static_cast<QWidget*>(form.View().horizontalHeader()),
                            static_cast<QWidget*>(form.findChild<QLabel*>(u"playListTotals"_s)),
                            static_cast<QWidget*>(form.findChild<QToolButton*>(u"repeatAll"_s)),
                            form.findChild<QSpinBox*>(u"scanTime"_s)->findChild<QWidget*>()}) {
        const QString name = QString::number(list.Count());
        DropOn(*target, SongMimeData({{.Name = name}}), QPoint(2, 2));
        expected += name;
    }
    QString listed;
    for (int i = 0; i < list.Count(); ++i)
        listed += list.Entry(i).Name;
    EXPECT_EQ(listed, expected);
}

TEST(PlaylistFormTest, SetsHowTheListIsPlayedAndShowsWhatOthersHaveSet) {
    TPlayList list;
    ScriptedPlayer player;
    list.SetPlaySound(&player);
    TPlaylistForm form(list);
    form.show();
    auto* order = form.findChild<QComboBox*>(u"playOrder"_s);
    auto* time = form.findChild<QSpinBox*>(u"scanTime"_s);
    QTest::keyClick(order, Qt::Key_End);
    EXPECT_EQ(list.PlayOrder(), poStopAfterPlay);
    form.findChild<QToolButton*>(u"repeatAll"_s)->click();
    EXPECT_TRUE(list.RepeatAll());
    EXPECT_FALSE(time->isVisible());
    form.findChild<QToolButton*>(u"scan"_s)->click();
    EXPECT_TRUE(time->isVisible());
    time->setValue(15);
    EXPECT_EQ(player.AutoStop, 15'000);

    list.SetPlayOrder(poRandom);
    list.SetRepeatAll(false);
    EXPECT_EQ(order->currentText(), u"Zufällig"_s);
    EXPECT_FALSE(form.findChild<QToolButton*>(u"repeatAll"_s)->isChecked());
    list.SetPlaySound(nullptr);
}

}  // namespace
