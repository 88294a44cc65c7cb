#include "MusicManagment/playback/fmod/OutputChoice.h"

#include "MusicManagment/playback/fmod/SdlOutput.h"
#include "MusicManagment/playback/fmod/SinkOutput.h"

using namespace Qt::StringLiterals;

namespace {

constexpr const char* kVariable = "TUNESTEAD_AUDIO";

std::unique_ptr<AudioOutput> OutputByType(TFSoundOutputTypes type) {
    switch (type) {
        case FSOUND_OUTPUT_NOSOUND:
            return std::make_unique<NullOutput>(SinkOutput::Pace::RealTime);
        case FSOUND_OUTPUT_WINMM:
        case FSOUND_OUTPUT_DSOUND:
            return std::make_unique<SdlOutput>(UsualSdlDrivers());
        case FSOUND_OUTPUT_OSS:
            return std::make_unique<SdlOutput>(QStringList{u"dsp"_s});
        case FSOUND_OUTPUT_ESD:  // PulseAudio took that daemon's place
            return std::make_unique<SdlOutput>(QStringList{u"pulseaudio"_s});
        case FSOUND_OUTPUT_ALSA:
            return std::make_unique<SdlOutput>(QStringList{u"alsa"_s});
        default:
            return nullptr;
    }
}

std::unique_ptr<AudioOutput> MakeOutput(const OutputChoice& choice, TFSoundOutputTypes type) {
    const auto pace = choice.unpaced ? SinkOutput::Pace::Caller : SinkOutput::Pace::RealTime;
    const auto samples = choice.floats ? WavFileOutput::Samples::Float32 : WavFileOutput::Samples::Int16;
    switch (choice.kind) {
        case OutputChoice::Kind::ByType:
            return OutputByType(type);
        case OutputChoice::Kind::Null:
            return std::make_unique<NullOutput>(pace);
        case OutputChoice::Kind::WavFile:
            return std::make_unique<WavFileOutput>(choice.name, samples, pace);
        case OutputChoice::Kind::Sdl:
            return std::make_unique<SdlOutput>(QStringList{choice.name});
    }
    return nullptr;
}

}  // namespace

std::optional<OutputChoice> ParseOutputChoice(const QString& text) {
    using Kind = OutputChoice::Kind;
    if (text == u"null"_s) return OutputChoice{.kind = Kind::Null};
    const qsizetype colon = text.indexOf(u':');
    const QString name = text.mid(colon + 1);
    if (colon < 0 || name.isEmpty()) return std::nullopt;
    const QString kind = text.left(colon);
    if (kind == u"file"_s || kind == u"capture"_s) return OutputChoice{.kind = Kind::WavFile, .name = name};
    if (kind == u"sdl"_s) return OutputChoice{.kind = Kind::Sdl, .name = name};
    return std::nullopt;
}

OutputFactory OutputsFor(const OutputChoice& choice) {
    return [choice](TFSoundOutputTypes type) { return MakeOutput(choice, type); };
}

OutputFactory OutputsOfEnvironment() {
    if (!qEnvironmentVariableIsSet(kVariable)) return OutputsFor({});
    const QString value = qEnvironmentVariable(kVariable);
    if (const auto choice = ParseOutputChoice(value)) return OutputsFor(*choice);
    qWarning("%s: no such output: %s", kVariable, qUtf8Printable(value));
    return [](TFSoundOutputTypes) { return nullptr; };
}
