#include "MusicManagment/playback/Engines.h"

#include "MusicManagment/playback/EngineErrors.h"
#include "MusicManagment/playback/FMODPlaySound.h"
#include "MusicManagment/playback/fmod/SoundLibrary.h"
#include "MusicManagment/playback/mci/GstMci.h"
#include "MusicManagment/playback/mci/MCIPlaySound.h"

using namespace Qt::StringLiterals;

namespace {

using Backend = std::unique_ptr<TPlaySoundContainer>;

TFMODSettings FmodSettings(const EngineSettings& settings) {
    return {.FadeTime = settings.FMODCrossoverTime,
            .OutputType = settings.FMODSoundOutputTypes,
            .MixRate = settings.FMODMixRate,
            .SoftChannels = settings.FMODSoftChannels,
            .BufferSize = settings.FMODBufferSize};
}

// An engine that this build does not have refuses every song in its own name, so that the player goes on to
// the next one.
template <typename Exception>
EngineTable::Maker Missing(TEngine engine) {
    return [engine](const EngineSettings&) -> Backend {
        throw Exception(u"Die Engine %1 ist in diesem Programm nicht enthalten."_s.arg(EngineName(engine)));
    };
}

}  // namespace

EngineTable MakeEngines(std::shared_ptr<FmodLibrary> library, std::shared_ptr<MciInterface> mci) {
    EngineTable table;
    table.Register(TEngine::FMOD, [library](const EngineSettings& settings) -> Backend {
        return std::make_unique<TFMODPlaySound>(*library, FmodSettings(settings));
    });
    table.Register(TEngine::MCI,
                   [mci](const EngineSettings&) -> Backend { return std::make_unique<TMCIPlaySound>(*mci); });
    table.Register(TEngine::EldoS, Missing<EEldoSException>(TEngine::EldoS));
    table.Register(TEngine::WinAmp, Missing<EWinAmpException>(TEngine::WinAmp));
    return table;
}

EngineTable MakeEngines() {
    return MakeEngines(std::make_shared<SoundLibrary>(), std::make_shared<GstMci>());
}
