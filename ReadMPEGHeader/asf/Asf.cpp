#include "ReadMPEGHeader/asf/Asf.h"

#include <QDateTime>
#include <algorithm>

#include "CommonRUKTools/BufferedSource.h"
#include "CommonRUKTools/Clock.h"
#include "ReadMPEGHeader/FieldValues.h"
#include "ReadMPEGHeader/asf/AsfObjects.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::uint64_t kTicksPerSecond = 10'000'000;
constexpr std::uint64_t kTicksPerMs = 10'000;
constexpr std::uint64_t kSecondsFrom1601To1970 = 11'644'473'600;
constexpr double kEndOfYear9999 = 2'958'466.0;

std::uint64_t PlayTicks(const TASFInfo& info, AsfLength length) {
    if (length == AsfLength::AsStored) return info.PlayDuration;
    if (info.Preroll > info.PlayDuration / kTicksPerMs) return 0;
    return info.PlayDuration - info.Preroll * kTicksPerMs;
}

// Local day count; 0 when the header names no time or one that no calendar has.
double DayCountOf(std::uint64_t creationTime) {
    if (creationTime == 0) return 0;
    const auto ms =
        static_cast<qint64>(creationTime / kTicksPerMs) - static_cast<qint64>(kSecondsFrom1601To1970 * 1000);
    const double days = ToDayCount(QDateTime::fromMSecsSinceEpoch(ms));
    return days < kEndOfYear9999 ? days : 0;
}

// A file without a list of codecs is named after its container.
QString FormatText(const TASFInfo& info) {
    if (info.CodecName.isEmpty() && info.CodecDescription.isEmpty()) return u"Windows Media Audio"_s;
    return info.CodecName + u' ' + info.CodecDescription;
}

}  // namespace

bool IsAsf(ByteSpan head) {
    return head.size() >= kAsfHeaderObject.size() &&
           std::equal(kAsfHeaderObject.begin(), kAsfHeaderObject.end(), head.begin());
}

std::optional<TASFInfo> ReadAsfHeader(ByteSource& stream) {
    BufferedSource source(stream);
    AsfCursor start(source, 0, source.Size());
    const auto guid = start.Block<16>();
    const auto size = start.U64();
    start.Skip(6);  // number of objects (their sizes tell it, too) and two reserved bytes
    if (start.Failed() || guid != kAsfHeaderObject || size < 30) return std::nullopt;

    AsfHeader header;
    ReadAsfObjects(start.Area(std::min<std::uint64_t>(size - 30, start.Remaining())), header);
    if (!header.KnowsAnything) return std::nullopt;
    header.Attributes.Complete(header.Info);
    if (header.Info.BitRate == 0) header.Info.BitRate = header.MaximumBitRate;
    return header.Info;
}

TID3Tag TagFromAsf(const TASFInfo& info, AsfLength length) {
    TID3Tag tag;
    ResetTag(false, tag, DayCountOf(info.CreationTime));
    tag.Title = info.Title;
    tag.Artist = info.Artist;
    tag.Album = info.Album;
    if (!info.Year.isEmpty()) tag.Year = info.Year;
    tag.Comment = info.Comment;
    tag.MPEGLayer = FormatText(info);
    tag.Length = Saturated<quint16>(PlayTicks(info, length) / kTicksPerSecond);
    tag.Genre = info.Genre;
    tag.BitRate = Saturated<quint16>(info.BitRate / 1000);
    tag.SampleRate = Saturated<quint16>(info.SampleRate);
    tag.ChannelMode = ChannelModeByCount(info.Channels);
    tag.Emphasis = 1;
    tag.Private = info.Encrypted;
    tag.FrameSize = info.BlockAlign;
    tag.Track = info.Track;
    return tag;
}
