#pragma once

#include <QString>
#include <QStringList>
#include <memory>
#include <span>

#include "MusicManagment/playback/eldos/SoundModule.h"

// One sound file, open in the module for its type.
class EldoSSound {
 public:
    // Throws EEldoSException.
    EldoSSound(const QString& fileName, const QStringList& moduleFolders);

    int Rate() const { return format_.rate; }                             // Hz, 1000 to 768000
    int Channels() const { return format_.channels; }                     // 1 to 8
    std::int64_t Length() const { return module_.length(sound_.get()); }  // frames; 0 when not known

    // Fills whole frames of the buffer as far as the file goes; returns how many. Fewer than fit is the end
    // of the file, or of what can be read of it.
    std::int64_t Read(std::span<std::int16_t> samples);
    // Throws EEldoSException.
    void Seek(std::int64_t frame);

 private:
    const EldoSModule& module_;
    EldoSFormat format_ = {};
    std::unique_ptr<void, void (*)(void*)> sound_;
};
