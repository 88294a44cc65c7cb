#include "app/MainWindow.h"

#include <gtest/gtest.h>

#include <QDockWidget>
#include <QDropEvent>
#include <QFile>
#include <QLabel>
#include <QLineEdit>
#include <QMimeData>
#include <QPushButton>
#include <QTableView>
#include <QTest>
#include <QTimer>
#include <QUrl>

#include "CommonRUKTools/CommandDispatcher.h"
#include "MusicManagment/database/Command.h"
#include "app/desktop/Installation.h"
#include "app/desktop/SingleInstance.h"
#include "app/dialogs/ProgressWindow.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/app/Menus.h"
#include "tests/app/ScriptedBackend.h"
#include "tests/database/RecordingTrash.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kYes = 0;
constexpr int kNo = 1;

const QString kStandardDatabase = u"data/Tunestead3_Database.tsdb"_s;

// Something may happen while a question stands.
struct BusyDialogs : ScriptedDialogs {
    std::function<void()> Meanwhile;
    int Ask(const Question& question) override {
        if (Meanwhile) std::exchange(Meanwhile, {})();
        return ScriptedDialogs::Ask(question);
    }
};

// A main window over a data folder of its own, and songs to take in.
class MainWindowTest : public testing::Test {
 protected:
    QString StandardDatabase() const { return folder_.Path(kStandardDatabase); }
    QString Music() const { return folder_.Path(u"Musik"_s); }

    void MakeSongs(int count, const QString& artist = u"Band"_s) const {
        for (int i = 0; i < count; ++i)
            folder_.Add(u"Musik/%1/%1 - Lied %2.wav"_s.arg(artist).arg(100 + i), 2);
    }

    void Start(const QStringList& arguments = {}, Installation* setup = nullptr) {
        window_.reset();  // only one at a time owns the data folder
        window_ = std::make_unique<TTunesteadMainWnd>(
            MainWindowOptions{.Files = {folder_.Path(u"data"_s)},
                              .SettingsFile = folder_.Path(u"settings.ini"_s),
                              .Arguments = arguments,
                              .Setup = setup,
                              .Engines = ScriptedEngines(song_)});
        window_->show();
        Work();
    }
    // Lets everything happen that is due, also what comes of it.
    static void Work() {
        for (int i = 0; i < 5; ++i)
            QApplication::processEvents();
    }
    void Drop(const QStringList& paths) {
        QMimeData data;
        QList<QUrl> urls;
        for (const QString& path : paths)
            urls << QUrl::fromLocalFile(path);
        data.setUrls(urls);
        QDragEnterEvent enter(QPoint(20, 20), Qt::CopyAction, &data, Qt::LeftButton, Qt::NoModifier);
        QApplication::sendEvent(window_.get(), &enter);
        EXPECT_TRUE(enter.isAccepted());
        QDropEvent drop(QPointF(20, 20), Qt::CopyAction, &data, Qt::LeftButton, Qt::NoModifier);
        QApplication::sendEvent(window_.get(), &drop);
    }
    // Runs as soon as the next long operation lets the interface work.
    void DuringRun(std::function<void()> action) {
        QTimer::singleShot(0, window_.get(), [this, action = std::move(action)] {
            EXPECT_TRUE(Database().ProgressRunning());
            action();
        });
    }

    TMusicDatabase& Database() { return window_->Database(); }
    // Depends on the fonts, and is all that fits on the screen with each of them.
    QSize SmallestSize() {
        window_->resize(1, 1);
        return window_->size();
    }
    template <typename T>
    T* Child(const QString& name) {
        return window_->findChild<T*>(name);
    }
    QString TitleAt(int row) { return List().model()->index(row, 0).data().toString(); }
    QTableView& List() { return *Child<QTableView>(u"songList"_s); }
    bool ShowsList() { return List().isVisible(); }
    bool ShowsEmptyState() { return Child<QWidget>(u"emptyState"_s)->isVisible(); }
    bool ShowsProgress() {
        const auto* progress = Child<QWidget>(u"progressWindow"_s);
        return progress != nullptr && progress->isVisible();
    }
    QAction* Command(const QString& caption) { return MenuItem(*window_, caption); }

