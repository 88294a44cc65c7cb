#include <sys/socket.h>
#include <unistd.h>

#include <array>
#include <csignal>

#include "app/desktop/Termination.h"

namespace {

constexpr std::array kSignals = {SIGTERM, SIGINT, SIGHUP};

int ends[2] = {-1, -1};  // what the handler writes into, and what the event loop reads

// A handler may do next to nothing; the rest is the event loop's.
void Tell(int) {
    const char byte = 0;
    [[maybe_unused]] const auto written = write(ends[0], &byte, sizeof byte);
}

void Handle(void (*handler)(int)) {
    for (const int signal : kSignals)
        std::signal(signal, handler);
}

}  // namespace

Termination::Termination(std::function<void()> end) : end_(std::move(end)) {
    if (socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0, ends) != 0) return;
    notifier_ = std::make_unique<QSocketNotifier>(ends[1], QSocketNotifier::Read);
    connect(notifier_.get(), &QSocketNotifier::activated, this, [this] {
        char byte = 0;
        if (read(ends[1], &byte, sizeof byte) > 0 && end_) end_();
    });
    Handle(Tell);
}

Termination::~Termination() {
    if (!notifier_) return;
    Handle(SIG_DFL);
    notifier_.reset();
    for (int& end : ends) {
        close(end);
        end = -1;
    }
}
