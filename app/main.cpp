#include <QApplication>
#include <QCommandLineParser>
#include <algorithm>
#include <string_view>

#include "CommonRUKTools/AbsolutePath.h"
#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/RWReg.h"
#include "CommonRUKTools/StandardFiles.h"
#include "MusicManagment/playback/Engines.h"
#include "MusicManagment/playback/extern/LocalExternalPlayer.h"
#include "MusicManagment/playback/fmod/SoundLibrary.h"
#include "MusicManagment/playback/mci/GstMci.h"
#include "MusicManagmentRemoteControl/bus/BusChannel.h"
#include "app/MainWindow.h"
#include "app/desktop/Icons.h"
#include "app/desktop/Installation.h"
#include "app/desktop/PlaceholderColor.h"
#include "app/desktop/SingleInstance.h"
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

// The parser knows the steps by one spelling; in a command line they have several, and only as its first
// word.
QStringList WordsOf(const QCoreApplication& application) {
    QStringList words = application.arguments();
    if (words.size() < 2) return words;
    const QString first = words[1].toLower();
    if (first == u"/install"_s || first == u"/uninstall"_s) words[1] = u'-' + first.mid(1);
    if (first == u"-install"_s || first == u"-uninstall"_s) words[1] = first;
    return words;
}

// Ends the program after showing help or version when that was asked for. Paths become absolute: another
// program, with another current folder, may be the one that opens them.
QStringList ArgumentsOf(const QCoreApplication& application) {
    QCommandLineParser parser;
    parser.setSingleDashWordOptionMode(QCommandLineParser::ParseAsLongOptions);
    parser.setApplicationDescription(u"Verwaltet eine Musiksammlung."_s);
    parser.addHelpOption();
    parser.addVersionOption();
    parser.addPositionalArgument(
        u"dateien"_s,
        u"Ordner und Songs, die aufgenommen werden, eine Datenbank (.tsdb) oder eine Anordnung der Fenster (.df)"_s,
        u"[dateien...]"_s);
    const QCommandLineOption install(
        u"install"_s,
        u"Trägt das Programm für diesen Benutzer in das Menü ein und meldet seine Dateitypen an."_s);
    const QCommandLineOption uninstall(u"uninstall"_s,
                                       u"Nimmt das zurück, auf Wunsch mit Datenbank und Einstellungen."_s);
    parser.addOptions({install, uninstall});
    parser.process(WordsOf(application));
    if (parser.isSet(install)) return {u"-install"_s};
    if (parser.isSet(uninstall)) return {u"-uninstall"_s};
    QStringList paths = parser.positionalArguments();
    for (QString& path : paths)
        path = AbsolutePath(path);
    paths.removeAll(QString());
    return paths;
}

// Help and version need no windows, and so no desktop.
bool WantsTextOnly(int argc, char** argv) {
    constexpr std::string_view kOptions[] = {"-h", "--help", "--help-all", "-v", "--version"};
    return std::any_of(argv + 1, argv + argc,
                       [&](const char* argument) { return std::ranges::count(kOptions, argument) > 0; });
}

// The desktop's permission to take the focus, which the toolkit would use up.
QString ActivationToken() {
    const QString token = qEnvironmentVariable("XDG_ACTIVATION_TOKEN");
    return token.isEmpty() ? qEnvironmentVariable("DESKTOP_STARTUP_ID") : token;
}

int RunWindow(QtDialogs& dialogs, SingleInstance& instance, const MainWindowOptions& options) {
    TTunesteadMainWnd window(options);
    dialogs.SetMainWindow(&window);
    instance.OnStart = [&window](const StartRequest& request) { return window.TakeOver(request); };
    const Termination termination([&window] { window.End(); });
    window.show();
    const int result = QApplication::exec();
    instance.OnStart = nullptr;
    return result;
}

int RefuseToStart(const SingleInstance& instance) {
    UserDialogs().ShowMessage(
        MessageKind::Error,
        u"Tunestead läuft bereits (%1), antwortet aber nicht. Zwei Programme zugleich würden einander die "
        "Datenbank überschreiben. Warten Sie, bis es wieder antwortet, oder beenden Sie es."_s.arg(
            instance.Holder()));
    return 1;
}

int Start(QtDialogs& dialogs, const StartRequest& request) {
    const StandardFiles files = LocateStandardFiles();
    SingleInstance instance(files.Folder);
    switch (instance.Start(request)) {
        case SingleInstance::Role::HandedOver:
            return 0;
        case SingleInstance::Role::Unanswered:
            return RefuseToStart(instance);
        default:
            break;
    }
#ifdef Q_OS_WIN
    Installation* setup = nullptr;
#else
    Installation forThisUser(InstallationPlaces::OfThisUser());
    Installation* setup = &forThisUser;
#endif
    const auto sound = std::make_shared<SoundLibrary>();
    EngineTable engines = MakeEngines(sound, std::make_shared<GstMci>());
    engines.SetSharedGain = [sound](float gain) { sound->SetMasterVolume(gain); };
    return RunWindow(
        dialogs, instance,
        {.Files = files,
         .SettingsFile = TRWReg::DefaultFile(),
         .Arguments = request.Arguments,
         .Setup = setup,
         .OfferWizard = true,
         .Engines = std::move(engines),
         .Spectrum = SpectrumOf(sound),
         .MakeExternalPlayer = [] { return std::make_unique<LocalExternalPlayer>(); },
         .MakeRemoteChannel = [] { return std::make_unique<BusChannel>(QDBusConnection::sessionBus()); }});
}

}  // namespace

int main(int argc, char** argv) {
    if (argc > 1 && WantsTextOnly(argc, argv)) {
        QCoreApplication application(argc, argv);
        SetUp(application);
        ArgumentsOf(application);
        return 0;
    }
    const QString token = ActivationToken();
    GuardedApplication<QApplication> application(argc, argv);
    SetUp(application);
    QGuiApplication::setDesktopFileName(u"tunestead"_s);
    const QStringList arguments = ArgumentsOf(application);

    ChooseIconTheme();
    KeepPlaceholdersLegible();
    QtDialogs dialogs;
    SetUserDialogs(&dialogs);
    const int result = Start(dialogs, {arguments, token});
    SetUserDialogs(nullptr);
    return result;
}
