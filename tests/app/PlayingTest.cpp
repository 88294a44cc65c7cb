#include "app/Playing.h"

#include <gtest/gtest.h>

#include <QTest>

#include "CommonRUKTools/CommandDispatcher.h"
#include "CommonRUKTools/CommandRunner.h"
#include "MusicManagment/database/Command.h"
#include "MusicManagment/playback/PlaySoundMenu.h"
#include "app/MainMenu.h"
#include "app/models/FilteredSongs.h"
#include "app/views/PlaylistForm.h"
#include "app/views/SongListWidget.h"
#include "app/views/VisPlayList.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/app/Menus.h"
#include "tests/app/ScriptedBackend.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

// A window with five songs "0" to "4" in its list and a player that makes no sound.
class PlayingTest : public testing::Test {
 protected:
    PlayingTest() {
        database_.SetSortType(stTitle);
        for (int i = 0; i < 5; ++i)
            AddFile(i);
        model_.SyncViews();
        songs_ = new SongListWidget(shown_, database_, &window_);
        window_.setCentralWidget(songs_);
        Start();
    }
    ~PlayingTest() override { playing_.reset(); }

    QString Path(int number) const { return folder_.Path(u"%1.mp3"_s.arg(number)); }
    void AddFile(int number) {
        TID3Tag song;
        song.FileName = folder_.Add(u"%1.mp3"_s.arg(number));
        song.Title = QString::number(number);
        song.Length = 60;
        database_.AddEntry(QString(), song);
    }
    void Start() {
        menu_ = std::make_unique<MainMenu>(*window_.menuBar(), database_.Commands());
        menu_->BindTo(*songs_);
        playing_ = std::make_unique<Playing>(window_, database_, *songs_,
                                             PlayingOptions{StandardList(), ScriptedEngines(song_), {}});
        playing_->AddMenusTo(*window_.menuBar());
        playing_->OnDone = [this](const QString& sentence) { told_ = sentence; };
        window_.resize(1000, 600);
        window_.show();
        window_.activateWindow();
        QApplication::processEvents();
    }
    QString StandardList() const { return folder_.Path(u"liste.rukpl"_s); }
    void Mark(const QList<int>& rows, int focus) {
        songs_->selectionModel()->clear();
        for (const int row : rows)
            songs_->selectionModel()->select(shown_.index(row, 0),
                                             QItemSelectionModel::Select | QItemSelectionModel::Rows);
        songs_->selectionModel()->setCurrentIndex(shown_.index(focus, 0), QItemSelectionModel::NoUpdate);
    }
    QString Listed() {
        QString listed;
        for (int i = 0; i < playing_->PlayList().Count(); ++i)
            listed += QFileInfo(playing_->PlayList().Entry(i).Name).completeBaseName();
        return listed;
    }
    TVisPlayList& View() { return window_.findChild<TPlaylistForm*>()->View(); }
    QString Sounding() const { return QFileInfo(song_.File).completeBaseName(); }
    void Choose(const QString& caption) {
        QAction* item = MenuItem(window_, caption, u"Player"_s);
        ASSERT_NE(item, nullptr);
        item->trigger();
    }

    SongFolder folder_;
    ScriptedDialogs dialogs_;
    ScriptedSong song_;
    TMusicDatabase database_;
    SongListModel model_{database_};
    FilteredSongs shown_{model_};
    QMainWindow window_;
    SongListWidget* songs_ = nullptr;
    std::unique_ptr<MainMenu> menu_;
    std::unique_ptr<Playing> playing_;
    QString told_;
};

TEST_F(PlayingTest, ReturnAppendsTheMarkedSongsAndPlaysTheFocusedOne) {
    Mark({1, 2, 4}, 2);
    songs_->setFocus();
    QTest::keyClick(songs_, Qt::Key_Return);
    EXPECT_EQ(Listed(), u"124"_s);
    EXPECT_EQ(Sounding(), u"2"_s);
    EXPECT_EQ(song_.Status, psPlaying);

    const QPoint last = songs_->visualRect(shown_.index(4, 0)).center();
    QTest::mouseClick(songs_->viewport(), Qt::LeftButton, {}, last);
    QTest::mouseDClick(songs_->viewport(), Qt::LeftButton, {}, last);
    EXPECT_EQ(Listed(), u"124"_s);
    EXPECT_EQ(Sounding(), u"4"_s);
}

