#include <QProcess>

#include "MusicManagment/conversion/platform/ProcessGroup.h"

void GiveOwnGroup(QProcess&) {}

void KillGroup(QProcess& process) {
    process.kill();
}
