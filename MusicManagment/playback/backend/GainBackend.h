#pragma once

#include "MusicManagment/playback/backend/PlaySoundContainer.h"

// What a back end with a loudness of its own offers. Back ends of the sound library have none: that library
// has one for all its sounds.
class GainBackend {
 public:
    virtual ~GainBackend() = default;
    // 0 to 1 of the amplitude. An engine that cannot do it now stays as loud as it is: no song fails for
    // that.
    virtual void SetGain(float gain) = 0;
};

// The loudness of a back end; nullptr when it has none.
inline GainBackend* AsGain(TPlaySoundContainer* backend) {
    return dynamic_cast<GainBackend*>(backend);
}
