#pragma once

#include <QTimer>
#include <functional>
#include <map>
#include <memory>
#include <vector>

#include "MusicManagment/playback/mci/MciInterface.h"

class GstPlayer;
using GstElement = struct _GstElement;

enum class MciSound {
    Audible,
    Silent,  // in real time all the same
};

// Silent when the environment variable TUNESTEAD_AUDIO says "null".
MciSound MciSoundOfEnvironment();

// Makes what the sound goes to; nullptr when that cannot be.
using MciSinkMaker = std::function<GstElement*()>;

// The media control interface on GStreamer: a device is a player of its own, with its own way to the
// loudspeaker.
class GstMci : public MciInterface {
 public:
    explicit GstMci(MciSound sound = MciSoundOfEnvironment());
    explicit GstMci(MciSinkMaker makeSink);
    // Waits until what is still leaving has become silent, a second at most.
    ~GstMci() override;

    // Whether GStreamer has a part that is needed for playing, as "playbin" or "wavparse".
    static bool HasPart(const char* name);

    quint32 SendCommand(quint32 device, MciCommand command, quint32 flags,
                        MciParameters& parameters) override;
    QString ErrorString(quint32 error) override;

 private:
    quint32 Open(MciParameters& parameters);
    quint32 Close(quint32 device);
    void DropSilent();
    void AwaitSilence();
    static QString Carry(GstPlayer& device, MciCommand command, quint32 flags, MciParameters& parameters);
    static quint32 ErrorOf(const GstPlayer& device);
    // Keeps the text for ErrorString; an empty one is no error.
    quint32 Result(const QString& text, quint32 error = kMciErrorInternal);

    const MciSinkMaker makeSink_;
    std::map<quint32, std::unique_ptr<GstPlayer>> devices_;
    std::vector<std::unique_ptr<GstPlayer>> leaving_;  // closed, and gliding into silence
    QTimer timer_;
    quint32 lastDevice_ = 0;
    quint32 lastError_ = 0;
    QString lastErrorText_;
};
