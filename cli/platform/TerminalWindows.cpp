#include <conio.h>
#include <fcntl.h>
#include <io.h>
#include <windows.h>

#include <atomic>

#include "cli/platform/Terminal.h"

namespace {

std::atomic<bool> interrupted = false;

BOOL WINAPI OnControl(DWORD) {
    interrupted = true;
    return TRUE;
}

}  // namespace

void PrepareConsole() {
    SetConsoleOutputCP(CP_UTF8);
    _setmode(_fileno(stdout), _O_BINARY);
}

bool IsTerminal(std::FILE* stream) {
    return _isatty(_fileno(stream)) != 0;
}

int TerminalColumns(std::FILE* stream) {
    CONSOLE_SCREEN_BUFFER_INFO info = {};
    const auto console = reinterpret_cast<HANDLE>(_get_osfhandle(_fileno(stream)));
    if (GetConsoleScreenBufferInfo(console, &info) == 0) return 0;
    return info.srWindow.Right - info.srWindow.Left + 1;
}

InterruptGuard::InterruptGuard() {
    SetConsoleCtrlHandler(OnControl, TRUE);
}

InterruptGuard::~InterruptGuard() {
    SetConsoleCtrlHandler(OnControl, FALSE);
    interrupted = false;
}

bool InterruptRequested() {
    return interrupted;
}

void RequestInterrupt() {
    interrupted = true;
}

// The console delivers single keys by functions of their own; nothing has to be switched.
struct KeyReader::Former {};

KeyReader::KeyReader() : former_(IsTerminal(stdin) ? std::make_unique<Former>() : nullptr) {}

KeyReader::~KeyReader() = default;

std::optional<char> KeyReader::Read() {
    if (!former_ || _kbhit() == 0) return std::nullopt;
    return static_cast<char>(_getch());
}
