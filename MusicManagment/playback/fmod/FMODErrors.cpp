#include "MusicManagment/playback/fmod/FMODErrors.h"

#include <array>
#include <cstddef>

namespace {

constexpr std::array kTexts = {
    "No errors",
    "Cannot call this command after FSOUND_Init.  Call FSOUND_Close first",
    "This command failed because FSOUND_Init was not called",
    "Error initializing output device",
    "The output device is already in use and cannot be reused",
    "Playing the sound failed",
    "Soundcard does not support the features needed for this soundsystem (16bit stereo output)",
    "Error setting cooperative level for hardware",
    "Error creating hardware sound buffer",
    "File not found",
    "Unknown file format",
    "Error loading file",
    "Not enough memory or resources",
    "The version number of this file format is not supported",
    "An invalid parameter was passed to this function",
    "Tried to use an EAX command on a non EAX enabled channel or output",
    "Failed to allocate a new channel",
    "Recording is not supported on this machine",
    "Required Mediaplayer codec is not installed",
};
static_assert(kTexts.size() == FMOD_ERR_MEDIAPLAYER + 1);

}  // namespace

bool IsOutputError(int code) {
    return code == FMOD_ERR_INIT || code == FMOD_ERR_ALLOCATED || code == FMOD_ERR_OUTPUT_FORMAT ||
           code == FMOD_ERR_COOPERATIVELEVEL || code == FMOD_ERR_CREATEBUFFER;
}

QString FMODErrorText(int code) {
    if (code < 0 || static_cast<std::size_t>(code) >= kTexts.size()) return QStringLiteral("Unknown error");
    return QString::fromLatin1(kTexts[static_cast<std::size_t>(code)]);
}
