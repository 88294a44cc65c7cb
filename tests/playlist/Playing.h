#pragma once

#include <gtest/gtest.h>

#include "CommonRUKTools/SafeFile.h"
#include "MusicManagment/playlist/PlayList.h"
#include "MusicManagment/playlist/PlayListView.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/database/SongFolder.h"
#include "tests/playlist/ScriptedPlayer.h"

class ScriptedView : public PlayListView {
 public:
    std::vector<int> Selected;
    int Current = -1;

    std::vector<int> SelectedEntries() const override { return Selected; }
    int CurrentEntry() const override { return Current; }
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
    QString Put(const QString& name, std::string_view text) const {
        SafeFile file(folder_.Path(name));
        file.Write(AsBytes(text));
        file.Commit();
        return folder_.Path(name);
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
