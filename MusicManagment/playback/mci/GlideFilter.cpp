#include "MusicManagment/playback/mci/GlideFilter.h"

#include <gst/gst.h>

#include <algorithm>
#include <atomic>
#include <span>

#include "MusicManagment/playback/backend/Glide.h"

namespace {

constexpr GstClockTime kUnknown = GST_CLOCK_TIME_NONE;

// Floats of the machine's own byte order.
GstCaps* FloatCaps() {
    return gst_caps_new_simple("audio/x-raw", "format", G_TYPE_STRING,
                               G_BYTE_ORDER == G_LITTLE_ENDIAN ? "F32LE" : "F32BE", "layout", G_TYPE_STRING,
                               "interleaved", nullptr);
}

}  // namespace

struct GlideFilter::State {
    explicit State(float startGain) : gain(startGain) {}

    std::atomic<float> gain;
    std::atomic<bool> out{false};
    // In nanoseconds; set by the player's thread when it does what `out` asks for.
    std::atomic<GstClockTime> silentFrom{kUnknown};  // running time
    std::atomic<GstClockTime> fadedFrom{kUnknown};   // in the song

    std::atomic<bool> empty{false};

    // The player's thread only.
    Glide level;
    bool fresh = true;  // nothing has sounded yet, so there is nothing to glide from
    int rate = 44100;
    std::size_t channels = 1;
    GstSegment segment{};

    static GstPadProbeReturn Pass(GstPad*, GstPadProbeInfo* info, gpointer self);
    void Note(GstEvent* event);
    void ComeOutOfSilence();
    void NoteFormat(GstEvent* event);
    void Change(GstBuffer* buffer);
    std::size_t Apply(std::span<float> samples);
};

GstPadProbeReturn GlideFilter::State::Pass(GstPad*, GstPadProbeInfo* info, gpointer self) {
    State& state = **static_cast<std::shared_ptr<State>*>(self);
    if ((info->type & GST_PAD_PROBE_TYPE_BUFFER) == 0) {
        state.Note(GST_PAD_PROBE_INFO_EVENT(info));
        return GST_PAD_PROBE_OK;
    }
    GstBuffer* buffer = gst_buffer_make_writable(GST_PAD_PROBE_INFO_BUFFER(info));
    GST_PAD_PROBE_INFO_DATA(info) = buffer;
    state.Change(buffer);
    return GST_PAD_PROBE_OK;
}

void GlideFilter::State::Note(GstEvent* event) {
    if (GST_EVENT_TYPE(event) == GST_EVENT_SEGMENT) gst_event_copy_segment(event, &segment);
    if (GST_EVENT_TYPE(event) == GST_EVENT_FLUSH_STOP) ComeOutOfSilence();
    if (GST_EVENT_TYPE(event) == GST_EVENT_CAPS) NoteFormat(event);
    if (GST_EVENT_TYPE(event) == GST_EVENT_EOS && fresh) empty = true;
}

void GlideFilter::State::ComeOutOfSilence() {
    out = false;
    if (!fresh) level.Jump(0);
}

void GlideFilter::State::NoteFormat(GstEvent* event) {
    GstCaps* caps = nullptr;
    gst_event_parse_caps(event, &caps);
    const GstStructure* format = gst_caps_get_structure(caps, 0);
    int count = 1;
    gst_structure_get_int(format, "rate", &rate);
    gst_structure_get_int(format, "channels", &count);
    channels = static_cast<std::size_t>(std::max(count, 1));
}

void GlideFilter::State::Change(GstBuffer* buffer) {
    const bool fades = out.load();
    const float target = fades ? 0 : gain.load();
    fresh ? level.Jump(target) : level.To(target, GlideFrames(rate));
    fresh = false;
    if (fades && fadedFrom.load() == kUnknown)
        fadedFrom = gst_segment_to_stream_time(&segment, GST_FORMAT_TIME, GST_BUFFER_PTS(buffer));
    if (!fades && level.Rests() && level.Now() == 1) return;
    GstMapInfo map;
    if (!gst_buffer_map(buffer, &map, GST_MAP_READWRITE)) return;
    const std::size_t glided = Apply({reinterpret_cast<float*>(map.data), map.size / sizeof(float)});
    gst_buffer_unmap(buffer, &map);
    if (!fades || !level.Rests() || silentFrom.load() != kUnknown) return;
    const GstClockTime start = gst_segment_to_running_time(&segment, GST_FORMAT_TIME, GST_BUFFER_PTS(buffer));
    silentFrom =
        start == kUnknown ? 0 : start + gst_util_uint64_scale(glided, GST_SECOND, static_cast<guint64>(rate));
}

// Returns how many frames passed before the level came to rest.
std::size_t GlideFilter::State::Apply(std::span<float> samples) {
    std::size_t glided = 0;
    for (std::size_t at = 0; at + channels <= samples.size(); at += channels) {
        glided += level.Rests() ? 0 : 1;
        const float frameGain = level.Next();
        for (float& sample : samples.subspan(at, channels))
            sample *= frameGain;
    }
    return glided;
}

GlideFilter::GlideFilter(float gain) : state_(std::make_shared<State>(gain)) {}
GlideFilter::~GlideFilter() = default;

GstElement* GlideFilter::Make(GstElement* sink) {
    GstElement* floats = gst_element_factory_make("capsfilter", nullptr);
    GstElement* convert = gst_element_factory_make("audioconvert", nullptr);
    if (sink == nullptr || floats == nullptr || convert == nullptr) return nullptr;
    GstCaps* caps = FloatCaps();
    g_object_set(floats, "caps", caps, nullptr);
    gst_caps_unref(caps);
    GstElement* bin = gst_bin_new(nullptr);
    gst_bin_add_many(GST_BIN(bin), floats, convert, sink, nullptr);
    gst_element_link_many(floats, convert, sink, nullptr);
    GstPad* pad = gst_element_get_static_pad(floats, "sink");
    gst_element_add_pad(bin, gst_ghost_pad_new("sink", pad));
    const auto what = static_cast<GstPadProbeType>(
        GST_PAD_PROBE_TYPE_BUFFER | GST_PAD_PROBE_TYPE_EVENT_DOWNSTREAM | GST_PAD_PROBE_TYPE_EVENT_FLUSH);
    gst_pad_add_probe(pad, what, &State::Pass, new std::shared_ptr<State>(state_),
                      [](gpointer state) { delete static_cast<std::shared_ptr<State>*>(state); });
    gst_object_unref(pad);
    return bin;
}

void GlideFilter::SetGain(float gain) {
    state_->gain = gain;
}

void GlideFilter::FadeOut() {
    state_->silentFrom = kUnknown;
    state_->fadedFrom = kUnknown;
    state_->out = true;
}

void GlideFilter::FadeIn() {
    state_->out = false;
}

bool GlideFilter::IsEmpty() const {
    return state_->empty;
}

bool GlideFilter::IsSilentAt(quint64 runningTime) const {
    const GstClockTime from = state_->silentFrom;
    return from != kUnknown && runningTime != kUnknown && runningTime >= from;
}

std::optional<quint32> GlideFilter::FadedFrom() const {
    const GstClockTime from = state_->fadedFrom;
    if (from == kUnknown) return std::nullopt;
    return static_cast<quint32>(from / GST_MSECOND);
}
