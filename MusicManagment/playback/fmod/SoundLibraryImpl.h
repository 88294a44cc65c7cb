#pragma once

#include <new>

#include "MusicManagment/playback/fmod/SoundLibrary.h"
#include "MusicManagment/playback/fmod/SoundSource.h"

// What the sources of SoundLibrary share.

template <typename Action>
bool SoundLibrary::Try(Action action) {
    try {
        action();
        return true;
    } catch (const ESoundFileError& error) {
        return Fail(error.code);
    } catch (const std::bad_alloc&) {
        return Fail(FMOD_ERR_MEMORY);
    }
}

template <typename Table, typename Handle>
auto* SoundLibrary::Find(Table& table, Handle handle) {
    const auto found = Initialised() ? table.find(handle) : table.end();
    if (found == table.end() && mixer_ != nullptr) Fail(FMOD_ERR_INVALID_PARAM);
    return found != table.end() ? &found->second : nullptr;
}

// Each open file has a thread and some hundred kilobytes of its own.
template <typename Table>
bool SoundLibrary::HasSpace(const Table& table) {
    constexpr std::size_t kMostOpen = 256;
    return table.size() < kMostOpen || Fail(FMOD_ERR_MEMORY);
}
