#pragma once

#include <QDBusConnection>
#include <QDBusObjectPath>
#include <QObject>

// Keeps the system from falling asleep by itself while a song plays. Asks the desktop's portal, see
// https://flatpak.github.io/xdg-desktop-portal/docs/doc-org.freedesktop.portal.Inhibit.html; without one
// nobody is asked.
class StayAwake : public QObject {
 public:
    explicit StayAwake(QDBusConnection bus) : bus_(std::move(bus)) {}
    ~StayAwake() override;

    void SetPlaying(bool playing);

 private:
    void Ask();
    void Release();

    QDBusConnection bus_;
    bool playing_ = false;
    bool asking_ = false;      // the answer is on its way
    QDBusObjectPath request_;  // what was granted; empty for nothing
};
