#include "MusicManagment/playback/mci/GstMci.h"

#include <gst/gst.h>

#include <QDir>
#include <algorithm>
#include <limits>
#include <optional>

#include "MusicManagment/playback/mci/MediaAddress.h"

using namespace Qt::StringLiterals;

namespace {

constexpr GstClockTime kOpenTimeout = 5 * GST_SECOND;
constexpr GstClockTime kSeekTimeout = GST_SECOND;

template <typename T>
struct Unref {
    void operator()(T* object) const { gst_object_unref(object); }
};
struct UnrefMessage {
    void operator()(GstMessage* message) const { gst_message_unref(message); }
};
using Element = std::unique_ptr<GstElement, Unref<GstElement>>;
using Bus = std::unique_ptr<GstBus, Unref<GstBus>>;
using Message = std::unique_ptr<GstMessage, UnrefMessage>;

quint32 ToMilliseconds(gint64 nanoseconds) {
    const gint64 milliseconds = std::max<gint64>(nanoseconds, 0) / static_cast<gint64>(GST_MSECOND);
    return static_cast<quint32>(std::min<gint64>(milliseconds, std::numeric_limits<quint32>::max()));
}

QString ErrorText(GstMessage* message) {
    GError* error = nullptr;
    gst_message_parse_error(message, &error, nullptr);
    QString text = QString::fromUtf8(error->message);
    g_error_free(error);
    return text;
}

// A sink that keeps time and lets nothing be heard or seen.
GstElement* MakeSilentSink() {
    GstElement* sink = gst_element_factory_make("fakesink", nullptr);
    if (sink != nullptr) g_object_set(sink, "sync", TRUE, nullptr);
    return sink;
}

GstElement* MakeAudioSink(MciSound sound) {
    return sound == MciSound::Silent ? MakeSilentSink() : gst_element_factory_make("autoaudiosink", nullptr);
}

// Without a sound server the automatic choice quietly becomes a sink that it calls so.
bool PlaysToNobody(GstElement* sink) {
    if (!GST_IS_BIN(sink)) return false;
    const Element silent(gst_bin_get_by_name(GST_BIN(sink), "fake-audio-sink"));
    return silent != nullptr;
}

}  // namespace

// One file and its player.
class GstMci::Device {
 public:
    ~Device() {
        if (player_) gst_element_set_state(player_.get(), GST_STATE_NULL);
    }

    // Each returns the text of an error, empty for none.
    QString Open(const QString& path, MciSound sound);
    QString Play();
    QString Stop();
    QString Pause();
    QString Seek(quint32 milliseconds);
    QString Status(quint32 item, quint32& value);
    QString SetAudio(quint32 item, quint32 value);

 private:
    void ReadMessages();
    QString SetState(GstState state);
    quint32 Length();
    quint32 Position();
    quint32 Mode() const;

    Element player_;
    Bus bus_;
    QString failure_;
    bool stopped_ = true;  // the player itself knows only playing and paused
    bool atEnd_ = false;
    bool playing_ = false;
};

QString GstMci::Device::Open(const QString& path, MciSound sound) {
    GstElement* player = gst_element_factory_make("playbin", nullptr);
    if (player == nullptr) return u"GStreamer hat kein \"playbin\"."_s;
    player_.reset(GST_ELEMENT(gst_object_ref_sink(player)));
    bus_.reset(gst_element_get_bus(player));
    GstElement* audio = MakeAudioSink(sound);
    GstElement* video = MakeSilentSink();
    if (audio == nullptr || video == nullptr) return u"GStreamer hat keine Ausgabe."_s;
    const QByteArray uri = MediaAddress(path);
    g_object_set(player, "uri", uri.constData(), "audio-sink", audio, "video-sink", video, nullptr);

    // Whether a file can be played shows when its beginning has been decoded.
    gst_element_set_state(player, GST_STATE_PAUSED);
    const auto result = gst_element_get_state(player, nullptr, nullptr, kOpenTimeout);
    ReadMessages();
    if (!failure_.isEmpty()) return failure_;
    if (PlaysToNobody(audio)) return u"Es gibt keine Tonausgabe."_s;
    if (result == GST_STATE_CHANGE_ASYNC) return u"Zeitüberschreitung beim Öffnen der Datei."_s;
    return result == GST_STATE_CHANGE_FAILURE ? u"Die Datei kann nicht abgespielt werden."_s : QString();
}

QString GstMci::Device::Play() {
    if (atEnd_) {
        QString error = Seek(0);
        if (!error.isEmpty()) return error;
    }
    stopped_ = false;
    playing_ = true;
    return SetState(GST_STATE_PLAYING);
}

QString GstMci::Device::Stop() {
    stopped_ = true;
    playing_ = false;
    return SetState(GST_STATE_PAUSED);
}

QString GstMci::Device::Pause() {
    playing_ = false;
    return SetState(GST_STATE_PAUSED);
}

