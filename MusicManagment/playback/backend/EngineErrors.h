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

// The player itself refuses.
class EPlaySoundException : public ERukException {
 public:
    using ERukException::ERukException;
};
