#pragma once

#include <memory>

#include "MusicManagment/playback/EngineChoice.h"
#include "MusicManagment/playback/fmod/FmodLibrary.h"
#include "MusicManagment/playback/mci/MciInterface.h"

// The engines of this build: where the player meets the sound libraries. The table keeps the two that are
// given here alive.
EngineTable MakeEngines(const std::shared_ptr<FmodLibrary>& library,
                        const std::shared_ptr<MciInterface>& mci);
// With the sound library and the media control interface of this system. Where the sound goes is the
// business of the environment variable TUNESTEAD_AUDIO.
EngineTable MakeEngines();
