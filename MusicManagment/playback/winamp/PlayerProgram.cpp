#include "MusicManagment/playback/winamp/PlayerProgram.h"

#include <QFileInfo>
#include <QProcess>
#include <QStandardPaths>
#include <array>
#include <csignal>

using namespace Qt::StringLiterals;

namespace {

struct KnownPlayer {
    QStringView name;
    QStringView argument;  // none when empty
};

// What each needs to be on the bus, and to stay there after a song.
constexpr std::array<KnownPlayer, 3> kKnownPlayers = {{
    {u"audacious", u""},
    {u"vlc", u"--control=dbus"},
    {u"mpv", u"--idle=yes"},
}};

}  // namespace

QStringList KnownPlayers() {
    QStringList names;
    for (const KnownPlayer& player : kKnownPlayers)
        names << player.name.toString();
    return names;
}

std::optional<PlayerProgram> FindPlayerProgram(const QString& nameOrPath) {
    const QString path = QStandardPaths::findExecutable(nameOrPath);
    if (path.isEmpty()) return std::nullopt;
    PlayerProgram program{path, {}};
    const QString name = QFileInfo(path).fileName();
    for (const KnownPlayer& player : kKnownPlayers) {
        if (name == player.name && !player.argument.isEmpty())
            program.Arguments << player.argument.toString();
    }
    return program;
}

std::optional<PlayerProgram> FindKnownPlayer() {
    for (const KnownPlayer& player : kKnownPlayers) {
        if (auto program = FindPlayerProgram(player.name.toString())) return program;
    }
    return std::nullopt;
}

std::optional<qint64> StartPlayer(const PlayerProgram& program, const QString& file) {
    QProcess process;
    process.setProgram(program.Path);
    process.setArguments(program.Arguments + QStringList{file});
    process.setStandardInputFile(QProcess::nullDevice());
    process.setStandardOutputFile(QProcess::nullDevice());
    process.setStandardErrorFile(QProcess::nullDevice());
    qint64 id = 0;
    if (!process.startDetached(&id)) return std::nullopt;
    return id;
}

void EndPlayer(const PlayerProgram& program, qint64 process) {
    const QFileInfo running(u"/proc/%1/exe"_s.arg(process));
    if (running.symLinkTarget() != QFileInfo(program.Path).canonicalFilePath()) return;
    ::kill(static_cast<pid_t>(process), SIGTERM);
}
