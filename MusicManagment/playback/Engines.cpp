#include "MusicManagment/playback/Engines.h"

#include "MusicManagment/playback/eldos/EldoSPlaySound.h"
#include "MusicManagment/playback/fmod/FMODPlaySound.h"
#include "MusicManagment/playback/mci/MCIPlaySound.h"
#include "MusicManagment/playback/winamp/WinAmpPlaySound.h"

namespace {

using Backend = std::unique_ptr<TPlaySoundContainer>;

TFMODSettings FmodSettings(const EngineSettings& settings) {
    return {.FadeTime = settings.FMODCrossoverTime,
            .OutputType = settings.FMODSoundOutputTypes,
            .MixRate = settings.FMODMixRate,
            .SoftChannels = settings.FMODSoftChannels,
            .BufferSize = settings.FMODBufferSize};
}

TEldoSSettings EldoSSettings(const EngineSettings& settings) {
    TEldoSSettings eldos;
    eldos.BufferCount = settings.EldoSBufferCount;
    eldos.BufferSize = settings.EldoSBufferSize;
    return eldos;
}

TWinAmpSettings WinAmpSettings(const EngineSettings& settings) {
    TWinAmpSettings winAmp;
    winAmp.ClassName = settings.WinAmpClassName;
    winAmp.File = settings.WinAmpFile;
    return winAmp;
}

quint32 AskWinAmp(const QString& path, const EngineSettings& settings) {
    TWinAmpPlaySound song(WinAmpSettings(settings));
    song.SetBackendFile(path);
    song.Open();
    return song.AskLength();
}

}  // namespace

EngineTable MakeEngines(const std::shared_ptr<FmodLibrary>& library,
                        const std::shared_ptr<MciInterface>& mci) {
    EngineTable table;
    table.Register(TEngine::FMOD, [library](const EngineSettings& settings) -> Backend {
        return std::make_unique<TFMODPlaySound>(*library, FmodSettings(settings));
    });
    table.Register(TEngine::MCI,
                   [mci](const EngineSettings&) -> Backend { return std::make_unique<TMCIPlaySound>(*mci); });
    table.Register(TEngine::EldoS, [](const EngineSettings& settings) -> Backend {
        return std::make_unique<TEldoSPlaySound>(EldoSSettings(settings));
    });
    table.Register(TEngine::WinAmp, [](const EngineSettings& settings) -> Backend {
        return std::make_unique<TWinAmpPlaySound>(WinAmpSettings(settings));
    });
    table.AskLength = AskWinAmp;
    return table;
}

static_assert(kSpectrumBands == FSOUND_SPECTRUM_SIZE);

SpectrumSource SpectrumOf(const std::shared_ptr<FmodLibrary>& library) {
    return {.SetActive =
                [library](bool active) {
                    library->FSOUND_DSP_SetActive(library->FSOUND_DSP_GetFFTUnit(), active);
                },
            .Get = [library] { return library->FSOUND_DSP_GetSpectrum(); }};
}
