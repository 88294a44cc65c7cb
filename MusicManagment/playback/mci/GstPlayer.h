#pragma once

#include <QString>
#include <memory>

#include "MusicManagment/playback/mci/GstMci.h"

using GstBus = struct _GstBus;
using GstElement = struct _GstElement;
using GstMessage = struct _GstMessage;

// One file and its player. What can fail returns the text of the error, empty for none.
class GstPlayer {
 public:
    GstPlayer(QString path, MciSound sound) : path_(std::move(path)), sound_(sound) {}
    ~GstPlayer();
    GstPlayer(const GstPlayer&) = delete;
    GstPlayer& operator=(const GstPlayer&) = delete;

    QString Open();
    // Goes on where it was, also in a new player when the output of the old one has been lost.
    QString Play();
    QString Stop();
    QString Pause();
    QString Seek(quint32 milliseconds);
    // An item of Status and its value. A lost output is an error of the mode only, and only while it plays.
    QString Status(quint32 item, quint32& value);
    QString SetAudio(quint32 item, quint32 value);

    // The last error was one of the way to the loudspeaker. Until Play succeeds the player stays where it
    // was.
    bool OutputLost() const { return outputLost_; }

 private:
    struct Unref {
        void operator()(GstElement* element) const;
        void operator()(GstBus* bus) const;
        void operator()(GstMessage* message) const;
    };
    using Message = std::unique_ptr<GstMessage, Unref>;

    QString MakePlayer();
    QString Preroll();
    QString LoseOutput();
    void ReadMessages();
    void Note(GstMessage* message);
    QString SetState(int state);
    quint32 Length();
    quint32 Position();
    quint32 Mode() const;

    const QString path_;
    const MciSound sound_;
    std::unique_ptr<GstElement, Unref> player_;
    std::unique_ptr<GstBus, Unref> bus_;
    GstElement* sink_ = nullptr;  // the player's
    QString failure_;
    double volume_ = 1;
    quint32 position_ = 0;  // ms, as told last
    quint32 length_ = 0;
    bool stopped_ = true;  // the player itself knows only playing and paused
    bool atEnd_ = false;
    bool playing_ = false;
    bool outputLost_ = false;
};
