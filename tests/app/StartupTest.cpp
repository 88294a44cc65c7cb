#include "app/Startup.h"

#include <gtest/gtest.h>

#include <QDir>
#include <QFile>

#include "MusicManagment/database/MusicManagment.h"
#include "app/CollectionCommands.h"
#include "app/desktop/InstallationSteps.h"
#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/Builders.h"
#include "tests/ScriptedDialogs.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

// The program's start without its window.
class StartupTest : public testing::Test {
 protected:
    QString Make(const QString& name, const Bytes& contents = {}) const {
        return folder_.Put(name, ByteSpan(contents));
    }
    QString MakeSong(const QString& name) const { return Make(name, Mp3Builder().Frames(80).Data()); }
    QByteArray BannList() const { return folder_.Get(u"data/Tunestead3_BannList.str"_s); }
    StartupTest() {
        startup_.OpenStandardPlayList = [] {};
        startup_.OpenPlayList = [this](const QString& path) { opened_ << u"playlist "_s + path; };
        startup_.OpenSong = [this](const QString& path) { opened_ << u"song "_s + path; };
        startup_.OpenArrangement = [this](const QString& path) { opened_ << u"windows "_s + path; };
    }

    SongFolder folder_;
    StandardFiles files_{folder_.Path(u"data"_s)};
    ScriptedDialogs dialogs_;
    TMusicDatabase database_;
    CollectionCommands commands_{database_, files_};
    InstallationSteps installation_{nullptr, files_, folder_.Path(u"settings.ini"_s)};
    Startup startup_{database_, commands_, installation_};
    QStringList opened_;
};

TEST_F(StartupTest, EveryKindOfFileFindsItsPlaceInCapitalsToo) {
    ASSERT_TRUE(startup_.Run({}));
    for (const auto& [extension, kind] :
         {std::pair(u"M3u"_s, u"playlist "_s), std::pair(u"MPEG"_s, u"song "_s),
          std::pair(u"dF"_s, u"windows "_s)}) {
        const QString path = Make(u"datei."_s + extension);
        EXPECT_TRUE(startup_.ActOn({path}));
        EXPECT_EQ(std::exchange(opened_, {}), QStringList{kind + path});
    }
    EXPECT_TRUE(dialogs_.Messages.isEmpty());
    EXPECT_EQ(database_.Count(), 0);
}

TEST_F(StartupTest, OneSongIsPlayedAndTheOthersAreTakenIn) {
    const QString song = MakeSong(u"a.mp3"_s);
    const QString video = Make(u"film.mpg"_s);
    ASSERT_TRUE(startup_.Run({song, MakeSong(u"b.mp3"_s), QFileInfo(MakeSong(u"ordner/c.mp3"_s)).path(),
                              video, Make(u"brief.Txt"_s), Make(u"LIES"_s)}));
    EXPECT_EQ(opened_, QStringList{u"song "_s + song});
    EXPECT_EQ(database_.Count(), 2);
    EXPECT_EQ(dialogs_.Messages,
              QStringList({u"Diese Datei kann nicht in die Datenbank aufgenommen werden: "_s + video,
                           u"Unbekannter Dateityp: .Txt"_s, u"Unbekannter Dateityp: "_s}));
}

TEST_F(StartupTest, AFileThatFailsIsSaidAndTheNextIsOpened) {
    startup_.OpenPlayList = [](const QString&) { throw ERukException(u"kaputt"_s); };
    startup_.OpenStandardPlayList = [] { throw ERukException(u"auch kaputt"_s); };
    QDir().mkpath(files_.BannList());  // a folder in place of the file
    ASSERT_TRUE(startup_.Run({Make(u"a.rukpl"_s), QFileInfo(MakeSong(u"ordner/b.mp3"_s)).path()}));
    EXPECT_EQ(dialogs_.Messages.size(), 3);
    EXPECT_EQ(database_.Count(), 1);
}

TEST_F(StartupTest, TheBanListOutlivesTheProgram) {
    ASSERT_TRUE(startup_.Run({}));
    EXPECT_TRUE(commands_.MayClose());
    EXPECT_FALSE(QFile::exists(files_.BannList()));
    database_.BannList().Insert(u"Ä - 1"_s);
    EXPECT_TRUE(commands_.MayClose());
    EXPECT_EQ(BannList(), "Ä - 1\r\n");

    TMusicDatabase next;
    CollectionCommands commands(next, files_);
    Startup startup(next, commands, installation_);
    startup.OpenStandardPlayList = [] {};
    ASSERT_TRUE(startup.Run({}));
    EXPECT_TRUE(next.BannList().Contains(u"Ä - 1"));
    next.BannList().Clear();
    EXPECT_TRUE(commands.MayClose());
    EXPECT_EQ(BannList(), "");
}

TEST_F(StartupTest, ABanListThatWasNotReadIsNotOverwritten) {
    const Bytes entries = {'A', ' ', '-', ' ', '1'};
    Make(u"data/Tunestead3_BannList.str"_s, entries);
    Make(u"data/Tunestead3_Database.tsdb"_s, {'T', 'S', 'D', 'B'});
    dialogs_.Answers = {1};  // the start ends before the list is read
    EXPECT_FALSE(startup_.Run({}));
    EXPECT_TRUE(commands_.MayClose());
    EXPECT_EQ(BannList(), "A - 1");

    QFile::remove(files_.Database());
    QFile::rename(files_.BannList(), files_.BannList() + u".kept"_s);
    QDir().mkpath(files_.BannList());
    ASSERT_TRUE(startup_.Run({}));
    dialogs_.Questions.clear();
    EXPECT_TRUE(commands_.MayClose());
    EXPECT_TRUE(dialogs_.Questions.isEmpty());
    database_.BannList().Insert(u"B - 2"_s);
    EXPECT_FALSE(commands_.MayClose());
    EXPECT_TRUE(dialogs_.Questions.value(0).contains(u"Trotzdem beenden?"_s));
}

TEST_F(StartupTest, OnlyTheFirstArgumentAsksForInstallingOrRemoving) {
    for (const QString& step : {u"-install"_s, u"/INSTALL"_s, u"-Uninstall"_s, u"/uninstall"_s}) {
        dialogs_.Messages.clear();
        // Removing ends a program that was started for it, and one that runs only when something was removed.
        EXPECT_EQ(startup_.Run({step}), !step.contains(u"un"_s, Qt::CaseInsensitive));
        EXPECT_TRUE(startup_.ActOn({step}));
        EXPECT_EQ(dialogs_.Messages.size(), 2) << step.toStdString();
        EXPECT_TRUE(dialogs_.Messages.value(0).startsWith(u"Auf diesem System"_s));
    }
    dialogs_.Messages.clear();
    EXPECT_TRUE(startup_.Run({Make(u"a.df"_s), u"-uninstall"_s}));
    ASSERT_EQ(dialogs_.Messages.size(), 1);
    EXPECT_TRUE(dialogs_.Messages[0].startsWith(u"Datei nicht gefunden"_s));
}

}  // namespace