    SongFolder folder_;
    BusyDialogs dialogs_;
    ScriptedSong song_;
    std::unique_ptr<TTunesteadMainWnd> window_;
};

TEST_F(MainWindowTest, StartsEmptyAndLeavesNoFilesBehind) {
    Start();
    EXPECT_TRUE(ShowsEmptyState());
    EXPECT_FALSE(ShowsList());
    EXPECT_EQ(window_->windowTitle(), u"Tunestead v6.0"_s);
    EXPECT_EQ(Child<QLabel>(u"summary"_s)->text(), u"0 Songs, Spielzeit 0:00"_s);
    EXPECT_TRUE(window_->close());
    EXPECT_FALSE(QFile::exists(StandardDatabase()));
    EXPECT_TRUE(dialogs_.Messages.isEmpty() && dialogs_.Questions.isEmpty());
}

TEST_F(MainWindowTest, ADroppedFolderIsTakenInAndThereAtTheNextStart) {
    MakeSongs(12);
    Start();
    Drop({Music()});
    Work();
    EXPECT_TRUE(ShowsList());
    EXPECT_EQ(List().model()->rowCount(), 12);
    EXPECT_EQ(Child<QLabel>(u"summary"_s)->text(), u"12 Songs, Spielzeit 0:24"_s);
    EXPECT_TRUE(window_->close());

    Start();
    EXPECT_TRUE(ShowsList());
    EXPECT_EQ(Database().Count(), 12);
    EXPECT_EQ(Database().Song(0).Title, u"Lied 100"_s);
}

TEST_F(MainWindowTest, ADatabaseOnTheCommandLineIsLoadedWhenTheUserAgrees) {
    MakeSongs(2);
    const QString other = folder_.Path(u"andere.TSDB"_s);
    Start({Music()});
    ASSERT_TRUE(Database().SaveDatabase(other, true));
    Database().Clear(true, true);
    ASSERT_TRUE(Database().SaveDatabase());

    Start({other});
    EXPECT_EQ(dialogs_.Questions, QStringList{u"Soll diese Datenbank nun geladen werden:\r\n"_s + other});
    EXPECT_EQ(Database().Count(), 0);
    dialogs_.Answers = {kYes};
    Start({other});
    EXPECT_EQ(Database().Count(), 2);
    EXPECT_EQ(Database().FileName(), other);
}

TEST_F(MainWindowTest, CommandsAndDropsRestWhileARunGoesAndTheStopButtonEndsIt) {
    MakeSongs(60);
    Start();
    Drop({Music()});
    DuringRun([this] {
        EXPECT_TRUE(ShowsProgress());
        EXPECT_FALSE(Command(u"Neue Datenbank"_s)->isEnabled());
        EXPECT_TRUE(Command(u"Beenden"_s)->isEnabled());
        EXPECT_TRUE(window_->windowTitle().startsWith(u"Tunestead v6.0 - "_s));
        Drop({Music()});
        Child<QPushButton>(u"stop"_s)->click();
    });
    Work();
    EXPECT_LT(Database().Count(), 60);
    EXPECT_EQ(dialogs_.Messages,
              QStringList{u"Hinzufügen von Songs zur Datenbank ist momentan nicht möglich."_s});
    EXPECT_FALSE(ShowsProgress());
    EXPECT_TRUE(Command(u"Neue Datenbank"_s)->isEnabled());
    EXPECT_EQ(window_->windowTitle(), u"Tunestead v6.0"_s);
}

TEST_F(MainWindowTest, ClosingDuringARunAsksAndNeverCloses) {
    MakeSongs(60);
    for (const int answer : {kNo, kYes}) {
        Start();
        Database().Clear(true, true);
        dialogs_.Questions.clear();
        dialogs_.Answers = {answer};
        Drop({Music()});
        DuringRun([this] { EXPECT_FALSE(window_->close()); });
        Work();
        EXPECT_TRUE(dialogs_.Questions.value(0).startsWith(u"Es wird noch eine Aktion ausgeführt."_s));
        EXPECT_TRUE(window_->isVisible());
        EXPECT_EQ(Database().Count() == 60, answer == kNo);
    }
}