// Exact: without the flag a file of variable bit rate is missed by seconds.
QString GstMci::Device::Seek(quint32 milliseconds) {
    const auto flags = static_cast<GstSeekFlags>(GST_SEEK_FLAG_FLUSH | GST_SEEK_FLAG_ACCURATE);
    const auto target = static_cast<gint64>(milliseconds * GST_MSECOND);
    ReadMessages();
    atEnd_ = false;  // an end that comes from now on belongs to the new position
    if (!gst_element_seek_simple(player_.get(), GST_FORMAT_TIME, flags, target))
        return u"In der Datei kann nicht gesucht werden."_s;
    gst_element_get_state(player_.get(), nullptr, nullptr, kSeekTimeout);
    ReadMessages();
    return failure_;
}

QString GstMci::Device::Status(quint32 item, quint32& value) {
    ReadMessages();
    if (item == kMciStatusLength)
        value = Length();
    else if (item == kMciStatusPosition)
        value = Position();
    else
        value = Mode();
    return failure_;
}

QString GstMci::Device::SetAudio(quint32 item, quint32 value) {
    if (item != kMciAudioVolume || value > kMciFullVolume) return u"Unbekannte Einstellung."_s;
    g_object_set(player_.get(), "volume", static_cast<double>(value) / kMciFullVolume, nullptr);
    return {};
}

void GstMci::Device::ReadMessages() {
    const auto wanted = static_cast<GstMessageType>(GST_MESSAGE_ERROR | GST_MESSAGE_EOS);
    while (const Message message{gst_bus_pop_filtered(bus_.get(), wanted)}) {
        if (GST_MESSAGE_TYPE(message.get()) == GST_MESSAGE_EOS)
            atEnd_ = true;
        else if (failure_.isEmpty())
            failure_ = ErrorText(message.get());
    }
}

QString GstMci::Device::SetState(GstState state) {
    const auto result = gst_element_set_state(player_.get(), state);
    ReadMessages();
    if (!failure_.isEmpty()) return failure_;
    return result == GST_STATE_CHANGE_FAILURE ? u"Die Wiedergabe ist nicht möglich."_s : QString();
}

// Some files do not tell their length before they have been played for a moment; 0 until then. At the end it
// is what has been played, so that a wrong estimate does not keep the song from ending.
quint32 GstMci::Device::Length() {
    if (atEnd_) return Position();
    gint64 length = 0;
    const bool known = gst_element_query_duration(player_.get(), GST_FORMAT_TIME, &length);
    return known ? ToMilliseconds(length) : 0;
}

quint32 GstMci::Device::Position() {
    gint64 position = 0;
    const bool known = gst_element_query_position(player_.get(), GST_FORMAT_TIME, &position);
    return known ? ToMilliseconds(position) : 0;
}

quint32 GstMci::Device::Mode() const {
    if (stopped_ || atEnd_) return kMciModeStop;
    return playing_ ? kMciModePlay : kMciModePause;
}

// --- The interface ---

MciSound MciSoundOfEnvironment() {
    return qEnvironmentVariable("TUNESTEAD_AUDIO") == u"null"_s ? MciSound::Silent : MciSound::Audible;
}

GstMci::GstMci(MciSound sound) : sound_(sound) {}
GstMci::~GstMci() = default;

bool GstMci::HasPart(const char* name) {
    if (!gst_init_check(nullptr, nullptr, nullptr)) return false;
    GstElementFactory* factory = gst_element_factory_find(name);
    if (factory != nullptr) gst_object_unref(factory);
    return factory != nullptr;
}

quint32 GstMci::Result(const QString& text) {
    if (text.isEmpty()) return 0;
    lastErrorText_ = text;
    return ++lastError_;
}

QString GstMci::ErrorString(quint32 error) {
    return error == lastError_ ? lastErrorText_ : u"Unbekannter Fehler %1"_s.arg(error);
}

quint32 GstMci::Open(MciParameters& parameters) {
    GError* error = nullptr;
    if (!gst_init_check(nullptr, nullptr, &error)) {
        const QString text = error != nullptr ? QString::fromUtf8(error->message) : u"GStreamer"_s;
        g_clear_error(&error);
        return Result(text);
    }
    auto device = std::make_unique<Device>();
    const QString text = device->Open(QDir::current().absoluteFilePath(parameters.Element), sound_);
    if (!text.isEmpty()) return Result(text);
    parameters.Device = ++lastDevice_;
    devices_[parameters.Device] = std::move(device);
    return 0;
}

quint32 GstMci::SendCommand(quint32 device, MciCommand command, quint32 flags, MciParameters& parameters) {
    if (command == MciCommand::Open) return Open(parameters);
    const auto found = devices_.find(device);
    if (found == devices_.end()) return Result(u"Es ist kein Gerät geöffnet."_s);
    Device& opened = *found->second;
    switch (command) {
        case MciCommand::Close:
            devices_.erase(found);
            return 0;
        case MciCommand::Play:
            return Result(opened.Play());
        case MciCommand::Stop:
            return Result(opened.Stop());
        case MciCommand::Pause:
            return Result(opened.Pause());
        case MciCommand::Seek:
            return Result(opened.Seek(flags == kMciSeekToStart ? 0 : parameters.To));
        case MciCommand::Status:
            return Result(opened.Status(parameters.Item, parameters.Value));
        case MciCommand::SetAudio:
            return Result(opened.SetAudio(parameters.Item, parameters.Value));
        case MciCommand::Set:  // times are milliseconds anyway
        case MciCommand::Open:
            return 0;
    }
    return Result(u"Unbekanntes Kommando."_s);
}
