#include "MusicManagment/database/batches/Corrections.h"

#include <gtest/gtest.h>

#include <QFile>

#include "tests/ErrorOf.h"
#include "tests/PrintQt.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

QString CorrectedOf(const Corrections& corrections, const QString& artist, const QString& title) {
    TID3Tag song;
    song.Artist = artist;
    song.Title = title;
    const auto corrected = corrections.Corrected(song);
    return corrected ? corrected->Artist + u'|' + corrected->Title : u"(stays)"_s;
}

TEST(Corrections, WholeTextsAreReplacedAndTheirCorrectionsToo) {
    const auto corrections = Corrections::FromText(
        u"# mine\r\n[Artist]\r\nBeatels = Beatles\r\nBeatles = The Beatles\r\nabba = ABBA\r\n"
        "[titel]\n Yesterdey = Yesterday\n"_s);
    EXPECT_EQ(CorrectedOf(corrections, u"BEATELS"_s, u"yesterdey "_s), u"The Beatles|Yesterday"_s);
    EXPECT_EQ(CorrectedOf(corrections, u"Abba"_s, u"Beatels"_s), u"ABBA|Beatels"_s);
    for (const QString& artist : {u"The Beatles"_s, u"ABBA"_s, u"Beatels and more"_s, QString()})
        EXPECT_EQ(CorrectedOf(corrections, artist, artist), u"(stays)"_s) << artist.toStdString();
}

TEST(Corrections, AFaultIsToldWithItsLine) {
    const std::pair<QString, QString> cases[] = {
        {u"a = b"_s, u"Zeile 1: Davor fehlt eine Zeile [Artist] oder [Titel]."_s},
        {u"[Album]\na = b"_s, u"Zeile 1: Davor fehlt eine Zeile [Artist] oder [Titel]."_s},
        {u"[Artist]\n\na=b"_s, u"Zeile 3: Erwartet wird \"falsch = richtig\"."_s},
        {u"[Artist]\na = "_s, u"Zeile 2: Erwartet wird \"falsch = richtig\"."_s},
        {u"[Artist]\na = b = c"_s, u"Zeile 2: Erwartet wird \"falsch = richtig\"."_s},
        {u"[Artist]\na = b\n[Titel]\na = b\n[Artist]\nA = c"_s,
         u"Zeile 6: Für diesen Text steht schon in Zeile 2 eine Korrektur."_s},
        {u"[Titel]\na = a2\na2 = a"_s, u"Zeile 2: Diese Korrektur führt im Kreis"_s},
    };
    for (const auto& [file, fault] : cases) {
        const QString told = ErrorOf([&] { Corrections::FromText(file); });
        EXPECT_TRUE(told.contains(fault)) << told.toStdString();
    }
}

TEST(Corrections, WhatIsPlannedIsWhatChanges) {
    const SongFolder folder;
    TMusicDatabase database;
    database.SetModernTags(true);
    database.SetRenameAndMoveMP3s(false);
    for (const QString& name : {u"Beatels - Eins.wav"_s, u"Queen - Zwei.wav"_s})
        database.AddSong(folder.Add(name, 1));
    QFile file(folder.Path(u"meine.korrektur"_s));
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    file.write("[Artist]\nBeatels = Beatles\n");
    file.close();
    const Corrections corrections = ReadCorrections(file.fileName());
    const auto planned = PlanCorrections(database, AllSongs(database), corrections);
    ASSERT_EQ(planned.size(), 1U);
    const SongHandle song = planned.front().Song;
    EXPECT_EQ(ApplyCorrections(database, AllSongs(database), corrections).Changed, 1);
    const TID3Tag& record = *database.Songs().Find(song);
    EXPECT_EQ(record.Artist, u"Beatles"_s);
    EXPECT_EQ(ReadSong(record.FileName, database.AudioReadOptions()).Tag.Artist, u"Beatles"_s);
    EXPECT_TRUE(PlanCorrections(database, AllSongs(database), corrections).empty());
    EXPECT_TRUE(ErrorOf([&] { ReadCorrections(folder.Path(u"fehlt"_s)); }).contains(u"fehlt"_s));
}

}  // namespace
