#pragma once

#include <QString>
#include <QStringList>

// SDL has one audio driver for the whole process, and starting another one would close every open device.
// Whoever wants devices keeps one of these; the driver ends with the last of them. The main thread only.
class SdlAudio {
 public:
    SdlAudio() = default;
    ~SdlAudio() { Release(); }
    SdlAudio(const SdlAudio&) = delete;
    SdlAudio& operator=(const SdlAudio&) = delete;

    // False when the driver is not to be had, or another one is in use by somebody else.
    bool Acquire(const QString& driver);
    void Release();

 private:
    bool held_ = false;
};

// SDL's names of the drivers that lead to a loudspeaker on this kind of system, the one to try first in
// front.
QStringList UsualSdlDrivers();
