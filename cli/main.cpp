#include <QCoreApplication>
#include <cstdio>

#include "cli/CommandLine.h"
#include "cli/platform/Terminal.h"

int main(int argc, char** argv) {
    const QCoreApplication application(argc, argv);
    PrepareConsole();
    return RunCommand(QCoreApplication::arguments().mid(1),
                      {stdout, stderr, IsTerminal(stdin) ? stdin : nullptr});
}
