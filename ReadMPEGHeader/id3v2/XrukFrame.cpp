#include "ReadMPEGHeader/id3v2/XrukFrame.h"

#include <algorithm>
#include <cmath>

#include "CommonRUKTools/CodePage.h"

namespace {

constexpr std::size_t kBannerSize = 242;
constexpr std::size_t kNumbersSize = 29;
constexpr std::size_t kFixedSize = kBannerSize + 1 + 1 + kNumbersSize;  // with encoding and terminator

// 31 December 9999, the last day that a date can show.
constexpr double kLastDay = 2958465;

// A time that no clock could have written is as good as none.
double PlausibleTime(double days) {
    return std::isfinite(days) && days > 0 && days <= kLastDay ? days : 0;
}

void ReadNumbers(ByteReader& reader, TID3Tag& fields) {
    fields.BitRate = reader.U16Le();
    fields.SampleRate = reader.U16Le();
    fields.ChannelMode = reader.U8();
    fields.Emphasis = reader.U8();
    fields.Private = reader.U8() != 0;
    fields.Protected = reader.U8() != 0;
    fields.Copyrighted = reader.U8() != 0;
    fields.Original = reader.U8() != 0;
    fields.Padding = reader.U8() != 0;
    fields.FrameSize = reader.U16Le();
    fields.Reserved = reader.U16Le();
    fields.Flags = reader.U32Le();
    fields.MainGenre = reader.U8();
    fields.Remix = reader.U8() != 0;
    fields.AddTime = PlausibleTime(reader.F64Le());
}

}  // namespace

std::optional<XrukFrame> XrukFrame::Parse(ByteSpan body) {
    if (body.size() < kFixedSize) return std::nullopt;
    ByteReader reader(body);
    reader.Skip(kBannerSize);
    if (reader.U8() != 0) return std::nullopt;
    const auto format = reader.Take(body.size() - kFixedSize);
    const bool endsInTime = reader.U8() == 0 && std::ranges::find(format, 0) == format.end();
    if (!endsInTime) return std::nullopt;
    XrukFrame frame;
    frame.Fields.MPEGLayer = CodePage::FromLegacy(format);
    ReadNumbers(reader, frame.Fields);
    return frame;
}

void XrukFrame::ApplyCollectionFields(TID3Tag& target) const {
    target.Reserved = Fields.Reserved;
    target.Flags = Fields.Flags;
    target.MainGenre = Fields.MainGenre;
    target.Remix = Fields.Remix;
    if (Fields.AddTime != 0) target.AddTime = Fields.AddTime;
}

void XrukFrame::ApplyTechnicalFields(TID3Tag& target) const {
    target.MPEGLayer = Fields.MPEGLayer;
    target.BitRate = Fields.BitRate;
    target.SampleRate = Fields.SampleRate;
    target.ChannelMode = Fields.ChannelMode;
    target.Emphasis = Fields.Emphasis;
    target.Private = Fields.Private;
    target.Protected = Fields.Protected;
    target.Copyrighted = Fields.Copyrighted;
    target.Original = Fields.Original;
    target.Padding = Fields.Padding;
    target.FrameSize = Fields.FrameSize;
}
