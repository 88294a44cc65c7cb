#pragma once

#include <QTimer>
#include <functional>
#include <memory>
#include <optional>

// The timers of the player. Each keeps its deadline by the engine's clock as well, so that whoever has
// no event loop (or another clock) can run what is due.
class PlayTimers {
 public:
    static constexpr int kEndDelay = 1200;    // ms from the noticed to the handled end of a song
    static constexpr int kOutputLook = 5000;  // ms between two looks for an output that is lost

    struct Handlers {
        std::function<void()> Tick;
        std::function<void()> EndOfSong;
        std::function<void()> AutoStop;
        std::function<void()> Output;
    };

    explicit PlayTimers(Handlers handlers);

    // Each starts anew when it runs already. Milliseconds.
    void StartTicks(int interval);
    void StartEnd();
    void StartAutoStop(int delay);
    void StartOutput();
    void StopTicks() { ticks_.Stop(); }
    void StopEnd() { end_.Stop(); }
    void StopAutoStop() { autoStop_.Stop(); }
    void StopAll();

    // Whether ticks have ever been started.
    bool TicksExist() const { return ticks_.Exists(); }
    bool Ticking() const { return ticks_.Running(); }
    bool EndPending() const { return end_.Running(); }
    bool AutoStopPending() const { return autoStop_.Running(); }
    bool OutputPending() const { return output_.Running(); }

    // Calls the handlers of those whose time has come by the engine's clock.
    void RunDue();

 private:
    class Timer {
     public:
        enum class Kind { Periodic, OneShot };

        Timer(Kind kind, std::function<void()> handler) : kind_(kind), handler_(std::move(handler)) {}
        void Start(int delay);
        void Stop();
        bool Exists() const { return timer_ != nullptr; }
        bool Running() const { return due_.has_value(); }
        void RunWhenDue();

     private:
        void Fire();

        Kind kind_;
        std::function<void()> handler_;
        std::unique_ptr<QTimer> timer_;
        std::optional<qint64> due_;  // ticks of the clock
        int delay_ = 0;
    };

    Timer ticks_;
    Timer end_;
    Timer autoStop_;
    Timer output_;
};
