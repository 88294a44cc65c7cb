#pragma once

#include <QString>
#include <QStringList>

// What the engine asks of the desktop around it.
class Shell {
 public:
    virtual ~Shell() = default;
    // Opens a file with the program that the user has chosen for its type; false when none could be started.
    virtual bool OpenWithDefaultProgram(const QString& path) = 0;
    // Starts a program that then goes its own way; false when that could not be done. The arguments reach it
    // as they are: no command interpreter sees them.
    virtual bool StartProgram(const QString& program, const QStringList& arguments) = 0;
};

// The shell in use; by default the desktop's own opener is started.
Shell& CurrentShell();
// The caller keeps ownership; nullptr restores the default.
void SetShell(Shell* shell);
