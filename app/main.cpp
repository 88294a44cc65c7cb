#include <QApplication>
#include <QCommandLineParser>
#include <algorithm>
#include <string_view>

#include "MusicManagment/playback/Engines.h"
#include "MusicManagment/playback/fmod/SoundLibrary.h"
#include "MusicManagment/playback/mci/GstMci.h"
#include "app/MainWindow.h"
#include "app/desktop/Icons.h"
#include "app/desktop/StandardFiles.h"
#include "app/desktop/Termination.h"
#include "app/desktop/Translations.h"
#include "app/dialogs/QtDialogs.h"

using namespace Qt::StringLiterals;

namespace {

void SetUp(QCoreApplication& application) {
    QCoreApplication::setApplicationName(u"Tunestead"_s);
    QCoreApplication::setApplicationVersion(QStringLiteral(TUNESTEAD_VERSION));
    InstallGerman(application);
}

// Ends the program after showing help or version when that was asked for.
QStringList FilesOfCommandLine(const QCoreApplication& application) {
    QCommandLineParser parser;
    parser.setApplicationDescription(u"Verwaltet eine Musiksammlung."_s);
    parser.addHelpOption();
    parser.addVersionOption();
    parser.addPositionalArgument(
        u"dateien"_s, u"Ordner und Songs, die aufgenommen werden, oder eine Datenbank"_s, u"[dateien...]"_s);
    parser.process(application);
    return parser.positionalArguments();
}

// Help and version need no windows, and so no desktop.
bool WantsTextOnly(int argc, char** argv) {
    constexpr std::string_view kOptions[] = {"-h", "--help", "--help-all", "-v", "--version"};
    return std::any_of(argv + 1, argv + argc,
                       [&](const char* argument) { return std::ranges::count(kOptions, argument) > 0; });
}

static_assert(kSpectrumBands == FSOUND_SPECTRUM_SIZE);

SpectrumSource SpectrumOf(const std::shared_ptr<FmodLibrary>& sound) {
    return {.SetActive =
                [sound](bool active) { sound->FSOUND_DSP_SetActive(sound->FSOUND_DSP_GetFFTUnit(), active); },
            .Get = [sound] { return sound->FSOUND_DSP_GetSpectrum(); }};
}

}  // namespace

int main(int argc, char** argv) {
    if (argc > 1 && WantsTextOnly(argc, argv)) {
        QCoreApplication application(argc, argv);
        SetUp(application);
        FilesOfCommandLine(application);
        return 0;
    }
    QApplication application(argc, argv);
    SetUp(application);
    QGuiApplication::setDesktopFileName(u"tunestead"_s);
    const QStringList files = FilesOfCommandLine(application);

    ChooseIconTheme();
    QtDialogs dialogs;
    SetUserDialogs(&dialogs);
    int result = 0;
    {
        const auto sound = std::make_shared<SoundLibrary>();
        TTunesteadMainWnd window({.Files = LocateStandardFiles(),
                                  .SettingsFile = UserSettingsFile(),
                                  .Arguments = files,
                                  .OfferWizard = true,
                                  .Engines = MakeEngines(sound, std::make_shared<GstMci>()),
                                  .Spectrum = SpectrumOf(sound)});
        dialogs.SetMainWindow(&window);
        const Termination termination([&window] { window.End(); });
        window.show();
        result = QApplication::exec();
    }
    SetUserDialogs(nullptr);
    return result;
}
