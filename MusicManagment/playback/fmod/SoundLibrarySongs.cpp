#include <algorithm>

#include "MusicManagment/playback/fmod/SongFile.h"
#include "MusicManagment/playback/fmod/SoundLibraryImpl.h"

FMUSIC_MODULE SoundLibrary::FMUSIC_LoadSong(const QString& fileName) {
    if (!Initialised() || !HasSpace(songs_)) return FMUSIC_MODULE::kNone;
    Song song;
    const bool loaded = Try([&] {
        auto source = LoadSongFile(fileName, rate_, midiFont_);
        song.length = source->Length();
        song.type = source->Type();
        song.orders = source->Orders();
        song.ahead = std::make_unique<DecodeAhead>(std::move(source), rate_);
    });
    if (!loaded) return FMUSIC_MODULE::kNone;
    const auto handle = static_cast<FMUSIC_MODULE>(++lastHandle_);
    songs_.emplace(handle, std::move(song));
    return handle;
}

bool SoundLibrary::FMUSIC_FreeSong(FMUSIC_MODULE song) {
    Song* found = Find(songs_, song);
    if (found == nullptr) return false;
    mixer_->Release(found->channel);
    songs_.erase(song);
    return true;
}

bool SoundLibrary::FMUSIC_PlaySong(FMUSIC_MODULE song) {
    Song* found = Find(songs_, song);
    return found != nullptr && StartVoice(*found, found->gain, false);
}

bool SoundLibrary::FMUSIC_StopSong(FMUSIC_MODULE song) {
    Song* found = Find(songs_, song);
    if (found == nullptr) return false;
    mixer_->Release(found->channel);
    found->channel = Mixer::kNoChannel;
    return Rewind(*found);
}

bool SoundLibrary::FMUSIC_SetPaused(FMUSIC_MODULE song, bool paused) {
    Song* found = Find(songs_, song);
    return found != nullptr && (mixer_->SetPaused(found->channel, paused) || Fail(FMOD_ERR_INVALID_PARAM));
}

bool SoundLibrary::FMUSIC_GetPaused(FMUSIC_MODULE song) {
    const Song* found = Find(songs_, song);
    return found != nullptr && mixer_->Paused(found->channel);
}

bool SoundLibrary::FMUSIC_IsPlaying(FMUSIC_MODULE song) {
    const Song* found = Find(songs_, song);
    return found != nullptr && Sounds(found->channel);
}

// Kept for a song that does not play yet.
bool SoundLibrary::FMUSIC_SetMasterVolume(FMUSIC_MODULE song, int volume) {
    Song* found = Find(songs_, song);
    if (found == nullptr) return false;
    found->gain = static_cast<float>(std::clamp(volume, 0, 256)) / 256;
    mixer_->SetGain(found->channel, found->gain);
    return true;
}

int SoundLibrary::FMUSIC_GetType(FMUSIC_MODULE song) {
    const Song* found = Find(songs_, song);
    return found != nullptr ? found->type : FMUSIC_TYPE_NONE;
}

bool SoundLibrary::FMUSIC_SetPanSeperation(FMUSIC_MODULE song, float separation) {
    Song* found = Find(songs_, song);
    if (found == nullptr) return false;
    if (!(separation >= 0 && separation <= 1)) return Fail(FMOD_ERR_INVALID_PARAM);
    found->ahead->Change(
        [=](SoundSource& source) { static_cast<SongSource&>(source).SetSeparation(separation); });
    return true;
}

int SoundLibrary::FMUSIC_GetOrder(FMUSIC_MODULE song) {
    const Song* found = Find(songs_, song);
    return found != nullptr ? found->ahead->Place().order : 0;
}

int SoundLibrary::FMUSIC_GetRow(FMUSIC_MODULE song) {
    const Song* found = Find(songs_, song);
    return found != nullptr ? found->ahead->Place().row : 0;
}

int SoundLibrary::FMUSIC_GetPatternLength(FMUSIC_MODULE song, int pattern) {
    Song* found = Find(songs_, song);
    int rows = 0;
    if (found != nullptr)
        found->ahead->Change(
            [&](SoundSource& source) { rows = static_cast<SongSource&>(source).PatternRows(pattern); });
    return rows;
}

int SoundLibrary::FMUSIC_GetNumOrders(FMUSIC_MODULE song) {
    const Song* found = Find(songs_, song);
    return found != nullptr ? found->orders : 0;
}

bool SoundLibrary::FMUSIC_SetOrder(FMUSIC_MODULE song, int order) {
    Song* found = Find(songs_, song);
    if (found == nullptr) return false;
    if (order < 0 || order >= found->orders) return Fail(FMOD_ERR_INVALID_PARAM);
    return Try([&] {
        found->ahead->Reposition(
            [order](SoundSource& source) { return static_cast<SongSource&>(source).SeekOrder(order); });
    });
}
