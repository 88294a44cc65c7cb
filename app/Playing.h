#pragma once

#include <QString>
#include <functional>
#include <vector>

#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playback/spectrum/SpectrumFeed.h"
#include "MusicManagment/playlist/PlayList.h"
#include "app/CommandMenu.h"
#include "app/ShownFollowers.h"
#include "app/desktop/Mpris.h"
#include "app/desktop/StayAwake.h"

class QMainWindow;
class QMenuBar;
class SongListWidget;
class TPlayerForm;
class TPlaylistForm;
class TSpectrumForm;

// What playing needs from outside.
struct PlayingOptions {
    QString StandardList{};     // the file that keeps the playlist between two runs
    EngineTable Engines{};      // that songs are played with
    SpectrumSource Spectrum{};  // of what they play; empty for none
    // Makes the way to a separate player program; empty for none.
    std::function<std::unique_ptr<ExternalPlayer>()> MakeExternalPlayer{};
};

// Everything about playing that the main window has: the playlist, the player, their windows and commands.
class Playing {
 public:
    // The tool windows belong to `window`; in `songs` songs are chosen.
    Playing(QMainWindow& window, TMusicDatabase& database, SongListWidget& songs, PlayingOptions options);
    ~Playing();

    // Told what came of a command, in a sentence for the status bar.
    std::function<void(const QString&)> OnDone;

    TPlayList& PlayList() { return list_; }
    TPlaySound& Player() { return player_; }
    TPlaylistForm& ListForm() { return *listForm_; }

    // Adds the menus of the playlist and the player.
    void AddMenusTo(QMenuBar& bar);
    // Adds the items that show and hide the tool windows.
    void AddTo(QMenu& menu);

    // Each throws what the playlist or the player throws. The first opens the list of the last run where
    // there is one.
    void OpenStandardList();
    void OpenPlayList(const QString& path);
    void OpenSong(const QString& path);
    // What another program names: a song, a list or a folder. Its songs join the list, but a list takes its
    // place, a moment later because the user may have to be asked; the first of them plays.
    void OpenFile(const QString& path);
    // Like OpenSong, from the place where the file `instead` is, if that is open.
    void OpenSongInstead(const QString& path, const QString& instead);
    // Stops playing and keeps the list for the next run if that is wanted. Throws EStreamError.
    void Close(bool keepList);

 private:
    void SetUpWindows(QMainWindow& window);
    void SetUpSpectrum(QMainWindow& window, SpectrumSource source);
    void SetUpContextMenu();
    void JoinDesktop(QMainWindow& window);
    void FollowPlayer();
    void FollowSong();
    void Tell(const QString& sentence);
    void OpenFolder(const QString& path);
    void OpenPlayListLater(const QString& path);
    void PlayFromFocus();
    void PlayFromStart(const QString& list);
    int Append(const std::vector<SongIndex>& songs);
    void PlayChosen();
    void AddChosen();
    void PlayChosenEntry(int index, SongIndex hint = -1);
    void PlayEntry(int index, SongIndex hint);
    void Play();

    TMusicDatabase& database_;
    SongListWidget& songs_;
    const QString standardList_;
    bool standardListIsUnread_ = true;
    bool opensList_ = false;  // for another program
    TPlayList list_;
    TPlaySound player_;
    ShownFollowers followers_{list_};
    CommandMenu listMenu_{list_.Commands()};
    CommandMenu playerMenu_{player_.Commands()};
    TPlaylistForm* listForm_;
    TPlayerForm* playerForm_;
    TSpectrumForm* spectrumForm_;
    std::unique_ptr<SpectrumFeed> spectrumFeed_;
    QMenu* contextMenu_;
    std::unique_ptr<Mpris> mpris_;
    std::unique_ptr<StayAwake> awake_;
    QString shownSong_;
    Subscriptions subscriptions_;
    Subscriptions handlers_;
};
