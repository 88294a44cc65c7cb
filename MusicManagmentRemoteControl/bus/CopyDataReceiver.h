#pragma once

#include <QDBusConnection>
#include <QObject>
#include <optional>

// Takes what the remote control sends to this program alone.
class CopyDataReceiver : public QObject {
    Q_OBJECT

 public:
    explicit CopyDataReceiver(QDBusConnection bus);

    // What has come since the last call, with the code that it must have; nothing when nothing has.
    std::optional<QByteArray> Take(quint32 code);

 public Q_SLOTS:
    void Receive(uint window, uint code, const QByteArray& bytes);

 private:
    quint32 code_ = 0;
    std::optional<QByteArray> bytes_;
};
