#pragma once

#include <functional>

// Runs a command of the user. What it throws is shown as a message; EAbort ends it silently. The only place
// where the program's windows catch exceptions.
void RunCommand(const std::function<void()>& command);
