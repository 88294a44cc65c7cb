#pragma once

#include <memory>

#include "CommonRUKTools/ByteReader.h"
#include "MusicManagment/playback/fmod/SoundSource.h"

// Tracker songs: mod, s3m, xm, it.
namespace ModuleSource {

// True when a file of this size that begins with these bytes can be a module. 2 KiB tell.
bool Probe(ByteSpan head, std::uint64_t fileSize);
// Throws ESoundFileError when it is none. `rate` in Hz.
std::unique_ptr<SongSource> Load(ByteSpan file, int rate);

}  // namespace ModuleSource
