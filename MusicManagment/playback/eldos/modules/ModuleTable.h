#pragma once

#include <exception>
#include <string_view>

#include "MusicManagment/playback/eldos/SoundModule.h"

#ifdef _WIN32
#define ELDOS_EXPORT extern "C" __declspec(dllexport)
#else
#define ELDOS_EXPORT extern "C" __attribute__((visibility("default")))
#endif

// Makes the table of a module out of a class with
//   explicit Sound(const char* fileName);
//   EldoSFormat Format() const;
//   std::int64_t Length() const;
//   std::int64_t Read(std::int16_t* samples, std::int64_t frames);
//   void Seek(std::int64_t frame);
// all of which may throw a std::exception.
template <typename Sound>
class ModuleTable {
 public:
    static const EldoSModule* Get() {
        static constexpr EldoSModule kTable = {kEldoSModuleVersion, Open, Length, Read, Seek, Close};
        return &kTable;
    }

 private:
    static void* Open(const char* fileName, EldoSFormat* format, char* error, std::size_t errorSize) {
        try {
            auto* sound = new Sound(fileName);
            *format = sound->Format();
            return sound;
        } catch (const std::exception& failure) {
            CopyText(failure.what(), error, errorSize);
            return nullptr;
        }
    }
    static std::int64_t Length(void* sound) { return static_cast<Sound*>(sound)->Length(); }
    static std::int64_t Read(void* sound, std::int16_t* samples, std::int64_t frames) {
        try {
            return static_cast<Sound*>(sound)->Read(samples, frames);
        } catch (const std::exception&) {
            return -1;
        }
    }
    static int Seek(void* sound, std::int64_t frame) {
        try {
            static_cast<Sound*>(sound)->Seek(frame);
            return 1;
        } catch (const std::exception&) {
            return 0;
        }
    }
    static void Close(void* sound) { delete static_cast<Sound*>(sound); }

    static void CopyText(std::string_view text, char* target, std::size_t size) {
        if (size == 0) return;
        target[text.copy(target, size - 1)] = '\0';
    }
};
