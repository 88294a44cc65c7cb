#pragma once

#include <cstddef>
#include <cstdint>

#include "CommonRUKTools/Errors.h"
#include "MusicManagment/playback/fmod/FmodLibrary.h"

// A file cannot be played, for the reason that the code tells.
class ESoundFileError : public ERukException {
 public:
    explicit ESoundFileError(TFmodError errorCode)
        : ERukException(FMODErrorText(errorCode)), code(errorCode) {}
    const TFmodError code;
};

// A place in a song: the entry of its order list and the row of the pattern that it names.
struct SongPlace {
    int order = 0;
    int row = 0;
    bool operator==(const SongPlace&) const = default;
};

// Decodes one file into stereo frames at the mix rate. Belongs to one thread at a time.
class SoundSource {
 public:
    virtual ~SoundSource() = default;
    // Returns how many frames it wrote; fewer than asked for only at the end.
    virtual std::size_t Read(float* stereo, std::size_t frames) = 0;
    // Goes on from `frame`, or from the end when that is beyond it. Returns where it goes on. Throws
    // ESoundFileError.
    virtual std::uint64_t Seek(std::uint64_t frame) = 0;
    virtual std::uint64_t Length() const = 0;  // frames
    // Where the next frame stands in the song. The same all the time for what is no song.
    virtual SongPlace Place() const { return {}; }
};

class SongSource : public SoundSource {
 public:
    virtual FMUSIC_TYPES Type() const = 0;
    virtual int Orders() const = 0;
    virtual int PatternRows(int pattern) const = 0;  // 0 when there is no such pattern
    // Goes on from the start of an order below Orders(). Returns its frame.
    virtual std::uint64_t SeekOrder(int order) = 0;
    // 0 = mono, 1 = as the song has it.
    virtual void SetSeparation(float separation) = 0;
};
