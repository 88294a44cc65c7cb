#include "MusicManagment/database/Command.h"

// It takes a window: what is found waits for decisions.

namespace {

constexpr DatabaseCommand kRows[] = {
    {.Id = mcReadBackupCd, .Caption = u"Songs von einer Backup-CD wieder einlesen"},
};

}  // namespace

constinit const DatabaseCommands kBackupCommands = kRows;
