#pragma once

#include <gtest/gtest.h>

#include <QSet>

#include "MusicManagment/playlist/PlayList.h"
#include "MusicManagment/playlist/PlayListView.h"
#include "MusicManagment/playlist/SongPlayer.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/database/SongFolder.h"

class EEngine : public ERukException {
 public:
    using ERukException::ERukException;
};

// Writes down what it is told to play, by the files' names without extension.
class ScriptedPlayer : public SongPlayer {
 public:
    bool CanFade = true;
    bool PlaysAtOnce = false;
    QSet<QString> Broken;  // songs that the engine refuses
    std::function<void()> OnOpen;

    QStringList Played;
    QStringList Files;
    QStringList Faded;
    int Plays = 0;
    int Redraws = 0;
    int AutoStop = -1;

    bool AutoPlay() const override { return PlaysAtOnce; }
    void SetAutoStop(int milliseconds) override { AutoStop = milliseconds; }
    void SetFileName(const QString& path) override { Played << Open(path); }
    void Play() override { ++Plays; }
    bool PlayWithCrossFade(const QString& path) override {
        if (!CanFade) return false;
        Faded << Open(path);
        return true;
    }
    void RedrawPanel() override { ++Redraws; }

 private:
    QString Open(const QString& path) {
        if (OnOpen) OnOpen();
        const QString song = QFileInfo(path).completeBaseName();
        if (Broken.contains(song)) throw EEngine(QStringLiteral("Engine: ") + song);
        Files << path;
        return song;
    }
};

class ScriptedView : public PlayListView {
 public:
    std::vector<int> Selected;
    int Current = -1;
    int Refreshes = 0;
    int Redraws = 0;

    std::vector<int> SelectedEntries() const override { return Selected; }
    int CurrentEntry() const override { return Current; }
    void Refresh() override { ++Refreshes; }
    void Redraw() override { ++Redraws; }
};

// A playlist of small sound files with a player.
class PlayingTest : public testing::Test {
 protected:
    PlayingTest() { list_.SetPlaySound(&player_); }

    QString Path(const QString& song) const { return folder_.Path(song + QStringLiteral(".wav")); }
    // Adds songs with these one-letter names; those in capitals have no file.
    void Add(const QString& songs) {
        for (const QChar song : songs) {
            if (song.isLower()) folder_.Add(song + QStringLiteral(".wav"));
            list_.Insert(list_.Count(), {.Name = Path(song)});
        }
    }
    QString Names(const QStringList& paths) const {
        QString names;
        for (const QString& path : paths)
            names += QFileInfo(path).completeBaseName();
        return names;
    }
    QString Listed() const {
        QStringList names;
        for (int i = 0; i < list_.Count(); ++i)
            names << list_.Entry(i).Name;
        return Names(names);
    }
    QString Current() const { return Names({list_.CurrentSong()}); }
    // Goes on until there is no next song; what was played, in its order.
    QString PlayOn(int most = 20) {
        player_.Played.clear();
        while (most-- > 0 && list_.PlayNext()) {
        }
        return player_.Played.join(QString());
    }
    const QStringList& Messages() const { return dialogs_.Messages; }

    SongFolder folder_;
    ScriptedDialogs dialogs_;
    ScriptedPlayer player_;
    TPlayList list_;
};
