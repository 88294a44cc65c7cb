#pragma once

#include <QString>
#include <QtGlobal>

// When the player fades from one song to the next. The numbers stand in the settings.
enum TCrossover : int {
    coNone,
    coAutoChange,  // when a song comes to its end
    coAllChanges,  // also when the user asks for another song
    coAlways,      // also when the user stops
};

// The panel that shows the song that plays. It leaves the player (SetPanel(nullptr)) before it goes.
class PlayerPanel {
 public:
    virtual ~PlayerPanel() = default;

    virtual void ShowSong(const QString& fileName) = 0;
    // No song.
    virtual void Clear() = 0;
    virtual void ShowPosition(quint32 position, quint32 length) = 0;  // ms
    // The player's state has changed.
    virtual void Redraw() = 0;
    // What the user has chosen here.
    virtual TCrossover Crossover() const = 0;
    virtual void SetCrossover(TCrossover mode) = 0;
};
