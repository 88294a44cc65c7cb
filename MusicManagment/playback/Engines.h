#pragma once

#include <memory>

#include "MusicManagment/playback/EngineChoice.h"
#include "MusicManagment/playback/fmod/FmodLibrary.h"
#include "MusicManagment/playback/mci/MciInterface.h"
#include "MusicManagment/playback/spectrum/SpectrumFeed.h"

// The engines of this build: where the player meets the sound libraries. The table keeps the two that are
// given here alive.
EngineTable MakeEngines(const std::shared_ptr<FmodLibrary>& library,
                        const std::shared_ptr<MciInterface>& mci);
// The spectrum of what the sound library plays.
SpectrumSource SpectrumOf(const std::shared_ptr<FmodLibrary>& library);
