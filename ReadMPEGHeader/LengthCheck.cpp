#include "ReadMPEGHeader/LengthCheck.h"

#include "CommonRUKTools/BufferedSource.h"
#include "CommonRUKTools/Errors.h"
#include "ReadMPEGHeader/FieldValues.h"
#include "ReadMPEGHeader/ReadingProfile.h"
#include "ReadMPEGHeader/id3v2/ID3v2Position.h"
#include "ReadMPEGHeader/mpeg/FrameCount.h"

using namespace Qt::StringLiterals;

namespace {

// Some encoders count the frame of the header itself, or one that they only flushed.
constexpr std::int64_t kFramesOfDoubt = 2;

std::optional<std::int64_t> FirstFrame(ByteSource& stream) {
    return ModernProfile().FindFirstFrame(stream, [&stream](std::int64_t position) {
        return EndOfID3v2Tag(stream, position).value_or(position);
    });
}

QString DamageOf(const FrameCount& count) {
    if (count.Skipped > 0)
        return u"Zwischen den Frames stehen %1 Bytes, die zu keinem gehören"_s.arg(count.Skipped);
    const std::int64_t missing = count.Announced - count.Frames;
    if (missing > kFramesOfDoubt) return u"Es fehlen %1 von %2 Frames"_s.arg(missing).arg(count.Announced);
    return {};
}

std::optional<LengthCheck> CheckMpeg(ByteSource& stream, const TID3Tag& head) {
    const auto begin = FirstFrame(stream);
    if (!begin) return std::nullopt;
    const FrameCount count = CountMpegFrames(stream, *begin);
    if (count.Frames == 0) return std::nullopt;
    LengthCheck check{.Technical = head, .Damage = DamageOf(count)};
    check.Technical.Length = Saturated<quint16>(count.Seconds());
    check.Technical.BitRate = Saturated<quint16>(count.BitRate());
    check.Technical.FrameSize = Saturated<quint16>(count.Bytes / count.Frames);
    return check;
}

}  // namespace

std::optional<LengthCheck> CheckLength(const QString& path) {
    FileSource file(path);
    BufferedSource stream(file, 128 * 1024);
    ReadOptions options;
    options.Profile = ReadProfile::Modern;
    options.FileTime = 0;
    const SongReading reading = ReadSong(stream, path, options);
    if (!reading.Succeeded()) throw EStreamError(reading.Failure());
    if (reading.Mpeg.FrameCount >= 0) return CheckMpeg(stream, reading.Tag);
    if (reading.Tag.Length == 0) return std::nullopt;
    return LengthCheck{.Technical = reading.Tag, .Damage = QString()};
}

void ApplyLengthCheck(const LengthCheck& check, TID3Tag& record) {
    record.MPEGLayer = check.Technical.MPEGLayer;
    record.Length = check.Technical.Length;
    record.BitRate = check.Technical.BitRate;
    record.SampleRate = check.Technical.SampleRate;
    record.ChannelMode = check.Technical.ChannelMode;
    record.FrameSize = check.Technical.FrameSize;
}
