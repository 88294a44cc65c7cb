#include <QtEndian>
#include <algorithm>
#include <cmath>

#include "tests/PrintQt.h"
#include "tests/cli/CommandRunner.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kRate = 44100;           // of the mix
constexpr qsizetype kWaveHeader = 44;  // bytes

class PlayTest : public CommandTest {
 protected:
    // A song that is one level (-1 to 1) from its beginning to its end, so that the mix tells who sounds how
    // loud.
    QString AddLevel(const QString& name, double level, quint32 seconds) {
        folder_.Add(name, seconds);
        QByteArray song = folder_.Get(name);
        std::fill(song.begin() + kWaveHeader, song.end(), static_cast<char>(std::lround(128 + level * 128)));
        return folder_.Put(name, song);
    }
    // Writes the mix, and keeps it.
    CommandResult WriteMix(const QStringList& words) {
        const CommandResult result = RunWords(
            QStringList{u"play"_s, u"--fast"_s, u"--output"_s, u"file:"_s + Path(u"mix.wav"_s)} + words);
        mix_ = folder_.Get(u"mix.wav"_s).mid(kWaveHeader);
        return result;
    }
    double Seconds() const { return static_cast<double>(mix_.size()) / (4 * kRate); }
    double LevelAt(double seconds) const {
        const auto at = static_cast<qsizetype>(seconds * kRate) * 4;
        return at + 2 <= mix_.size() ? qFromLittleEndian<qint16>(mix_.constData() + at) / 32767.0 : NAN;
    }

    QByteArray mix_;  // 16 bit, left and right in turn
};

TEST_F(PlayTest, SongsCrossInTheMix) {
    const QString a = AddLevel(u"a.wav"_s, 0.25, 12);
    const QString b = AddLevel(u"b.wav"_s, -0.5, 12);
    const CommandResult result = WriteMix({u"--crossfade"_s, u"4000"_s, a, b});
    EXPECT_EQ(result.Status, 0);
    EXPECT_EQ(result.Err, QString());
    EXPECT_EQ(result.Out, a + u'\n' + b + u'\n');
    EXPECT_NEAR(Seconds(), 20.5, 0.75);
    EXPECT_NEAR(LevelAt(6), 0.25, 0.01);
    EXPECT_NEAR(LevelAt(10.1), (0.25 - 0.5) / 2, 0.06);
    EXPECT_NEAR(LevelAt(15), -0.5, 0.01);
}

TEST_F(PlayTest, SongsFollowOneAnotherInTheOrderThatIsAskedFor) {
    const QString a = AddLevel(u"a.wav"_s, 0.25, 3);
    const QString b = AddLevel(u"b.wav"_s, -0.5, 3);
    const CommandResult result = WriteMix({u"--order"_s, u"up"_s, u"--mode=none"_s, a, b});
    EXPECT_EQ(result.Out, b + u'\n' + a + u'\n');
    EXPECT_NEAR(LevelAt(2), -0.5, 0.01);
    EXPECT_NEAR(LevelAt(5), 0.25, 0.01);
    EXPECT_NEAR(Seconds(), 6.75, 0.75);
}

TEST_F(PlayTest, WhatCannotBePlayedIsToldAndTheRestIsPlayed) {
    const QString a = AddLevel(u"a.wav"_s, 0.25, 2);
    Put(Path(u"bad.mp3"_s), AsBytes("no sound at all"));
    const QByteArray list = "#EXTM3U\r\n" + Path(u"gone.mp3"_s).toUtf8() + "\r\n";
    Put(Path(u"list.m3u"_s), AsBytes(list.constData()));
    const CommandResult result =
        WriteMix({Path(u"missing.mp3"_s), Path(u"bad.mp3"_s), Path(u"list.m3u"_s), a});
    EXPECT_EQ(result.Status, 1);
    EXPECT_EQ(result.Out, a + u'\n');
    EXPECT_TRUE(result.Err.contains(u"Die Datei ist nicht verfügbar: "_s + Path(u"gone.mp3"_s)));
    EXPECT_TRUE(result.Err.contains(u"Nichts zum Abspielen gefunden: "_s + Path(u"missing.mp3"_s)));
    EXPECT_TRUE(result.Err.contains(u"Fehler beim Öffnen der Datei "_s + Path(u"bad.mp3"_s)));
}

TEST_F(PlayTest, AFullDiskEndsThePlaying) {
    if (!QFile::exists(u"/dev/full"_s)) GTEST_SKIP();
    const QString a = AddLevel(u"a.wav"_s, 0.25, 30);
    for (const QStringList& pace : {QStringList(), QStringList(u"--fast"_s)}) {
        const CommandResult result =
            RunWords(QStringList{u"play"_s, u"--output"_s, u"file:/dev/full"_s, a} + pace);
        EXPECT_EQ(result.Status, 1);
        EXPECT_TRUE(result.Err.contains(u"nicht vollständig"_s)) << result.Err.toStdString();
    }
}

TEST_F(PlayTest, OptionsThatDoNotFitTogetherAreRefused) {
    const QString a = AddLevel(u"a.wav"_s, 0.25, 1);
    const QStringList cases[] = {
        {u"--fast"_s},
        {u"--fast"_s, u"--output=alsa"_s},
        {u"--fast"_s, u"--output=null"_s, u"--engine=mci"_s},
        {u"--output=file:"_s + Path(u"x.wav"_s), u"--engine=eldos"_s},
        {u"--output=what:ever"_s},
        {u"--scan=soon"_s},
        {u"--crossfade=-1"_s},
        {u"--order=sideways"_s},
    };
    for (const QStringList& words : cases)
        EXPECT_EQ(RunWords(QStringList{u"play"_s, a} + words).Status, 2) << words.join(u' ').toStdString();
    EXPECT_FALSE(QFile::exists(Path(u"x.wav"_s)));
}

TEST_F(PlayTest, OutputThatCannotBeOpenedFails) {
    const QString a = AddLevel(u"a.wav"_s, 0.25, 1);
    const CommandResult result = RunWords({u"play"_s, u"--output"_s, u"file:"_s + Path(u"no/x.wav"_s), a});
    EXPECT_EQ(result.Status, 1);
    EXPECT_TRUE(result.Err.contains(u"Error initializing output device"_s));
}

}  // namespace

TEST_F(PlayTest, AMixNeverOverwritesWhatItIsMadeOf) {
    const QString song = AddLevel(u"mix.wav"_s, 0.25, 1);
    const QByteArray before = folder_.Get(u"mix.wav"_s);
    for (const QString& path : {song, folder_.Path()}) {
        EXPECT_EQ(WriteMix({path}).Status, 1);
        EXPECT_EQ(folder_.Get(u"mix.wav"_s), before);
    }
}
