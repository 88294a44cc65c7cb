#pragma once

#include <vector>

#include "ReadMPEGHeader/ID3Tag.h"

// A collection as people have them, the same at every call: of a million songs some 20,000 artists and 60,000
// albums, folder by folder as a scan takes them in; most titles differ, one text in eight has umlauts.
std::vector<TID3Tag> MakeFakeSongs(int count);
