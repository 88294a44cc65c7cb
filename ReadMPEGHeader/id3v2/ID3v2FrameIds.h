#pragma once

#include <string>
#include <string_view>

// True for capital letters and digits only, of which every frame id consists.
bool IsFrameId(std::string_view id);

// The id that ID3v2.3 gave to a frame of ID3v2.2 ("TT2": "TIT2"); one that has no successor stays as it is.
// "PIC" has a successor of another layout, "APIC".
std::string SuccessorOfFrameId(std::string_view id);
