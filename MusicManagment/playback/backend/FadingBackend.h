#pragma once

#include <QtGlobal>

#include "MusicManagment/playback/backend/PlaySoundContainer.h"

// What a back end that can fade offers besides playing. The player fades, and fades from song to song, with
// these only. Fades run in steps: the player calls FadeStep at every tick of its timer.
class FadingBackend {
 public:
    virtual ~FadingBackend() = default;

    // Below 0 is 0, above 100 is 100.
    virtual void SetVolume(int percent) = 0;
    virtual void SetFadeTime(quint32 milliseconds) = 0;
    // The volume goes from silence to full, or from full to silence, within the fade time from now on.
    virtual void StartFadeIn() = 0;
    virtual void StartFadeOut() = 0;
    // Sets the volume that the running fades ask for now. True when a fade-out has come to its end in this
    // step; the back end has stopped itself then.
    virtual bool FadeStep() = 0;
    virtual bool IsFadingIn() const = 0;
    virtual bool IsFadingOut() const = 0;
    // Forgets both fades and leaves the volume as it is.
    virtual void CancelFades() = 0;
    // A running fade-out ends with the next step.
    virtual void CutFadeOut() = 0;
};

// The fades of a back end; nullptr when it has none.
inline FadingBackend* AsFading(TPlaySoundContainer* backend) {
    return dynamic_cast<FadingBackend*>(backend);
}
