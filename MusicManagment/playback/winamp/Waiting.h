#pragma once

#include <QDBusMessage>
#include <QDBusPendingCall>
#include <functional>

// Waiting that keeps the interface painted and timers running, but takes no input: whoever waits must expect
// to be asked, or destroyed, meanwhile.

// Waits until the condition holds; false when the time (milliseconds) was over before. It is looked at
// several times a second.
bool WaitUntil(const std::function<bool()>& condition, int milliseconds);

// The answer to a call; an error message when there was none in time.
QDBusMessage WaitForAnswer(const QDBusPendingCall& call, int milliseconds);
