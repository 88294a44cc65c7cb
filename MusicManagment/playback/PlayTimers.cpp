#include "MusicManagment/playback/PlayTimers.h"

#include <utility>

#include "CommonRUKTools/Clock.h"

PlayTimers::PlayTimers(Handlers handlers)
    : ticks_(Timer::Kind::Periodic, std::move(handlers.Tick)),
      end_(Timer::Kind::OneShot, std::move(handlers.EndOfSong)),
      autoStop_(Timer::Kind::OneShot, std::move(handlers.AutoStop)),
      output_(Timer::Kind::OneShot, std::move(handlers.Output)) {}

void PlayTimers::StartTicks(int interval) {
    ticks_.Start(interval);
}

void PlayTimers::StartEnd() {
    end_.Start(kEndDelay);
}

void PlayTimers::StartAutoStop(int delay) {
    autoStop_.Start(delay);
}

void PlayTimers::StartOutput() {
    output_.Start(kOutputLook);
}

void PlayTimers::StopAll() {
    ticks_.Stop();
    end_.Stop();
    autoStop_.Stop();
    output_.Stop();
}

void PlayTimers::RunDue() {
    ticks_.RunWhenDue();
    end_.RunWhenDue();
    autoStop_.RunWhenDue();
    output_.RunWhenDue();
}

void PlayTimers::Timer::Start(int delay) {
    if (!timer_) {
        timer_ = std::make_unique<QTimer>();
        // A coarse timer may be early by a twentieth.
        timer_->setTimerType(Qt::PreciseTimer);
        timer_->setSingleShot(kind_ == Kind::OneShot);
        QObject::connect(timer_.get(), &QTimer::timeout, [this] { Fire(); });
    }
    delay_ = delay;
    due_ = CurrentClock().Ticks() + delay;
    timer_->start(delay);
}

void PlayTimers::Timer::Stop() {
    if (timer_) timer_->stop();
    due_.reset();
}

void PlayTimers::Timer::RunWhenDue() {
    if (due_ && CurrentClock().Ticks() >= *due_) Fire();
}

void PlayTimers::Timer::Fire() {
    if (kind_ == Kind::OneShot)
        Stop();
    else
        due_ = CurrentClock().Ticks() + delay_;
    handler_();
}
