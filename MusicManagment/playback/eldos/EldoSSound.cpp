#include "MusicManagment/playback/eldos/EldoSSound.h"

#include <QFile>
#include <array>

#include "MusicManagment/playback/backend/EngineErrors.h"
#include "MusicManagment/playback/backend/SoundLimits.h"
#include "MusicManagment/playback/eldos/ModuleFiles.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kMostDeviceChannels = 8;  // of the outputs

[[noreturn]] void ThrowUnplayable(const QString& fileName, const QString& reason) {
    throw EEldoSException(u"Kann die Datei "_s + fileName + u" nicht abspielen ("_s + reason + u")."_s);
}

void* OpenIn(const EldoSModule& module, const QString& fileName, EldoSFormat& format) {
    std::array<char, 256> error{};
    void* sound = module.open(QFile::encodeName(fileName).constData(), &format, error.data(), error.size());
    if (sound == nullptr) ThrowUnplayable(fileName, QString::fromUtf8(error.data()));
    return sound;
}

}  // namespace

EldoSSound::EldoSSound(const QString& fileName, const QStringList& moduleFolders)
    : module_(ModuleFor(fileName, moduleFolders)), sound_(OpenIn(module_, fileName, format_), module_.close) {
    if (!IsSoundFormat(format_.rate, format_.channels) || format_.channels > kMostDeviceChannels)
        ThrowUnplayable(fileName, u"%1 Hz, %2 Kanäle"_s.arg(format_.rate).arg(format_.channels));
}

std::int64_t EldoSSound::Read(std::span<std::int16_t> samples) {
    const auto wanted = static_cast<std::int64_t>(samples.size()) / format_.channels;
    std::int64_t frames = 0;
    while (frames < wanted) {
        const std::int64_t read =
            module_.read(sound_.get(), samples.data() + frames * format_.channels, wanted - frames);
        if (read <= 0) break;
        frames += read;
    }
    return frames;
}

void EldoSSound::Seek(std::int64_t frame) {
    if (module_.seek(sound_.get(), frame) == 0)
        throw EEldoSException(u"Fehler beim Setzen der neuen Position."_s);
}