TEST_F(PlayingTest, DoubleClickPlaysTheSongAndWhatFollowsInTheShownList) {
    const auto doubleClick = [this](int row) {
        const QPoint place = songs_->visualRect(shown_.index(row, 0)).center();
        QTest::mouseClick(songs_->viewport(), Qt::LeftButton, {}, place);
        QTest::mouseDClick(songs_->viewport(), Qt::LeftButton, {}, place);
    };
    const auto isBold = [this](int row) {
        return shown_.index(row, 0).data(Qt::FontRole).value<QFont>().bold();
    };
    Mark({0}, 0);
    database_.ClickMenuItem(mcAddToPlayList);
    doubleClick(2);
    EXPECT_EQ(Sounding(), u"2"_s);
    EXPECT_TRUE(isBold(2));
    for (const QString& next : {u"3"_s, u"4"_s}) {
        Choose(u"Nächstes"_s);
        EXPECT_EQ(Sounding(), next);
    }
    EXPECT_FALSE(isBold(2));
    EXPECT_EQ(Listed(), u"0234"_s);  // one by one, each when the one before it began

    doubleClick(1);    // what is listed already waits where it stands
    View().OnPlay(0);  // another choice ends that
    EXPECT_EQ(playing_->PlayList().Queue(), QStringList());
}

TEST_F(PlayingTest, AddingLeavesOutWhatIsListed) {
    Mark({0, 3}, 0);
    database_.ClickMenuItem(mcAddToPlayList);
    EXPECT_EQ(told_, u"2 Songs zur PlayList hinzugefügt."_s);
    Mark({0, 1, 3}, 0);
    database_.ClickMenuItem(mcAddToPlayList);
    EXPECT_EQ(told_, u"1 Song zur PlayList hinzugefügt, 2 waren schon darin."_s);
    EXPECT_EQ(Listed(), u"031"_s);
    EXPECT_EQ(song_.Status, psClosed);
}

TEST_F(PlayingTest, DelWorksInTheListThatHasTheFocus) {
    Mark({0, 1, 2}, 0);
    database_.ClickMenuItem(mcAddToPlayList);
    View().setFocus();
    View().selectRow(1);
    QTest::keyClick(&View(), Qt::Key_Delete);
    EXPECT_EQ(Listed(), u"02"_s);
    EXPECT_TRUE(dialogs_.Questions.isEmpty());

    songs_->setFocus();
    int removals = 0;
    const Subscription shell =
        database_.Commands().Handle(mcRemoveFromDatabase, {.Run = [&removals] { ++removals; }});
    QTest::keyClick(songs_, Qt::Key_Delete);
    EXPECT_EQ(removals, 1);
    EXPECT_EQ(Listed(), u"02"_s);
}

TEST_F(PlayingTest, PlayWithoutASongBeginsWithTheList) {
    Choose(u"Play"_s);
    EXPECT_EQ(dialogs_.Messages, QStringList(u"Keine Lieder in der PlayList zum Abspielen"_s));
    Mark({1, 2}, 1);
    database_.ClickMenuItem(mcAddToPlayList);
    Choose(u"Play"_s);
    EXPECT_EQ(Sounding(), u"1"_s);
    Choose(u"Nächstes"_s);
    EXPECT_EQ(Sounding(), u"2"_s);
    Choose(u"Vorheriges"_s);
    EXPECT_EQ(Sounding(), u"1"_s);
}

TEST_F(PlayingTest, ASongThatIsGoneIsToldAndTheOtherPlaysOn) {
    Mark({0, 1}, 0);
    database_.ClickMenuItem(mcPlay);
    QFile::remove(Path(1));
    View().OnPlay(1);
    EXPECT_EQ(dialogs_.Messages, QStringList(u"Die Datei ist nicht verfügbar: "_s + Path(1)));
    // Of one whose medium the user does not want to look for he need not be told with a window.
    playing_->PlayList().Insert(2, {.Name = u":00000001:\\a.mp3"_s});
    database_.SetCDNames({{u"Urlaub"_s, 1}});
    View().OnPlay(2);
    EXPECT_EQ(dialogs_.Prompts.size(), 1);
    EXPECT_EQ(dialogs_.Messages.size(), 1);
    EXPECT_EQ(told_, u"Der Datenträger ist nicht eingelegt: [Urlaub] \\a.mp3"_s);
    playing_->PlayList().Insert(3, {.Name = u":00000001:\\b.mp3"_s});
    playing_->PlayList().PlayNext();
    EXPECT_EQ(dialogs_.Prompts.size(), 2);  // once a search, not once a song
    EXPECT_EQ(Sounding(), u"0"_s);
    EXPECT_EQ(song_.Status, psPlaying);
}

