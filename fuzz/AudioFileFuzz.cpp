// Any bytes are a sound file: reading them must neither crash nor throw nor take long. The first byte chooses
// profile and cleaning, the rest is the file.

#include <cstdlib>

#include "CommonRUKTools/FileSource.h"
#include "ReadMPEGHeader/SongReading.h"

using namespace Qt::StringLiterals;

namespace {

constexpr unsigned kModern = 1;
constexpr unsigned kCleaning = 2;
constexpr unsigned kListening = 4;

ReadOptions OptionsFrom(std::uint8_t choice) {
    ReadOptions options;
    options.Profile = (choice & kModern) != 0 ? ReadProfile::Modern : ReadProfile::Classic;
    options.RemoveJunkTexts = options.TakeTrackNumbers = (choice & kCleaning) != 0;
    options.FileTime = 1;
    if ((choice & kListening) != 0) options.OnFrame = [](const FrameReport&) {};
    return options;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    if (size == 0) return 0;
    const ByteSpan input(data, size);
    MemorySource source(input.subspan(1));
    const SongReading reading = ReadSong(source, u"/music/Artist - Title.mp3"_s, OptionsFrom(input[0]));
    // The name at least gives these to whatever is no WMA file.
    if (!reading.Succeeded() || reading.Tag.FileName.isEmpty() || reading.Tag.MPEGLayer.isNull())
        std::abort();
    return 0;
}
