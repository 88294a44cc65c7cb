#pragma once

#include <vector>

#include "ReadMPEGHeader/TagWriting.h"
#include "ReadMPEGHeader/writing/TagFrame.h"

// Front covers among the frames of an ID3v2.3 tag: "APIC" of type 3.

// Whether the change would leave other covers than there are.
bool ChangesCovers(const std::vector<TagFrame>& frames, const CoverChange& change);
// A new cover takes the place of the first one; other pictures stay.
void ChangeCovers(std::vector<TagFrame>& frames, const CoverChange& change);
