#include "MusicManagment/playback/mci/GstPlayer.h"

#include <gst/gst.h>

#include <algorithm>
#include <limits>
#include <utility>

#include "MusicManagment/playback/backend/SoundLimits.h"
#include "MusicManagment/playback/mci/MediaAddress.h"
#include "MusicManagment/playback/mci/TrustedElements.h"

using namespace Qt::StringLiterals;

namespace {

constexpr GstClockTime kOpenTimeout = 5 * GST_SECOND;
constexpr GstClockTime kSeekTimeout = GST_SECOND;
constexpr gint64 kDeviceBuffer = 100'000;  // us
constexpr int kLookAtFadeEvery = 10;       // ms
constexpr int kLongestFade = 1000;         // ms

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

}  // namespace

GstElement* MakeSilentSink() {
    GstElement* sink = gst_element_factory_make("fakesink", nullptr);
    if (sink != nullptr) g_object_set(sink, "sync", TRUE, nullptr);
    return sink;
}

GstElement* MakeAudibleSink() {
    return gst_element_factory_make("autoaudiosink", nullptr);
}

namespace {

// Stands in front of the resampler, which would work for seconds on a rate that no sound has.
GstElement* MakeLimits() {
    GstElement* filter = gst_element_factory_make("capsfilter", nullptr);
    if (filter == nullptr) return nullptr;
    GstCaps* caps =
        gst_caps_new_simple("audio/x-raw", "rate", GST_TYPE_INT_RANGE, kLowestSoundRate, kHighestSoundRate,
                            "channels", GST_TYPE_INT_RANGE, 1, kMostSoundChannels, nullptr);
    g_object_set(filter, "caps", caps, nullptr);
    gst_caps_unref(caps);
    return filter;
}

// What waits in a device is heard before anything that is changed; GStreamer would let 200 ms wait.
void ShortenBuffer(GstElement*, GstElement* element, gpointer) {
    const bool isSink = GST_OBJECT_FLAG_IS_SET(element, GST_ELEMENT_FLAG_SINK);
    if (isSink && g_object_class_find_property(G_OBJECT_GET_CLASS(element), "buffer-time") != nullptr)
        g_object_set(element, "buffer-time", kDeviceBuffer, nullptr);
}

// Without a sound server the automatic choice quietly becomes a sink that it calls so.
bool PlaysToNobody(GstElement* sink) {
    if (!GST_IS_BIN(sink)) return false;
    GstElement* silent = gst_bin_get_by_name(GST_BIN(sink), "fake-audio-sink");
    if (silent != nullptr) gst_object_unref(silent);
    return silent != nullptr;
}

}  // namespace

void GstPlayer::Unref::operator()(GstElement* element) const {
    gst_element_set_state(element, GST_STATE_NULL);
    gst_object_unref(element);
}

void GstPlayer::Unref::operator()(GstBus* bus) const {
    gst_object_unref(bus);
}

void GstPlayer::Unref::operator()(GstMessage* message) const {
    gst_message_unref(message);
}

GstPlayer::GstPlayer(QString path, MciSinkMaker makeSink)
    : path_(std::move(path)), makeSink_(std::move(makeSink)) {
    timer_.setInterval(kLookAtFadeEvery);
    QObject::connect(&timer_, &QTimer::timeout, &timer_, [this] { LookAtFade(); });
}

GstPlayer::~GstPlayer() = default;

QString GstPlayer::Open() {
    failure_.clear();
    atEnd_ = false;
    outputLost_ = false;
    runs_ = false;
    fades_ = false;
    timer_.stop();
    goTo_.reset();
    const QString error = MakePlayer();
    return error.isEmpty() ? Preroll() : error;
}

