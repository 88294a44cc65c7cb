#pragma once

#include <cstddef>
#include <cstdint>

// The border between the EldoS engine and its sound modules, which are libraries loaded at run time: plain C
// functions, nothing is thrown across, and what a module has made only that module frees. Samples are 16-bit,
// the channels of a frame one after the other.

extern "C" {

struct EldoSFormat {
    std::int32_t rate;      // Hz
    std::int32_t channels;  // per frame
};

struct EldoSModule {
    std::uint32_t version;  // kEldoSModuleVersion
    // `fileName` in the system's 8-bit encoding. Null on failure; `error` then holds a text with its
    // terminating zero.
    void* (*open)(const char* fileName, EldoSFormat* format, char* error, std::size_t errorSize);
    std::int64_t (*length)(void* sound);  // frames; 0 when not known
    // Reads up to so many frames. 0 at the end, -1 when the file cannot be read any further.
    std::int64_t (*read)(void* sound, std::int16_t* samples, std::int64_t frames);
    // Goes on with that frame. 0 on failure; where reading goes on is not known then.
    int (*seek)(void* sound, std::int64_t frame);
    void (*close)(void* sound);
};

// The one symbol of a module.
using EldoSModuleFunction = const EldoSModule* (*)();
}

inline constexpr std::uint32_t kEldoSModuleVersion = 1;
inline constexpr char kEldoSModuleSymbol[] = "EldoSSoundModule";
