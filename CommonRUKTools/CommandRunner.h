#pragma once

#include <concepts>
#include <utility>

class QEvent;
class QObject;

// Where exceptions end. Behind a slot, a timer, an event handler or a callback of the bus nobody catches
// them, so none may leave it; what is thrown there is shown to the user, and the program goes on.

// In a catch clause: shows what was caught as a message; EAbort is silent. While such a message is shown,
// others wait until it has been read, each text once.
void ShowCaughtException();

// Runs a command of the user.
template <std::invocable Command>
void RunCommand(Command&& command) {
    try {
        std::forward<Command>(command)();
    } catch (...) {
        ShowCaughtException();
    }
}

// A slot or listener that lets no exception out: connect(button, &QPushButton::clicked, this, Guarded([...]
// {})).
template <typename Slot>
class Guarded {
 public:
    explicit Guarded(Slot slot) : slot_(std::move(slot)) {}

    template <typename... Arguments>
    requires std::invocable<Slot&, Arguments...>
    void operator()(Arguments&&... arguments) {
        RunCommand([&] { slot_(std::forward<Arguments>(arguments)...); });
    }

 private:
    Slot slot_;
};

// The last net, for event handlers and for slots that are not guarded. The toolkit's own frames are not made
// for exceptions and may be left half-done, so what can fail in the ordinary way is guarded where it is
// connected.
template <typename Application>
class GuardedApplication : public Application {
 public:
    using Application::Application;

    bool notify(QObject* receiver, QEvent* event) override {
        try {
            return Application::notify(receiver, event);
        } catch (...) {
            ShowCaughtException();
            return true;
        }
    }
};
