#include "app/dialogs/TagsFromNamesDialog.h"

#include <gtest/gtest.h>

#include <QLineEdit>
#include <QPushButton>
#include <QTableView>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

TEST(TagsFromNamesDialog, ShowsWhatFieldsBecomeAndWhatIsInTheWay) {
    TMusicDatabase database;
    std::vector<SongHandle> songs;
    for (const QString& name : {u"Band - Eins"_s, u"Drei"_s}) {
        TID3Tag song;
        song.FileName = u"/m/2001/"_s + name + u".mp3"_s;
        song.Title = u"Zwei"_s;
        songs.push_back(database.Songs().HandleOf(database.AddEntry(song.FileName, song, AddAs::Returning)));
    }
    const auto shown = [&](const QString& pattern) {
        TagsFromNamesDialog dialog(database, songs, pattern);
        const auto* model = dialog.findChild<QTableView*>()->model();
        const auto* agree = dialog.findChild<QPushButton*>(u"agree"_s);
        QString text = agree->isEnabled() ? u"ja"_s : u"nein"_s;
        for (int cell = 0; cell < model->rowCount() * model->columnCount(); ++cell)
            text += u'|' +
                    model->index(cell / model->columnCount(), cell % model->columnCount()).data().toString();
        dialog.findChild<QLineEdit*>(u"pattern"_s)->setText(u"%TITLE%"_s);
        EXPECT_FALSE(agree->isEnabled()) << "for what is shown no longer";
        return text;
    };
    EXPECT_EQ(shown(u"%ARTIST% - %TITLE%"_s),
              u"ja|Band - Eins.mp3|Band|Eins||Drei.mp3|||Passt nicht zum Muster"_s);
    EXPECT_EQ(shown(u"%YEAR%/%TITLE%"_s),
              u"ja|2001/Band - Eins.mp3|2001|Band - Eins||2001/Drei.mp3|2001|Drei|"_s);
    EXPECT_EQ(shown(u"%ARTIST%%TITLE%"_s), u"nein"_s);
}
