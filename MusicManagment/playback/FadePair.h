#pragma once

#include <memory>

#include "MusicManagment/playback/backend/FadingBackend.h"
#include "MusicManagment/playback/backend/PlaySoundContainer.h"

// The current song and the one that leaves, fading out. Without a current song nothing may be asked but
// Current() and what sets one.
class FadePair {
 public:
    using Song = std::unique_ptr<TPlaySoundContainer>;

    TPlaySoundContainer* Current() const { return current_.get(); }
    // nullptr when it cannot fade.
    FadingBackend* CurrentFades() const { return AsFading(current_.get()); }
    bool HasLeaving() const { return leaving_ != nullptr; }
    QString FileOfLeaving() const { return leaving_ ? leaving_->BackendFile() : QString(); }

    void SetCurrent(Song song) { current_ = std::move(song); }
    void SetLeaving(Song song) { leaving_ = std::move(song); }
    void Clear();

    void Play();
    // Only the current one stays, and goes back to its start.
    void Stop();
    // Both. True when they play again.
    bool PauseResume();

    // A song that plays already gets its full volume back, and the one that leaves is cut short. False when
    // it does not play, or cannot fade.
    bool EndFades();
    // Lets the current song, which plays, fade out; it stops then. False where that is not possible.
    bool StartFadingStop(quint32 milliseconds);
    // Whether it was asked to stop and still fades.
    bool IsStopping() const;
    // Takes the current song's place with one that can fade; the former leaves. What the new one throws
    // leaves everything as it was.
    void CrossTo(Song next, quint32 milliseconds);
    // Sets the volumes for now. True when a fading stop has come to its end.
    bool FadeStep();

 private:
    void ResumeLeaving();

    Song current_;
    Song leaving_;
};
