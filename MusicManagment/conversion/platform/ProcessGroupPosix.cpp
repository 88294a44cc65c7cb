#include <csignal>

#include <QProcess>

#include <unistd.h>

#include "MusicManagment/conversion/platform/ProcessGroup.h"

void GiveOwnGroup(QProcess& process) {
    process.setChildProcessModifier([] { ::setpgid(0, 0); });
}

void KillGroup(QProcess& process) {
    const auto id = static_cast<pid_t>(process.processId());
    if (id > 0) ::kill(-id, SIGKILL);
    process.kill();
}
