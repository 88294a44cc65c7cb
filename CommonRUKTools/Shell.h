#pragma once

#include <QString>

// What the engine asks of the desktop around it.
class Shell {
 public:
    virtual ~Shell() = default;
    // Opens a file with the program that the user has chosen for its type; false when none could be started.
    virtual bool OpenWithDefaultProgram(const QString& path) = 0;
};

// The shell in use; by default the desktop's own opener is started.
Shell& CurrentShell();
// The caller keeps ownership; nullptr restores the default.
void SetShell(Shell* shell);
