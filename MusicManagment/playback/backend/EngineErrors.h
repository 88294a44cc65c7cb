#pragma once

#include "CommonRUKTools/Errors.h"

// What the sound engines throw; the messages are for the user. The player tells the engines apart by these
// classes and goes on with the next one.

// The sound library of TFMODPlaySound refuses.
class EFMODException : public ERukException {
 public:
    using ERukException::ERukException;
};

class EEldoSException : public ERukException {
 public:
    using ERukException::ERukException;
};

class EMCIException : public ERukException {
 public:
    using ERukException::ERukException;
};

// The last engine: nothing follows it.
class EWinAmpException : public ERukException {
 public:
    using ERukException::ERukException;
};

// There is no other player, and none that could be started.
class EWinAmpMissing : public EWinAmpException {
 public:
    using EWinAmpException::EWinAmpException;
};

// The way to the loudspeaker failed: no device, or the sound server has gone. Nothing is said of the song,
// and no other engine would do better. Not derived from the engines' own classes, so that nobody takes it for
// a failure of theirs.
class EOutputException : public ERukException {
 public:
    using ERukException::ERukException;
};

// The player itself refuses.
class EPlaySoundException : public ERukException {
 public:
    using ERukException::ERukException;
};
