#pragma once

#include <cstdio>
#include <memory>
#include <optional>

// What the command line needs of the system's terminal and of its signals.

// A closed pipe becomes a failing write instead of ending the process; texts are shown as UTF-8.
void PrepareConsole();

bool IsTerminal(std::FILE* stream);
// How many characters a line of the terminal has; 0 when it does not say.
int TerminalColumns(std::FILE* stream);

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

// While one exists, keys arrive without the Enter key and are not shown, when the standard input is a
// terminal and this program has it. The terminal is as it was afterwards. Ctrl-C stays what it is.
class KeyReader {
 public:
    KeyReader();
    ~KeyReader();
    KeyReader(const KeyReader&) = delete;
    KeyReader& operator=(const KeyReader&) = delete;

    // A key that was pressed; does not wait.
    std::optional<char> Read();

 private:
    struct Former;
    std::unique_ptr<Former> former_;  // nullptr: no keys
};
