#include "app/dialogs/TagsFromNamesDialog.h"

#include <gtest/gtest.h>

#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTableView>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

TEST(TagsFromNamesDialog, ShowsWhatFieldsBecomeAndWhatIsInTheWay) {
    TMusicDatabase database;
    std::vector<SongHandle> songs;
    for (const QString& name : {u"Band - Eins"_s, u"Band - Zwei"_s, u"Drei"_s}) {
        TID3Tag song;
        song.FileName = u"/m/2001/"_s + name + u".mp3"_s;
        song.Artist = u"Band"_s;
        song.Title = u"Zwei"_s;
        songs.push_back(database.Songs().HandleOf(database.AddEntry(song.FileName, song, AddAs::Returning)));
    }
    // Row by row, then the summary, then whether the user can agree.
    const auto shown = [&](const QString& pattern) {
        TagsFromNamesDialog dialog(database, songs, pattern);
        const auto* model = dialog.findChild<QTableView*>()->model();
        QStringList lines;
        for (int row = 0; row < model->rowCount(); ++row) {
            lines << model->index(row, 0).data().toString();
            for (int column = 1; column < model->columnCount(); ++column)
                lines.back() += u'|' + model->index(row, column).data().toString();
        }
        lines << dialog.findChild<QLabel*>(u"summary"_s)->text();
        const auto* agree = dialog.findChild<QPushButton*>(u"agree"_s);
        lines << (agree->isEnabled() ? u"ja"_s : u"nein"_s);
        dialog.findChild<QLineEdit*>(u"pattern"_s)->setText(u"%TITLE%"_s);
        EXPECT_FALSE(agree->isEnabled()) << "for what is shown no longer";
        return lines;
    };
    EXPECT_EQ(shown(u"%ARTIST% - %TITLE%"_s),
              (QStringList{u"Band - Eins.mp3|Band|Eins|"_s, u"Band - Zwei.mp3|Band|Zwei|"_s,
                           u"Drei.mp3|||Der Name passt nicht zum Muster"_s,
                           u"1 Song von 3 Songs wird geändert. Bei 1 ist etwas im Weg."_s, u"ja"_s}));
    EXPECT_EQ(shown(u"%YEAR%/%TITLE%"_s).value(2), u"2001/Drei.mp3|2001|Drei|"_s);
    const QStringList ambiguous = shown(u"%ARTIST%%TITLE%"_s);
    EXPECT_TRUE(ambiguous.first().startsWith(u"Zwischen %ARTIST% und %TITLE% muss"_s));
    EXPECT_EQ(ambiguous.last(), u"nein"_s);
}
