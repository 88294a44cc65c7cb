#include "app/desktop/StartRequests.h"

#include <utility>

namespace {

// Between two looks whether a dialog or a run has ended; nothing looks while nothing waits.
constexpr int kInterval = 150;  // milliseconds

}  // namespace

StartRequests::StartRequests() {
    timer_.setInterval(kInterval);
    QObject::connect(&timer_, &QTimer::timeout, &timer_, [this] { Work(); });
}

void StartRequests::Add(const QStringList& arguments) {
    waiting_.push_back(arguments);
    timer_.start();
}

void StartRequests::Work() {
    if (!waiting_.empty() && IsReady()) {
        const QStringList arguments = std::exchange(waiting_.front(), {});
        waiting_.pop_front();
        Act(arguments);
    }
    if (waiting_.empty()) timer_.stop();
}
