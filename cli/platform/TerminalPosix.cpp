#include <poll.h>
#include <signal.h>
#include <sys/ioctl.h>
#include <termios.h>
#include <unistd.h>

#include <array>
#include <atomic>

#include "cli/platform/Terminal.h"

namespace {

constexpr std::array<int, 2> kStopSignals = {SIGINT, SIGTERM};

std::atomic<bool> interrupted = false;
static_assert(std::atomic<bool>::is_always_lock_free, "set inside a signal handler");

std::array<struct sigaction, kStopSignals.size()> formerActions;

void OnStopSignal(int) {
    interrupted = true;
}

}  // namespace

void PrepareConsole() {
    signal(SIGPIPE, SIG_IGN);
}

bool IsTerminal(std::FILE* stream) {
    return isatty(fileno(stream)) == 1;
}

int TerminalColumns(std::FILE* stream) {
    winsize size = {};
    return ioctl(fileno(stream), TIOCGWINSZ, &size) == 0 ? size.ws_col : 0;
}

InterruptGuard::InterruptGuard() {
    struct sigaction action = {};
    action.sa_handler = OnStopSignal;
    action.sa_flags = SA_RESTART;
    sigemptyset(&action.sa_mask);
    for (std::size_t i = 0; i < kStopSignals.size(); ++i)
        sigaction(kStopSignals[i], &action, &formerActions[i]);
}

InterruptGuard::~InterruptGuard() {
    for (std::size_t i = 0; i < kStopSignals.size(); ++i)
        sigaction(kStopSignals[i], &formerActions[i], nullptr);
    interrupted = false;
}

bool InterruptRequested() {
    return interrupted;
}

void RequestInterrupt() {
    interrupted = true;
}

struct KeyReader::Former {
    termios settings;
};

KeyReader::KeyReader() {
    // A program in the background would be stopped for touching the terminal.
    if (tcgetpgrp(STDIN_FILENO) != getpgrp()) return;
    termios settings = {};
    if (tcgetattr(STDIN_FILENO, &settings) != 0) return;
    former_ = std::make_unique<Former>(Former{settings});
    settings.c_lflag &= ~static_cast<tcflag_t>(ICANON | ECHO);
    settings.c_cc[VMIN] = 1;
    settings.c_cc[VTIME] = 0;
    settings.c_cc[VQUIT] = _POSIX_VDISABLE;  // it would end the process and leave the terminal like this
    tcsetattr(STDIN_FILENO, TCSANOW, &settings);
}

KeyReader::~KeyReader() {
    if (former_) tcsetattr(STDIN_FILENO, TCSANOW, &former_->settings);
}

std::optional<char> KeyReader::Read() {
    pollfd input = {STDIN_FILENO, POLLIN, 0};
    char key = 0;
    if (!former_ || poll(&input, 1, 0) != 1 || read(STDIN_FILENO, &key, 1) != 1) return std::nullopt;
    return key;
}
