#pragma once

#include <functional>
#include <vector>

#include "ReadMPEGHeader/ID3Tag.h"

// For each of the songs whether it passes the test, which several threads ask at once.
std::vector<char> TestSongs(const std::vector<const TID3Tag*>& songs,
                            const std::function<bool(const TID3Tag&)>& passes);