TEST_F(MainWindowTest, TheSystemEndsTheProgramAlsoDuringARunAndNothingIsLost) {
    MakeSongs(60);
    Start();
    Drop({Music()});
    DuringRun([this] { window_->End(); });
    Work();
    EXPECT_FALSE(window_->isVisible());
    EXPECT_TRUE(dialogs_.Questions.isEmpty());
    const int taken = Database().Count();
    EXPECT_LT(taken, 60);
    Start();
    EXPECT_EQ(Database().Count(), taken);
}

TEST_F(MainWindowTest, ADamagedStandardDatabaseIsOnlyGivenUpWhenTheUserAgrees) {
    folder_.Put(kStandardDatabase, "TSDB By");
    const QByteArray before = folder_.Get(kStandardDatabase);
    dialogs_.Answers = {kNo};
    Start();
    EXPECT_EQ(dialogs_.Messages, QStringList{u"Dies ist keine gültige Datenbank."_s});
    EXPECT_TRUE(
        dialogs_.Questions.value(0).startsWith(u"Die Standard-Datenbank wurde nicht komplett importiert."_s));
    EXPECT_FALSE(window_->isVisible());
    EXPECT_EQ(folder_.Get(kStandardDatabase), before);

    MakeSongs(1);
    dialogs_.Answers = {kYes};
    Start({Music()});
    EXPECT_TRUE(window_->isVisible());
    EXPECT_TRUE(window_->close());
    EXPECT_NE(folder_.Get(kStandardDatabase), before);
}

TEST_F(MainWindowTest, AnotherDatabasesChangesAreOnlyLostWhenTheUserSaysSo) {
    MakeSongs(3);
    Start();
    Command(u"Neue Datenbank"_s)->trigger();
    Drop({Music()});
    Work();
    dialogs_.Answers = {2};
    EXPECT_FALSE(window_->close());
    dialogs_.Answers = {kYes};  // and the dialog for its name is cancelled
    EXPECT_FALSE(window_->close());
    EXPECT_EQ(Database().Count(), 3);

    const QString file = folder_.Path(u"neu.tsdb"_s);
    dialogs_.Files = {{file}, {file}};
    dialogs_.Answers = {kYes};
    Command(u"Neue Datenbank"_s)->trigger();
    EXPECT_EQ(Database().Count(), 0);
    EXPECT_TRUE(QFile::exists(file));
    EXPECT_TRUE(ShowsEmptyState());

    Command(u"Datenbank öffnen..."_s)->trigger();
    EXPECT_EQ(Database().Count(), 3);
    Database().RemoveEntry(0);
    dialogs_.Answers = {kNo};
    EXPECT_TRUE(window_->close());
    EXPECT_FALSE(QFile::exists(StandardDatabase()));
}

TEST_F(MainWindowTest, TheMenuFollowsADatabaseThatBecomesReadOnly) {
    Start();
    Command(u"Alben auflisten"_s)->trigger();
    const auto menus = window_->menuBar()->actions().size();
    Database().SetReadOnly(true);
    EXPECT_EQ(window_->menuBar()->actions().size(), menus - 2);
    EXPECT_EQ(Command(u"Neue Datenbank"_s), nullptr);
    EXPECT_NE(Command(u"Beenden"_s), nullptr);
    EXPECT_NE(Command(u"Einstellungen..."_s), nullptr);
    EXPECT_TRUE(Command(u"Alben auflisten"_s)->isChecked());
    Database().SetReadOnly(false);
    EXPECT_EQ(window_->menuBar()->actions().size(), menus);
}

TEST_F(MainWindowTest, TheWindowAndItsDocksKeepTheirSizesBetweenTwoStarts) {
    Start();
    Child<QDockWidget>(u"PlaylistForm"_s)->hide();
    auto* overview = Child<QDockWidget>(u"OverviewForm"_s);
    const int usualWidth = overview->width();
    window_->resizeDocks({overview}, {usualWidth + 30}, Qt::Horizontal);
    Work();
    const int width = overview->width();
    EXPECT_GT(width, usualWidth);
    window_->close();
    Start();
    EXPECT_EQ(Child<QDockWidget>(u"OverviewForm"_s)->width(), width);

    const int usualHeight = window_->height();
    SmallestSize();
    window_->close();
    Start();
    const QSize size = window_->size();
    EXPECT_LT(size.height(), usualHeight);
    window_->close();
    Start();
    EXPECT_EQ(window_->size(), size);
}

