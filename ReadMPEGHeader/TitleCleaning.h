#pragma once

#include "ReadMPEGHeader/ID3Tag.h"

struct TitleCleaning {
    bool RemoveJunkTexts = false;   // discard titles and artists that are advertising or place-holders
    bool TakeTrackNumbers = false;  // a leading "(7)" of a title becomes the track, when there is none yet
};

// Cleans title and artist of one source of tags. First an artist that is repeated in front of the title is
// removed, then junk, then the track number is taken.
void CleanTitles(TID3Tag& tag, const TitleCleaning& cleaning);