QString GstPlayer::MakePlayer() {
    GstElement* player = gst_element_factory_make("playbin", nullptr);
    if (player == nullptr) return u"GStreamer hat kein \"playbin\"."_s;
    player_.reset(GST_ELEMENT(gst_object_ref_sink(player)));
    bus_.reset(gst_element_get_bus(player));
    sink_ = makeSink_();
    GstElement* video = MakeSilentSink();
    filter_ = std::make_unique<GlideFilter>(volume_);
    GstElement* audio = filter_->Make(sink_);
    GstElement* limits = MakeLimits();
    if (audio == nullptr || video == nullptr || limits == nullptr) return u"GStreamer hat keine Ausgabe."_s;
    const QByteArray uri = MediaAddress(path_);
    g_object_set(player, "uri", uri.constData(), "audio-sink", audio, "video-sink", video, "audio-filter",
                 limits, nullptr);
    g_signal_connect(player, "element-setup", G_CALLBACK(ShortenBuffer), nullptr);
    KeepToTrustedElements(player);
    return {};
}

// Whether a file can be played shows when its beginning has been decoded.
QString GstPlayer::Preroll() {
    const auto change = gst_element_set_state(player_.get(), GST_STATE_PAUSED);
    if (change == GST_STATE_CHANGE_ASYNC) {
        const auto wanted = static_cast<GstMessageType>(GST_MESSAGE_ERROR | GST_MESSAGE_ASYNC_DONE);
        const Message message(gst_bus_timed_pop_filtered(bus_.get(), kOpenTimeout, wanted));
        if (message == nullptr) return u"Zeitüberschreitung beim Öffnen der Datei."_s;
        Note(message.get());
    }
    ReadMessages();
    if (outputLost_ || PlaysToNobody(sink_)) return LoseOutput();
    if (!failure_.isEmpty()) return failure_;
    // What fails while a decoder is being put in place GStreamer sometimes forgets to tell.
    const bool fails = change == GST_STATE_CHANGE_FAILURE || filter_->IsEmpty();
    return fails ? u"Die Datei kann nicht abgespielt werden."_s : QString();
}

QString GstPlayer::LoseOutput() {
    outputLost_ = true;
    return u"Es gibt keine Tonausgabe."_s;
}

QString GstPlayer::Play() {
    ReadMessages();
    if (outputLost_) {
        const quint32 position = position_;
        QString error = Open();
        if (error.isEmpty() && position > 0) error = Go(position);
        if (!error.isEmpty()) {
            position_ = position;
            return error;
        }
    }
    if (atEnd_ && !goTo_) goTo_ = 0;
    stopped_ = false;
    playing_ = true;
    return fades_ ? QString() : GoOn();
}

QString GstPlayer::Stop() {
    stopped_ = true;
    return Pause();
}

QString GstPlayer::Pause() {
    playing_ = false;
    return AfterFade();
}

QString GstPlayer::Seek(quint32 milliseconds) {
    ReadMessages();
    position_ = milliseconds;
    if (outputLost_) return {};
    goTo_ = milliseconds;
    return AfterFade();
}

void GstPlayer::Leave() {
    playing_ = false;
    AfterFade();
    timer_.stop();
}

bool GstPlayer::IsSilent() {
    return !fades_ || FadeIsOver();
}

// Does what has been asked for, when nothing sounds any more.
QString GstPlayer::AfterFade() {
    if (fades_ || outputLost_) return {};
    if (!runs_ || atEnd_) return GoOn();
    fades_ = true;
    filter_->FadeOut();
    latest_.setRemainingTime(kLongestFade, Qt::PreciseTimer);
    timer_.start();
    return {};
}

bool GstPlayer::FadeIsOver() {
    ReadMessages();
    return outputLost_ || atEnd_ || latest_.hasExpired() ||
           filter_->IsSilentAt(gst_element_get_current_running_time(player_.get()));
}

void GstPlayer::LookAtFade() {
    if (!fades_ || !FadeIsOver()) return;
    fades_ = false;
    timer_.stop();
    const QString error = GoOn();
    if (failure_.isEmpty() && !outputLost_) failure_ = error;
}

QString GstPlayer::GoOn() {
    if (outputLost_) return {};
    QString error;
    if (!playing_ && runs_) error = Halt();
    if (error.isEmpty() && goTo_) error = Go(*std::exchange(goTo_, std::nullopt));
    if (!error.isEmpty() || !playing_) return error;
    filter_->FadeIn();
    runs_ = true;
    return SetState(GST_STATE_PLAYING);
}

