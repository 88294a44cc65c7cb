#include "MusicManagment/playback/mci/TrustedElements.h"

#include <gst/gst.h>

#include <algorithm>
#include <array>
#include <string_view>

namespace {

// Of everything else nothing is made: no demuxer that reads other files or addresses, no list, no script.
constexpr std::array<std::string_view, 13> kTrusted = {
    "id3demux", "apedemux",    "mpegaudioparse", "wavparse", "asfdemux", "avidemux", "midiparse",
    "fluiddec", "wildmididec", "mpg123audiodec", "adpcmdec", "mulawdec", "alawdec",
};
// Decoders of single packets, which know of no file.
constexpr std::string_view kTrustedDecoders = "avdec_";

// GstAutoplugSelectResult; the library has no header for it.
constexpr int kTry = 0;
constexpr int kSkip = 2;

std::string_view NameOf(GstElementFactory* factory) {
    return factory != nullptr ? GST_OBJECT_NAME(factory) : std::string_view();
}

int Select(GstElement*, GstPad*, GstCaps*, GstElementFactory* factory, gpointer) {
    const std::string_view name = NameOf(factory);
    const bool trusted =
        name.starts_with(kTrustedDecoders) || std::ranges::find(kTrusted, name) != kTrusted.end();
    return trusted ? kTry : kSkip;
}

void SetUpElement(GstElement*, GstElement* element, gpointer) {
    if (NameOf(gst_element_get_factory(element)) == "uridecodebin")
        g_signal_connect(element, "autoplug-select", G_CALLBACK(Select), nullptr);
}

}  // namespace

void KeepToTrustedElements(GstElement* player) {
    g_signal_connect(player, "element-setup", G_CALLBACK(SetUpElement), nullptr);
}
