#pragma once

#include <vector>

#include "MusicManagment/conversion/ConvertSong.h"

// Many conversions, as many at a time as the machine has cores.

struct ConversionOutcome {
    TID3Tag Record{};   // of the new file
    QString Error{};    // why there is none
    bool Done = false;  // there is one; neither this nor an error: it was stopped before
};

struct ConversionState {
    std::size_t Song = 0;  // that is waited for
    double SongPart = 0;   // of it, 0 to 1
    double Part = 0;       // of all
};

// Of each job, in their order; a job that fails does not stop the others. `goOn` is asked some thirty times a
// second on this thread; when it returns false what is being made is given up at once.
std::vector<ConversionOutcome> RunConversions(const std::vector<ConversionJob>& jobs,
                                              const EncoderSettings& settings,
                                              const std::function<bool(const ConversionState&)>& goOn);
