#pragma once

#include <QObject>
#include <QSocketNotifier>
#include <functional>
#include <memory>

// The system's request to end the program: the user logs out, the machine is shut down. One object at a time.
class Termination : public QObject {
 public:
    // `end` is called from the event loop, once for each request.
    explicit Termination(std::function<void()> end);
    ~Termination() override;

 private:
    std::function<void()> end_;
    std::unique_ptr<QSocketNotifier> notifier_;
};
