#pragma once

#include <QDeadlineTimer>
#include <QString>
#include <QTimer>
#include <memory>
#include <optional>

#include "MusicManagment/playback/mci/GlideFilter.h"
#include "MusicManagment/playback/mci/GstMci.h"

using GstBus = struct _GstBus;
using GstElement = struct _GstElement;
using GstMessage = struct _GstMessage;

// A sink that keeps time and lets nothing be heard or seen.
GstElement* MakeSilentSink();
// Whatever leads to a loudspeaker here.
GstElement* MakeAudibleSink();

// One file and its player. What can fail returns the text of the error, empty for none.
//
// Nothing that is asked for cuts off what sounds: it glides into silence, and when that has come through the
// buffers of the device (some tenths of a second at most, nobody waits for it) the player does what it was
// asked for last. Whoever asks for the status is told so at once.
class GstPlayer {
 public:
    GstPlayer(QString path, MciSinkMaker makeSink);
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

    // Glides into silence, to be destroyed when that has come.
    void Leave();
    bool IsSilent();

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
    QString AfterFade();
    bool FadeIsOver();
    void LookAtFade();
    QString GoOn();
    QString Halt();
    QString Go(quint32 milliseconds);
    QString SetState(int state);
    quint32 Length();
    quint32 Position();
    quint32 Mode() const;

    const QString path_;
    const MciSinkMaker makeSink_;
    std::unique_ptr<GlideFilter> filter_;  // the player's
    std::unique_ptr<GstElement, Unref> player_;
    std::unique_ptr<GstBus, Unref> bus_;
    GstElement* sink_ = nullptr;  // the player's
    QString failure_;
    float volume_ = 1;
    quint32 position_ = 0;  // ms, as told last
    quint32 length_ = 0;
    bool stopped_ = true;  // the player itself knows only playing and paused
    bool atEnd_ = false;
    bool playing_ = false;
    bool outputLost_ = false;

    // What the player still has to do.
    std::optional<quint32> goTo_;  // ms
    bool runs_ = false;            // it is in the state of playing
    bool fades_ = false;
    QDeadlineTimer latest_;  // for a device that takes nothing
    QTimer timer_;
};