TEST_F(PlayingTest, TheSongThatPlaysIsFoundInTheCollection) {
    Mark({3}, 3);
    database_.ClickMenuItem(mcPlay);
    Mark({0}, 0);
    Choose(u"Aktuelles Lied markieren"_s);
    EXPECT_EQ(database_.Song(songs_->FocusedSong()).Title, u"3"_s);
    EXPECT_EQ(songs_->MarkedSongs(), std::vector<SongIndex>({songs_->FocusedSong()}));
    shown_.SetText(u"titel:0"_s);
    Choose(u"Aktuelles Lied markieren"_s);
    EXPECT_EQ(told_, u"Der Filter zeigt dieses Lied nicht."_s);
}

TEST_F(PlayingTest, TheListIsThereAgainAtTheNextStart) {
    RunCommand([this] { playing_->OpenStandardList(); });
    playing_->Close(true);
    EXPECT_FALSE(QFile::exists(StandardList()));
    Mark({3, 4}, 3);
    database_.ClickMenuItem(mcPlay);
    playing_->Close(true);
    EXPECT_EQ(song_.Status, psClosed);

    playing_.reset();
    Start();
    RunCommand([this] { playing_->OpenStandardList(); });
    EXPECT_EQ(Listed(), u"34"_s);
    EXPECT_TRUE(dialogs_.Messages.isEmpty());
}

TEST_F(PlayingTest, AListThatCannotBeReadIsNotLost) {
    folder_.Put(u"liste.rukpl"_s, "RUKPLYLST??");
    RunCommand([this] { playing_->OpenStandardList(); });
    EXPECT_EQ(dialogs_.Messages.size(), 1);
    playing_->Close(true);
    EXPECT_EQ(folder_.Get(u"liste.rukpl"_s), "RUKPLYLST??");
}

TEST_F(PlayingTest, FilesFromTheCommandLinePlayOrBecomeTheList) {
    playing_->OpenSong(Path(4));
    EXPECT_EQ(Sounding(), u"4"_s);
    EXPECT_EQ(Listed(), QString());
    Mark({0, 2}, 0);
    database_.ClickMenuItem(mcAddToPlayList);
    const QString other = folder_.Path(u"andere.m3u"_s);
    playing_->PlayList().Save(other);
    playing_->OpenPlayList(QString());
    playing_->OpenPlayList(other);
    EXPECT_EQ(Listed(), u"02"_s);
    EXPECT_EQ(song_.Status, psPlaying);
}

TEST_F(PlayingTest, AnotherProgramOpensFoldersAndLists) {
    folder_.Add({u"album/x.wav"_s, u"album/y.wav"_s});
    playing_->PlayList().Insert(0, {.Name = Path(1)});
    playing_->OpenFile(folder_.Path(u"album"_s));
    EXPECT_EQ(Listed(), u"1xy"_s);
    EXPECT_EQ(Sounding(), u"x"_s);
    playing_->PlayList().Save(folder_.Path(u"saved.m3u"_s));
    playing_->PlayList().SetPlayListFileName({});
    const auto open = [this](const QString& name) { playing_->OpenFile(folder_.Path(name)); };
    open(u"saved.m3u"_s);
    EXPECT_EQ(Listed(), QString());  // it may have to ask, and whoever called does not wait for that
    EXPECT_THROW(open(u"saved.m3u"_s), EPlayListException);
    QApplication::processEvents();
    EXPECT_EQ(Listed(), u"1xy"_s);
    EXPECT_EQ(Sounding(), u"1"_s);
    folder_.Put(u"notes.txt"_s, QByteArray("x"));
    EXPECT_THROW(open(u"notes.txt"_s), EPlayListException);
    EXPECT_THROW(open(u"missing.wav"_s), EPlayListException);
    EXPECT_EQ(Sounding(), u"1"_s);
}

}  // namespace
