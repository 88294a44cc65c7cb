#include "MusicManagment/playback/fmod/SdlAudio.h"

#include <SDL.h>

#include <cstring>

using namespace Qt::StringLiterals;

namespace {

int& Users() {
    static int users = 0;
    return users;
}

}  // namespace

bool SdlAudio::Acquire(const QString& driver) {
    Release();
    const QByteArray name = driver.toLatin1();
    if (Users() > 0) {
        const char* current = SDL_GetCurrentAudioDriver();
        if (current == nullptr || name != current) return false;
    } else {
        SDL_SetHint(SDL_HINT_AUDIO_DEVICE_APP_NAME, "Tunestead");
        // Not SDL_Init: that would start SDL's events as well and take over SIGINT and SIGTERM.
        if (SDL_AudioInit(name.constData()) != 0) return false;
    }
    ++Users();
    held_ = true;
    return true;
}

void SdlAudio::Release() {
    if (!held_) return;
    held_ = false;
    if (--Users() == 0) SDL_AudioQuit();
}

QStringList UsualSdlDrivers() {
#ifdef Q_OS_WIN
    return {u"wasapi"_s, u"directsound"_s, u"winmm"_s};
#else
    // Not "pipewire": opening a device waits there for ever while the server has no sink, and the loss of the
    // server goes unnoticed. A PipeWire desktop answers as PulseAudio, and through ALSA.
    return {u"pulseaudio"_s, u"alsa"_s, u"dsp"_s};
#endif
}
