#pragma once

#include <QtGlobal>
#include <memory>
#include <optional>

using GstElement = struct _GstElement;

// What the sound of a player goes through on its last steps to the device: its gain glides there. What waits
// in the device is heard first.
class GlideFilter {
 public:
    // 0 to 1 of the amplitude. The first sound begins there at once, so that nothing of an attack is lost.
    explicit GlideFilter(float gain);
    ~GlideFilter();
    GlideFilter(const GlideFilter&) = delete;
    GlideFilter& operator=(const GlideFilter&) = delete;

    // A sink around `sink`, for one player, which may live longer than this object; nullptr when GStreamer
    // lacks a part of it.
    GstElement* Make(GstElement* sink);

    void SetGain(float gain);
    // Glides into silence, and stays there until FadeIn or a seek.
    void FadeOut();
    void FadeIn();

    // The end has come and no sound before it.
    bool IsEmpty() const;
    // Whether silence has come after FadeOut; `runningTime` is the player's, in nanoseconds.
    bool IsSilentAt(quint64 runningTime) const;
    // Where in the song FadeOut has begun to work, in milliseconds.
    std::optional<quint32> FadedFrom() const;

 private:
    struct State;
    std::shared_ptr<State> state_;
};
