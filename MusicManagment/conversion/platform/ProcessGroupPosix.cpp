#include <csignal>

#include <QProcess>

#ifdef __linux__
#include <sys/prctl.h>
#endif
#include <unistd.h>

#include "MusicManagment/conversion/platform/ProcessGroup.h"

void GiveOwnGroup(QProcess& process) {
    process.setChildProcessModifier([] {
        ::setpgid(0, 0);
#ifdef __linux__
        // Where Tunestead is killed nobody waits for the program any more.
        ::prctl(PR_SET_PDEATHSIG, SIGKILL);
#endif
    });
}

void KillGroup(QProcess& process) {
    const auto id = static_cast<pid_t>(process.processId());
    if (id > 0) ::kill(-id, SIGKILL);
    process.kill();
}
