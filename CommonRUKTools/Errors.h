#pragma once

#include <QByteArray>
#include <QString>
#include <exception>
#include <utility>

// Base of all exceptions of the engine: carries a German message that is shown to the user as it stands.
class ERukException : public std::exception {
 public:
    explicit ERukException(QString message) : message_(std::move(message)), utf8_(message_.toUtf8()) {}

    const QString& Message() const noexcept { return message_; }
    const char* what() const noexcept override { return utf8_.constData(); }

 private:
    QString message_;
    QByteArray utf8_;
};

// A file could not be opened, read or written.
class EStreamError : public ERukException {
 public:
    using ERukException::ERukException;
};

// The medium itself failed (disk, network drive, removed stick), as opposed to a file whose contents end
// early.
class EMediumError : public EStreamError {
 public:
    using EStreamError::EStreamError;
};

// Ends the running command without a message: the user has been told already, or chose to stop.
class EAbort : public ERukException {
 public:
    EAbort() : ERukException(QString()) {}
};
