#pragma once

#include <random>
#include <vector>

#include "MusicManagment/playlist/PlayListTypes.h"

// In which sequence the entries of a list are tried after the one at `current` (-1: none of them). Every
// position comes once. Downwards and upwards `current` itself comes last; a random sequence has it anywhere.
// Empty for poStopAfterPlay.
std::vector<int> SequenceAfter(TPlayOrder order, int count, int current, std::mt19937& random);
