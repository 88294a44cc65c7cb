#pragma once

#include <QString>

#include "MusicManagment/playback/backend/PlaySoundContainer.h"

enum class StopMode {
    AtOnce,
    Fade,  // at once where fading is not possible
};

// What became of a command.
enum class Carried {
    Out,       // here and now
    OnItsWay,  // what it leads to is told later
    Not,       // there was nothing to do
};

// Where the song plays: in the engines of this program, or in another program. The commands throw what the
// engine throws, the questions nothing.
class PlayTarget {
 public:
    virtual ~PlayTarget() = default;

    // Makes it ready for a command; where it does not know the song yet it gets that first. False when it
    // cannot be reached. Throws EPlaySoundException.
    virtual bool Reach(const QString& song) = 0;
    virtual void Open(const QString& path) = 0;
    virtual void Close() = 0;
    virtual Carried Play() = 0;
    virtual Carried Stop(StopMode mode) = 0;
    virtual Carried PauseResume() = 0;
    virtual void SetPosition(quint32 milliseconds) = 0;

    virtual quint32 Position() = 0;  // ms
    virtual quint32 Length() = 0;    // ms
    virtual TPSStatus Status() = 0;

    // Fades from the current song to this one. `Not` when that is not possible; the current one goes on then.
    virtual Carried CrossFadeTo(const QString& path) = 0;
    // Lets a song sound, and fade out, while the current one keeps playing.
    virtual void PlayBeside(const QString& path) = 0;
    virtual void CloseBeside() = 0;
    virtual bool SoundsBeside() = 0;
};
