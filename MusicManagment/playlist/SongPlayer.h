#pragma once

#include <QString>

// The player as a playlist drives it.
class SongPlayer {
 public:
    virtual ~SongPlayer() = default;

    // Whether a song begins to play as soon as it is the current file.
    virtual bool AutoPlay() const = 0;
    // The longest time a song plays, in milliseconds; 0 is no limit.
    virtual void SetAutoStop(int milliseconds) = 0;
    // Makes it the current file and opens it. Throws what the sound engine throws.
    virtual void SetFileName(const QString& path) = 0;
    virtual void Play() = 0;
    // Fades from the current file to this one. False when that is not possible now.
    virtual bool PlayWithCrossFade(const QString& path) = 0;
    // Tells in one line, where the player does that, why songs were passed over. False: tell it in a message.
    virtual bool TellQuietly(const QString&) { return false; }
    // The song that is shown has changed.
    virtual void RedrawPanel() = 0;
};
