#include "ReadMPEGHeader/id3v2/XrukFrame.h"

#include <algorithm>
#include <cmath>
#include <string>
#include <string_view>

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

void WriteNumbers(ByteWriter& body, const TID3Tag& record) {
    body.U16Le(record.BitRate);
    body.U16Le(record.SampleRate);
    body.U8(record.ChannelMode);
    body.U8(record.Emphasis);
    for (const bool flag :
         {record.Private, record.Protected, record.Copyrighted, record.Original, record.Padding})
        body.U8(flag ? 1 : 0);
    body.U16Le(record.FrameSize);
    body.U16Le(record.Reserved);
    body.U32Le(record.Flags);
    body.U8(record.MainGenre);
    body.U8(record.Remix ? 1 : 0);
    body.F64Le(record.AddTime);
}

// For those who look into the file with other programs: four lines of 60 bytes behind an empty one.
const std::string& Banner() {
    static const std::string banner = [] {
        constexpr std::size_t kWidth = 58;
        const auto centred = [](std::string_view text) {
            std::string line(kWidth, ' ');
            return line.replace((kWidth - text.size()) / 2, text.size(), text);
        };
        const std::string rule(kWidth, '=');
        std::string text = "\r\n";
        for (const std::string& line : {rule, centred("Tunestead"), centred("by RUK"), rule})
            text += line + "\r\n";
        return text;
    }();
    return banner;
}

}  // namespace

void XrukFrame::Write(ByteWriter& body, const TID3Tag& record, ByteSpan format) {
    body.Block(Banner(), kBannerSize);
    body.U8(0);
    body.Raw(format);
    body.U8(0);
    WriteNumbers(body, record);
}

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
