#pragma once

#include <QStringList>
#include <QTimer>
#include <deque>
#include <functional>

// What later starts of the program have handed over, until the program can act on it: not while it starts
// itself, a long operation goes or a dialog is open.
class StartRequests {
 public:
    StartRequests();
    StartRequests(const StartRequests&) = delete;
    StartRequests& operator=(const StartRequests&) = delete;

    std::function<bool()> IsReady;
    std::function<void(const QStringList& arguments)> Act;

    void Add(const QStringList& arguments);
    // Acts on what is waiting if it can be done now.
    void Work();

 private:
    std::deque<QStringList> waiting_;
    QTimer timer_;
};
