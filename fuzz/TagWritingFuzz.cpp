// Any bytes are a file whose tags change: its sound stays as it is, the new tags read as they were meant, the
// same edit changes nothing a second time, and the old file can be had back. The first byte chooses the
// rules and what changes, the rest is the file.

#include <QLoggingCategory>
#include <algorithm>
#include <cstdio>
#include <cstdlib>

#include "CommonRUKTools/Errors.h"
#include "ReadMPEGHeader/TagWriting.h"
#include "ReadMPEGHeader/id3v2/ID3v2Position.h"
#include "ReadMPEGHeader/id3v2/ID3v2Reader.h"
#include "ReadMPEGHeader/writing/TagLayout.h"

using namespace Qt::StringLiterals;

namespace {

using Bytes = std::vector<std::uint8_t>;

// Bits of the first byte.
constexpr unsigned kClassic = 1;
constexpr unsigned kTitle = 2;
constexpr unsigned kComment = 4;
constexpr unsigned kGenre = 8;
constexpr unsigned kTotal = 16;
constexpr unsigned kCover = 32;
constexpr unsigned kNoCover = 64;
constexpr unsigned kAlbum = 128;

// Clang 14 has no std::source_location.
void Require(bool condition, int line = __builtin_LINE()) {
    if (condition) return;
    std::fprintf(stderr, "requirement of line %d\n", line);
    std::abort();
}

Bytes Patched(ByteSpan file, const FilePatch& patch) {
    ByteWriter result;
    for (const FilePatch::Piece& piece : patch.Pieces())
        if (piece.IsKept())
            result.Raw(
                file.subspan(static_cast<std::size_t>(piece.From), static_cast<std::size_t>(piece.Length)));
        else
            result.Raw(piece.Bytes);
    return result.Bytes();
}

QString PathFor(ByteSpan file) {
    return StartsWith(file, "RIFF") ? u"/music/a.wav"_s : u"/music/a.mp3"_s;
}

TagEdit EditFrom(TID3Tag record, unsigned choice) {
    TagEdit edit{.Record = std::move(record)};
    if ((choice & kTitle) != 0) edit.Record.Title = u"Neuer Titel Ω"_s;
    if ((choice & kComment) != 0)
        edit.Record.Comment = u"Gut\nPrivate Angaben:\nabc\nURL:(d) http://a.example"_s;
    if ((choice & kGenre) != 0) edit.Record.Genre = 13;
    if ((choice & kTotal) != 0) edit.TrackTotal = 12;
    if ((choice & kCover) != 0) edit.Cover = CoverPicture{QByteArray("picture"), u"image/png"_s};
    if ((choice & kNoCover) != 0) edit.Cover = CoverRemoval{};
    if ((choice & kAlbum) != 0) edit.Record.Album = QString(400, u'x');
    return edit;
}

Bytes SoundIn(ByteSpan file, const QString& path) {
    MemorySource source(file);
    const TagLayout layout = FindTags(source, path);
    ByteWriter sound;
    const auto add = [&](const FileRange& range) {
        sound.Raw(
            file.subspan(static_cast<std::size_t>(range.Begin), static_cast<std::size_t>(range.Length())));
    };
    add(layout.Sound);
    std::ranges::for_each(layout.Behind, add);
    return sound.Bytes();
}

void CheckReading(ByteSpan file, const TagEdit& edit, unsigned choice) {
    MemorySource source(file);
    const auto position = FindID3v2Tag(source);
    Require(position.has_value());
    TID3Tag tag;
    std::int64_t end = 0;
    Require(ReadID3v2Modern(source, *position, end, tag, {}));
    const TID3Tag& record = edit.Record;
    Require((choice & kTitle) == 0 || tag.Title == record.Title);
    Require((choice & kComment) == 0 || tag.Comment == record.Comment);
    Require(tag.Album == record.Album && tag.Track == record.Track);
}

void CheckChange(ByteSpan file, const QString& path, unsigned choice) {
    MemorySource source(file);
    const TagWriteOptions options{(choice & kClassic) != 0 ? ReadProfile::Classic : ReadProfile::Modern};
    ReadOptions reading;
    reading.Profile = options.Profile;
    reading.FileTime = 1;
    const TagEdit edit = EditFrom(ReadSong(source, path, reading).Tag, choice);
    const FilePatch patch = PlanTag(source, path, edit, options);
    if (patch.ChangesNothing(source.Size())) return;
    const Bytes after = Patched(file, patch);
    Require(SoundIn(after, path) == SoundIn(file, path));
    Require(Patched(after, patch.Inverse(source)) == Bytes(file.begin(), file.end()));
    if (options.Profile == ReadProfile::Classic) return;
    CheckReading(after, edit, choice);
    MemorySource again(after);
    // Behind a comment that was taken away another one may come to light, and the sound of an MPEG file is
    // only looked at when its tag has come to its head.
    const bool tagMoves =
        FindTags(source, path).Container == TagLayout::Kind::Mpeg && FindID3v2Tag(source).value_or(0) > 0;
    if (edit.Record.Comment.isEmpty() || tagMoves) return;
    // A length that is reckoned from the size of the file grows with the old tag behind it.
    if (ReadSong(again, path, reading).Tag.Length != edit.Record.Length) return;
    Require(PlanTag(again, path, edit, options).ChangesNothing(again.Size()));
}

void CheckRemoval(ByteSpan file, const QString& path) {
    MemorySource source(file);
    const Bytes bare = Patched(file, PlanTagRemoval(source, path));
    Require(bare == SoundIn(file, path));
    MemorySource again(bare);
    Require(PlanTagRemoval(again, path).ChangesNothing(again.Size()));
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static const bool quiet = [] {
        QLoggingCategory::setFilterRules(u"default.warning=false"_s);  // the decompressor's complaints
        return true;
    }();
    if (!quiet || size == 0) return 0;
    const ByteSpan file(data + 1, size - 1);
    const QString path = PathFor(file);
    try {
        CheckChange(file, path, data[0]);
        CheckRemoval(file, path);
    } catch (const EStreamError& error) {
        Require(!error.Message().isEmpty());
    }
    return 0;
}
