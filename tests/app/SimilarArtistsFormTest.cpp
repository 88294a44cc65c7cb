#include "app/dialogs/SimilarArtistsForm.h"

#include <gtest/gtest.h>

#include <QLineEdit>
#include <QTableView>
#include <QTest>

#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

TEST(SimilarArtistsForm, AKeyDecidesAndRowsGoAndComeWithTheirArtists) {
    const SongFolder folder;
    ScriptedDialogs dialogs;
    TMusicDatabase database;
    database.SetModernTags(true);
    database.SetRenameAndMoveMP3s(false);
    database.SetSortType(stPath);
    for (const QString& name : {u"Beatles - 1.wav"_s, u"Meier - 2.wav"_s, u"Meyer - 3.wav"_s,
                                u"Quen - 4.wav"_s, u"Queen - 5.wav"_s, u"The Beatles - 6.wav"_s})
        database.AddSong(folder.Add(name, 1));
    bool stopped = false;
    SimilarArtistsForm form(database);
    form.SetPairs(FindSimilarArtists(database, stopped), stopped);
    auto& table = *form.findChild<QTableView*>(u"pairs"_s);
    const auto shown = [&table] {
        QStringList rows;
        for (int row = 0; row < table.model()->rowCount(); ++row)
            rows << table.model()->index(row, SimilarArtistsModel::FirstArtist).data().toString() + u'/' +
                        table.model()->index(row, SimilarArtistsModel::SecondArtist).data().toString();
        return rows;
    };
    ASSERT_EQ(shown(), (QStringList{u"Meier/Meyer"_s, u"Queen/Quen"_s, u"Beatles/The Beatles"_s}));
    QTest::keyClick(&table, Qt::Key_2);
    EXPECT_EQ(database.Song(1).Artist, u"Meyer"_s);
    EXPECT_EQ(ReadSong(database.Song(1).FileName, database.AudioReadOptions()).Tag.Artist, u"Meyer"_s);
    EXPECT_EQ(shown().size(), 2);
    QTest::keyClick(&table, Qt::Key_4);
    EXPECT_EQ(shown(), QStringList{u"Beatles/The Beatles"_s});
    EXPECT_EQ(database.Song(4).Artist, u"Quen"_s);

    dialogs.Inputs = {u" Die Beatles "_s};
    QTest::keyClick(&table, Qt::Key_3);
    EXPECT_EQ(database.Song(0).Artist, u"Die Beatles"_s);
    EXPECT_EQ(database.Song(5).Artist, u"Die Beatles"_s);
    EXPECT_TRUE(shown().isEmpty());
    QTest::keyClick(&table, Qt::Key_1);  // nothing to decide

    // Taken back elsewhere.
    TID3Tag song = database.Song(1);
    song.Artist = u"Meier"_s;
    database.UpdateEntry(1, song);
    QTest::qWait(0);
    EXPECT_EQ(shown(), QStringList{u"Meier/Meyer"_s});
    form.findChild<QLineEdit*>(u"filter"_s)->setText(u"beatles"_s);
    EXPECT_TRUE(shown().isEmpty());
}
