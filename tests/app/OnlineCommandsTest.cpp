#include "app/OnlineCommands.h"

#include <gtest/gtest.h>

#include <QBuffer>
#include <QImage>
#include <QLabel>
#include <QLineEdit>
#include <QMainWindow>
#include <QPushButton>
#include <QTableView>
#include <QTemporaryDir>

#include "CommonRUKTools/CommandDispatcher.h"
#include "CommonRUKTools/RWReg.h"
#include "MusicManagment/database/Command.h"
#include "app/dialogs/OnlineSearchForm.h"
#include "app/views/TagForm.h"
#include "tests/HTTPRetrieval/LoopbackServer.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

QByteArray Picture() {
    QImage image(8, 8, QImage::Format_RGB32);
    image.fill(Qt::red);
    QByteArray bytes;
    QBuffer buffer(&bytes);
    image.save(&buffer, "PNG");
    return bytes;
}

class OnlineCommandsTest : public testing::Test {
 protected:
    OnlineCommandsTest() {
        database_.SetModernTags(true);
        database_.AddSong(folder_.Add(u"Band - Eins.wav"_s, 2));
        window_.addDockWidget(Qt::RightDockWidgetArea, &tags_);
        commands_.OnNeedChoice = [this] { tags_.ShowSongs(chosen_, TID3TagForm::ChosenBy::Program); };
        Use(ssMusicBrainz);
    }

    void Use(SearchService service, const QString& host = {}) {
        TRWReg settings(u"\\Test"_s, folder_.Path(u"settings.ini"_s));
        const OnlineServices services{service, host, server_.URL({}), server_.URL({})};
        SaveSettingsOf(services, OnlineSettings::kAll, settings);
        commands_.LoadSettings(settings);
    }
    OnlineSearchForm* Search(const QString& query) {
        dialogs_.Inputs = {query};
        EXPECT_TRUE(database_.ClickMenuItem(mcFindOnline));
        OnlineSearchForm* form = nullptr;
        const auto comes = [&] {
            form = window_.findChild<OnlineSearchForm*>();
            return (form != nullptr && !Count(*form).startsWith(u"0 ")) || !dialogs_.Messages.isEmpty();
        };
        EXPECT_TRUE(Comes(comes));
        return form;
    }
    static QString Count(const OnlineSearchForm& form) { return form.findChild<QLabel*>(u"count"_s)->text(); }
    QString Line(const QString& field) { return tags_.findChild<QLineEdit*>(field)->text(); }

    LoopbackServer<> server_{[](QTcpSocket& socket, const QByteArray& request) {
        if (request.startsWith("GET /ws/2/"))
            return SendAnswer(socket, R"({"recordings": [{"title": "Neu", "length": 2000,
                "artist-credit": [{"name": "Wir"}], "releases": [{"id": "r", "title": "Album",
                "date": "1999", "media": [{"track": [{"number": "300"}]}]}]}, {"title": "Anders"}]})");
        if (request.startsWith("GET /release/r/front-500 ")) return SendAnswer(socket, Picture());
        SendAnswer(socket, "<html>nothing</html>");
    }};
    SongFolder folder_;
    ScriptedDialogs dialogs_;
    TMusicDatabase database_;
    QMainWindow window_;
    TID3TagForm tags_{database_};
    std::vector<SongHandle> chosen_;
    OnlineCommands commands_{window_, database_, tags_};
};

TEST_F(OnlineCommandsTest, AHitAndItsCoverBecomeEditsThatAreNotApplied) {
    OnlineSearchForm* form = Search(u"neu"_s);
    ASSERT_NE(form, nullptr);
    EXPECT_EQ(form->windowTitle(), u"Such-Ergebnisse im Internet"_s);
    EXPECT_EQ(Count(*form), u"2 Treffer"_s);
    auto& take = *form->findChild<QPushButton*>(u"take"_s);
    auto& takeCover = *form->findChild<QPushButton*>(u"takeCover"_s);

    take.click();  // for which song?
    EXPECT_EQ(dialogs_.Messages,
              QStringList{u"Markieren Sie in der Liste zuerst den einen Song, um den es geht."_s});
    chosen_ = {database_.Songs().HandleOf(0)};
    take.click();
    EXPECT_EQ(Line(u"title"_s) + u'|' + Line(u"album"_s), u"Neu|Album"_s);
    auto& table = *form->findChild<QTableView*>(u"hits"_s);
    table.selectRow(1);
    take.click();  // nothing of the first hit is left beside it
    EXPECT_EQ(Line(u"title"_s) + u'|' + Line(u"album"_s), u"Anders|"_s);
    table.selectRow(0);
    take.click();
    EXPECT_EQ(database_.Song(0).Title, u"Eins"_s);

    takeCover.click();
    auto& state = *tags_.findChild<QLabel*>(u"coverState"_s);
    EXPECT_TRUE(Comes([&] { return state.text().startsWith(u"Neu: PNG, 8 × 8"); }))
        << state.text().toStdString();
    EXPECT_TRUE(tags_.Apply());
    const TID3Tag& song = database_.Song(0);
    EXPECT_EQ(song.Artist + u'|' + song.Title + u'|' + song.Album + u'|' + song.Year,
              u"Wir|Neu|Album|1999"_s);
    EXPECT_EQ(song.Track, 0);  // 300 is none that a record can hold
}

TEST_F(OnlineCommandsTest, AServiceIsNeededAndAFailureTold) {
    Use(ssPage);
    EXPECT_TRUE(database_.ClickMenuItem(mcFindOnline));
    ASSERT_EQ(dialogs_.Messages.size(), 1);
    EXPECT_TRUE(dialogs_.Messages.takeFirst().contains(u"Einstellungen"));
    EXPECT_TRUE(dialogs_.Prompts.isEmpty());

    Use(ssPage, server_.Host());
    const OnlineSearchForm* form = Search(u"x"_s);
    ASSERT_NE(form, nullptr);
    EXPECT_EQ(dialogs_.Prompts, QStringList{u"Suchen nach:"_s});
    EXPECT_EQ(Count(*form), u"Nichts gefunden."_s);
    const auto& table = *form->findChild<QTableView*>(u"hits"_s);
    EXPECT_TRUE(!table.isColumnHidden(1) && table.isColumnHidden(2));

    delete form;
    Use(ssPage, u"127.0.0.1:1"_s);
    EXPECT_EQ(Search(u"x"_s), nullptr);
    EXPECT_EQ(dialogs_.Messages, QStringList{u"Fehler beim Stellen einer Such-Anfrage im Internet"_s});
}

}  // namespace
