#include <signal.h>
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