TEST_F(MainWindowTest, FindsSongsFromTheFilterLineAndGoesOn) {
    MakeSongs(12);
    Start({Music()});
    QTest::keyClicks(Child<QLineEdit>(u"filterEdit"_s), u"lied 11"_s);
    QTest::keyClick(Child<QLineEdit>(u"filterEdit"_s), Qt::Key_Escape);
    QSet<QString> found;
    for (int i = 0; i < 3; ++i) {
        Database().ClickMenuItem(mcFindNext);
        found << TitleAt(List().currentIndex().row());
    }
    EXPECT_EQ(found, QSet<QString>({u"Lied 110"_s, u"Lied 111"_s}));
}

// A play that is counted while the question stands moves the song.
TEST_F(MainWindowTest, TheSongThatWasAskedAboutIsRemovedAndUndoBringsItBack) {
    MakeSongs(4);
    Start({Music()});
    Database().SetSortType(stPlayCnt);
    Work();
    List().setCurrentIndex(List().model()->index(1, 0));
    const QString chosen = TitleAt(1);
    const QString next = TitleAt(2);
    dialogs_.Meanwhile = [this] {
        TID3Tag played = Database().Song(1);
        played.PlayCount += 5;
        EXPECT_NE(Database().UpdateEntry(1, played), 1);
    };
    dialogs_.Answers = {kYes};
    Database().ClickMenuItem(mcRemoveFromDatabase);
    EXPECT_EQ(Database().Count(), 3);
    EXPECT_EQ(TitleAt(List().currentIndex().row()), next);

    QAction* undo = Command(u"Rückgängig: 1 Song entfernen"_s);
    ASSERT_NE(undo, nullptr);
    undo->trigger();
    EXPECT_EQ(List().selectionModel()->selectedRows().size(), 1);
    EXPECT_EQ(TitleAt(List().currentIndex().row()), chosen);
    EXPECT_FALSE(undo->isEnabled());

    dialogs_.Answers = {kYes};
    Database().ClickMenuItem(mcRemoveFromDatabase);
    EXPECT_TRUE(undo->isEnabled());
    Command(u"Neue Datenbank"_s)->trigger();  // has nothing to take back, but the other one has
    EXPECT_EQ(undo->text(), u"&Rückgängig: 1 Song entfernen (in Tunestead3_Database.tsdb)"_s);
    undo->trigger();
    EXPECT_EQ(Database().Count(), 0);
    dialogs_.Answers = {kYes};
    undo->trigger();
    EXPECT_EQ(Database().FileName(), StandardDatabase());
    EXPECT_EQ(Database().Count(), 4);
}

TEST_F(MainWindowTest, TheFileOfTheBanListFollowsEachBanAndItsUndoAtOnce) {
    const RecordingTrash trash;
    MakeSongs(3);
    Start({Music()});
    int told = 0;
    const Subscription watching = Database().Events().BannListChanged.Subscribe([&] { ++told; });
    List().selectAll();
    dialogs_.Answers = {kYes};
    Database().ClickMenuItem(mcBan);
    EXPECT_EQ(Database().Count(), 0);
    EXPECT_EQ(folder_.Get(u"data/Tunestead3_BannList.str"_s).count("\r\n"), 3);
    EXPECT_EQ(told, 1);
    Command(u"Rückgängig: 3 Songs verbannen"_s)->trigger();
    EXPECT_EQ(Database().Count(), 3);
    EXPECT_EQ(folder_.Get(u"data/Tunestead3_BannList.str"_s), QByteArray());
    EXPECT_EQ(told, 2);
}

TEST_F(MainWindowTest, WhatACommandOrAnEventHandlerThrowsIsTold) {
    Start();
    const auto fails = [] { throw ERukException(u"kaputt"_s); };
    const Subscription handler = Database().Commands().Handle(mcSearchNew, {.Run = fails});
    Command(u"Nach neuen Songs suchen"_s)->trigger();
    QTimer::singleShot(0, window_.get(), fails);
    Work();
    EXPECT_EQ(dialogs_.Messages, QStringList({u"kaputt"_s, u"kaputt"_s}));
}