QString GstPlayer::Halt() {
    QString error = SetState(GST_STATE_PAUSED);
    if (!error.isEmpty()) return error;
    runs_ = false;
    // What has passed in silence is to be heard later. Of a file that cannot go back it is lost.
    const std::optional<quint32> faded = filter_->FadedFrom();
    if (!goTo_ && !atEnd_ && faded) Go(*faded);
    return failure_;
}

// Exact: without the flag a file of variable bit rate is missed by seconds.
QString GstPlayer::Go(quint32 milliseconds) {
    const auto flags = static_cast<GstSeekFlags>(GST_SEEK_FLAG_FLUSH | GST_SEEK_FLAG_ACCURATE);
    const auto target = static_cast<gint64>(milliseconds * GST_MSECOND);
    position_ = milliseconds;
    atEnd_ = false;  // an end that comes from now on belongs to the new position
    if (!gst_element_seek_simple(player_.get(), GST_FORMAT_TIME, flags, target))
        return u"In der Datei kann nicht gesucht werden."_s;
    gst_element_get_state(player_.get(), nullptr, nullptr, kSeekTimeout);
    ReadMessages();
    return failure_;
}

QString GstPlayer::Status(quint32 item, quint32& value) {
    ReadMessages();
    LookAtFade();  // an end that has come meanwhile is not that of a song that is to go on elsewhere
    if (item == kMciStatusLength)
        value = Length();
    else if (item == kMciStatusPosition)
        value = Position();
    else
        value = Mode();
    return outputLost_ && playing_ && item == kMciStatusMode ? LoseOutput() : failure_;
}

QString GstPlayer::SetAudio(quint32 item, quint32 value) {
    if (item != kMciAudioVolume || value > kMciFullVolume) return u"Unbekannte Einstellung."_s;
    volume_ = static_cast<float>(value) / kMciFullVolume;
    filter_->SetGain(volume_);
    return {};
}

void GstPlayer::ReadMessages() {
    const auto wanted = static_cast<GstMessageType>(GST_MESSAGE_ERROR | GST_MESSAGE_EOS);
    while (const Message message{gst_bus_pop_filtered(bus_.get(), wanted)})
        Note(message.get());
}

// What the sink complains of says nothing of the file, nor does what follows from it.
void GstPlayer::Note(GstMessage* message) {
    if (GST_MESSAGE_TYPE(message) == GST_MESSAGE_EOS) atEnd_ = true;
    if (GST_MESSAGE_TYPE(message) != GST_MESSAGE_ERROR || outputLost_) return;
    GstObject* source = GST_MESSAGE_SRC(message);
    outputLost_ =
        source == GST_OBJECT(sink_) || gst_object_has_as_ancestor(source, GST_OBJECT(sink_)) != FALSE;
    if (!outputLost_ && failure_.isEmpty()) failure_ = ErrorText(message);
}

QString GstPlayer::SetState(int state) {
    const auto result = gst_element_set_state(player_.get(), static_cast<GstState>(state));
    ReadMessages();
    if (outputLost_) return LoseOutput();
    if (!failure_.isEmpty()) return failure_;
    return result == GST_STATE_CHANGE_FAILURE ? u"Die Wiedergabe ist nicht möglich."_s : QString();
}

// Some files do not tell their length before they have been played for a moment; 0 until then. At the end it
// is what has been played, so that a wrong estimate does not keep the song from ending.
quint32 GstPlayer::Length() {
    if (atEnd_) return Position();
    gint64 length = 0;
    if (!outputLost_ && gst_element_query_duration(player_.get(), GST_FORMAT_TIME, &length))
        length_ = ToMilliseconds(length);
    return length_;
}

quint32 GstPlayer::Position() {
    gint64 position = 0;
    if (!outputLost_ && !goTo_ && gst_element_query_position(player_.get(), GST_FORMAT_TIME, &position))
        position_ = ToMilliseconds(position);
    return position_;
}

quint32 GstPlayer::Mode() const {
    if (stopped_ || atEnd_) return kMciModeStop;
    return playing_ ? kMciModePlay : kMciModePause;
}
