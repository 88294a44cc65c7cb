#pragma once

#include <QString>
#include <QtGlobal>

#include "CommonRUKTools/Listeners.h"

// What the player tells, whoever plays: this program or another one. Any number may listen.
struct PlayerEvents {
    Listeners<> Started, Stopped, Paused, Resumed;
    Listeners<> ReachedEnd;
    Listeners<> Crossover;             // the moment at which the next song may be faded in
    Listeners<quint32> Playing;        // the position in ms, at every tick
    Listeners<quint32> Seeked;         // ms; somebody has gone to another place of the song
    Listeners<> Changed;               // the song, or what the player does with it
    Listeners<const QString&> Notice;  // one line for the user, that needs no answer: a song was passed over
};