TEST_F(MainWindowTest, AnArrangementOfTheWindowsIsSavedAndComesBack) {
    Start();
    auto* overview = window_->findChildren<QDockWidget*>().first();
    const QSize arranged = SmallestSize();
    const QSize larger = arranged + QSize(20, 30);
    ASSERT_TRUE(overview->isVisible());
    const QString file = folder_.Path(u"meine.DF"_s);
    dialogs_.Files = {{file}, {file}};
    Command(u"Anordnung speichern unter..."_s)->trigger();
    overview->hide();
    window_->resize(larger);
    Command(u"Anordnung laden..."_s)->trigger();
    EXPECT_EQ(window_->size(), arranged);
    EXPECT_TRUE(overview->isVisible());
    EXPECT_TRUE(dialogs_.Messages.isEmpty());

    // What the file says of the docks is damaged: nothing changes.
    const QString damaged = folder_.Put(
        u"kaputt.df"_s,
        "[Tunestead Desktop]\nVersion=1\nMainForm=AAAA\nMainFormState=AAAA\nSongListColumns=AAAA\n");
    window_->resize(larger);
    window_->TakeOver({{damaged}, {}});
    EXPECT_TRUE(QTest::qWaitFor([this] { return !dialogs_.Messages.isEmpty(); }));
    EXPECT_EQ(window_->size(), larger);
    EXPECT_TRUE(overview->isVisible());
}

TEST_F(MainWindowTest, ALaterStartBringsItsFilesAndIsNotTakenByAClosedWindow) {
    MakeSongs(60);
    Start({Music()});
    MakeSongs(2, u"Neue"_s);
    window_->showMinimized();
    EXPECT_TRUE(window_->TakeOver({{Music() + u"/Neue"_s}, {}}));
    EXPECT_FALSE(window_->isMinimized());
    EXPECT_TRUE(QTest::qWaitFor([this] { return Database().Count() == 62; }));
    window_->close();
    EXPECT_FALSE(window_->TakeOver({}));
}

TEST_F(MainWindowTest, WhatWasRemovedWithTheProgramDoesNotComeBack) {
    MakeSongs(2);
    Installation installation({u"/opt/tunestead"_s, folder_.Path(u"xdg"_s), folder_.Path(u"xdg"_s)},
                              [](const QString&, const QStringList&) { return QString(); });
    RecordingTrash trash;
    trash.Removes = true;
    Start({Music()});
    Database().BannList().Insert(u"A - 1"_s);
    window_->close();
    ASSERT_TRUE(QFile::exists(StandardDatabase()) && QFile::exists(folder_.Path(u"settings.ini"_s)));

    dialogs_.Answers = {kYes, kYes, kYes, kYes};
    Start({u"-uninstall"_s}, &installation);
    EXPECT_FALSE(window_->isVisible());
    EXPECT_EQ(dialogs_.Questions.size(), 4);
    EXPECT_FALSE(QFile::exists(StandardDatabase()) ||
                 QFile::exists(folder_.Path(u"data/Tunestead3_BannList.str"_s)) ||
                 QFile::exists(folder_.Path(u"settings.ini"_s)));
}

TEST_F(MainWindowTest, EveryMenuItemHasALetterAndKeysOfItsOwn) {
    Start();
    QStringList keys;
    for (const auto* menu : window_->menuBar()->findChildren<QMenu*>()) {
        QStringList letters;
        for (const QAction* action : menu->actions()) {
            if (action->isSeparator()) continue;
            const qsizetype mark = action->text().indexOf(u'&');
            EXPECT_GE(mark, 0) << action->text().toStdString();
            letters << action->text().mid(mark + 1, 1).toLower();
            if (!action->shortcut().isEmpty() && action->shortcutContext() == Qt::WindowShortcut)
                keys << action->shortcut().toString();
        }
        EXPECT_EQ(letters.removeDuplicates(), 0) << menu->title().toStdString();
    }
    EXPECT_EQ(keys.removeDuplicates(), 0);
    QTest::keyClick(window_.get(), Qt::Key_Q, Qt::ControlModifier);
    EXPECT_FALSE(window_->isVisible());
}

}  // namespace
