#include <QApplication>
#include <QTimer>

#include "CommonRUKTools/CommandRunner.h"
#include "MusicManagment/playback/Engines.h"
#include "MusicManagment/playback/extern/PlayerChannel.h"
#include "MusicManagment/playback/fmod/SoundLibrary.h"
#include "MusicManagment/playback/mci/GstMci.h"
#include "tsplayer/PlayerService.h"
#include "tsplayer/PlayerWindow.h"

using namespace Qt::StringLiterals;

namespace {

// A hidden player that nobody drives would stay for ever.
constexpr int kWaitForController = 30000;  // ms

}  // namespace

int main(int argc, char** argv) {
    GuardedApplication<QApplication> application(argc, argv);
    QCoreApplication::setApplicationName(u"TSPlayer"_s);
    QCoreApplication::setApplicationVersion(QStringLiteral(TUNESTEAD_VERSION));
    const bool hidden = QCoreApplication::arguments().contains(u"/NoVisible"_s, Qt::CaseInsensitive);
    QGuiApplication::setQuitOnLastWindowClosed(true);

    const auto sound = std::make_shared<SoundLibrary>();
    TPlaySound player(MakeEngines(sound, std::make_shared<GstMci>()));
    // Only of what sounds here: the program that drives this one may play songs itself meanwhile.
    SpectrumSource spectrum = SpectrumOf(sound);
    spectrum.Get = [&player, get = std::move(spectrum.Get)]() -> const float* {
        return player.GetStatus() == psPlaying ? get() : nullptr;
    };
    SpectrumFeed feed(std::move(spectrum));
    feed.Watch();
    PlayerWindow window(player);
    SetUserDialogs(&window);
    ChannelServer server(QCoreApplication::applicationPid());
    PlayerService service(player, server);
    service.OnControllerGone = &QCoreApplication::quit;
    service.OnFailure = [&window](const QString& message) {
        window.ShowMessage(MessageKind::Error, message);
    };
    // Another one serves this user already.
    if (!server.Listen(PlayerChannelPath())) return 1;

    if (!hidden) window.show();
    QTimer::singleShot(kWaitForController, &window, [&] {
        if (hidden && !window.isVisible() && !service.HasController()) QCoreApplication::quit();
    });
    const int result = QApplication::exec();
    SetUserDialogs(nullptr);
    return result;
}
