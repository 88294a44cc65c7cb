#pragma once

#include <QString>

#include "cli/Commands.h"

QString ProgramHelp();
QString CommandHelp(const CommandRow& command);
