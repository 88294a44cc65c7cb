#pragma once

#include <cstdio>

// What the command line needs of the system's terminal and of its signals.

// A closed pipe becomes a failing write instead of ending the process; texts are shown as UTF-8.
void PrepareConsole();

bool IsTerminal(std::FILE* stream);

// While one exists, the user's wish to stop (Ctrl-C, a polite kill) only sets a mark that the running
// operation looks at; otherwise it ends the process at once.
class InterruptGuard {
 public:
    InterruptGuard();
    ~InterruptGuard();
    InterruptGuard(const InterruptGuard&) = delete;
    InterruptGuard& operator=(const InterruptGuard&) = delete;
};

bool InterruptRequested();
// What the signal does.
void RequestInterrupt();
