#pragma once

#include <QObject>
#include <QString>

// What a player is doing.
enum TPSStatus : quint8 { psClosed, psPaused, psPlaying, psStopped, psOpening, psSeeking };

// One song in one sound engine. A back end belongs to one file: it gets its name, is opened, played and
// closed.
class TPlaySoundContainer : public QObject {
 public:
    using QObject::QObject;

    const QString& BackendFile() const { return backendFile_; }
    void SetBackendFile(const QString& path) { backendFile_ = path; }

    // All of them throw the exception of the engine when it refuses.

    // Prepares the file for playing.
    virtual void Open() = 0;
    // Gives back the file and everything else that this song holds.
    virtual void Close() = 0;
    // Starts, or goes on when paused.
    virtual void Play() = 0;
    // Stops; the position goes back to the start.
    virtual void Stop() = 0;
    // Pauses when playing, goes on when paused.
    virtual void PauseResume() = 0;
    virtual quint32 GetPosition() = 0;  // milliseconds
    virtual void SetPosition(quint32 milliseconds) = 0;
    virtual quint32 GetLength() = 0;  // milliseconds
    virtual TPSStatus GetStatus() = 0;

 private:
    QString backendFile_;
};
