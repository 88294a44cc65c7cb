#pragma once

#include <QObject>
#include <QThread>
#include <memory>

// A thread with an event loop, which stands for another program: what belongs to it is made, used and
// destroyed there.
template <typename Program>
class OtherProgram {
 public:
    template <typename... Arguments>
    explicit OtherProgram(const Arguments&... arguments) {
        place_.moveToThread(&thread_);
        thread_.start();
        InThread([&] { program_ = std::make_unique<Program>(arguments...); });
    }
    ~OtherProgram() {
        InThread([this] { program_.reset(); });
        thread_.quit();
        thread_.wait();
    }
    OtherProgram(const OtherProgram&) = delete;
    OtherProgram& operator=(const OtherProgram&) = delete;

    // Lets the other program do something and waits for it.
    template <typename Action>
    void Do(Action action) {
        InThread([&] { action(*program_); });
    }
    // Starts something there.
    template <typename Action>
    void Begin(Action action) {
        QMetaObject::invokeMethod(
            &place_, [this, action] { action(*program_); }, Qt::QueuedConnection);
    }

 private:
    template <typename Action>
    void InThread(Action action) {
        QMetaObject::invokeMethod(&place_, action, Qt::BlockingQueuedConnection);
    }

    QThread thread_;
    QObject place_;
    std::unique_ptr<Program> program_;
};
