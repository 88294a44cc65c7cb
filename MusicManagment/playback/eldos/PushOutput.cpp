#include "MusicManagment/playback/eldos/PushOutput.h"

#include "MusicManagment/playback/eldos/NullPush.h"
#include "MusicManagment/playback/eldos/SdlPush.h"
#include "MusicManagment/playback/fmod/OutputChoice.h"

std::unique_ptr<PushOutput> PushOutputOfEnvironment() {
    const QString text = qEnvironmentVariable("TUNESTEAD_AUDIO");
    if (text.isEmpty()) return std::make_unique<SdlPush>(UsualSdlDrivers());
    const std::optional<OutputChoice> choice = ParseOutputChoice(text);
    if (!choice) return nullptr;
    if (choice->kind == OutputChoice::Kind::Sdl) return std::make_unique<SdlPush>(QStringList{choice->name});
    return std::make_unique<NullPush>();
}
