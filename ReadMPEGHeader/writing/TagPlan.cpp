#include <algorithm>
#include <array>
#include <utility>

#include "CommonRUKTools/BufferedSource.h"
#include "CommonRUKTools/Errors.h"
#include "ReadMPEGHeader/TagWriting.h"
#include "ReadMPEGHeader/id3v1/ID3v1.h"
#include "ReadMPEGHeader/id3v2/ID3v2Position.h"
#include "ReadMPEGHeader/mpeg/FrameSearch.h"
#include "ReadMPEGHeader/writing/StoredTag.h"
#include "ReadMPEGHeader/writing/TagBytes.h"
#include "ReadMPEGHeader/writing/TagLayout.h"
#include "ReadMPEGHeader/writing/TagMerge.h"
#include "ReadMPEGHeader/writing/TagReading.h"

using namespace Qt::StringLiterals;

namespace {

constexpr auto kOldTagSize = static_cast<std::int64_t>(kId3v1Size);

// The message names the file, whoever knew the reason.
template <typename Plan>
FilePatch Named(const QString& path, Plan plan) {
    try {
        return plan();
    } catch (const EMediumError&) {
        throw;
    } catch (const EStreamError& error) {
        throw EStreamError(u"Kann die Tags dieser Datei nicht ändern: "_s + path + u": "_s + error.Message());
    }
}

FilePatch Unchanged(const ByteSource& file) {
    FilePatch patch;
    patch.Keep(0, file.Size());
    return patch;
}

void KeepSound(FilePatch& patch, const TagLayout& layout) {
    patch.Keep(layout.Sound.Begin, layout.Sound.Length());
    for (const FileRange& range : layout.Behind)
        patch.Keep(range.Begin, range.Length());
}

// What stands in `place` becomes `bytes`, which the patch has reached; whatever is the same there is not
// written, so that less must be remembered to take it back.
void Overwrite(FilePatch& patch, ByteSource& file, FileRange place, ByteSpan bytes) {
    const auto old = file.ReadExactly(place.Begin, static_cast<std::size_t>(place.Length()));
    const ByteSpan before(old);
    const auto [oldDiffers, newDiffers] = std::ranges::mismatch(before, bytes);
    const auto front = static_cast<std::size_t>(newDiffers - bytes.begin());
    std::size_t back = 0;
    while (before.size() == bytes.size() && back < bytes.size() - front &&
           before[before.size() - 1 - back] == bytes[bytes.size() - 1 - back])
        ++back;
    patch.Keep(place.Begin, static_cast<std::int64_t>(front));
    patch.Insert(bytes.subspan(front, bytes.size() - front - back));
    patch.Keep(place.End - static_cast<std::int64_t>(back), static_cast<std::int64_t>(back));
}

// One file on its way to new tags.
class TagPlan {
 public:
    TagPlan(ByteSource& file, const QString& path, const TagEdit& edit, const TagWriteOptions& options)
        : file_(file), edit_(edit), layout_(FindTags(file, path)) {
        if (!layout_.AreLeadingTagsWhole) throw EStreamError(u"der ID3v2-Tag ist beschädigt"_s);
        std::vector<StoredTag> tags;
        for (const std::int64_t position : layout_.Tags)
            tags.push_back(ReadStoredTag(file, position));
        ReadOptions reading;
        reading.Profile = options.Profile;
        reading.FileTime = 0;
        frames_ = MergedFrames(std::move(tags), edit, ReadSong(file, path, reading).Tag, options.Profile);
    }

    FilePatch Run() {
        if (!frames_) return Unchanged(file_);
        return layout_.Container == TagLayout::Kind::Mpeg ? Leading() : BehindSound();
    }

 private:
    FilePatch Leading() {
        FilePatch patch;
        const FileRange place{0, layout_.Sound.Begin};
        const std::int64_t size = SizeOfTag(*frames_);
        ByteWriter tag;
        if (size <= place.End && IsPossibleTagSize(place.End)) {
            AppendTag(tag, *frames_, place.End);
            Overwrite(patch, file_, place, tag.Bytes());
        } else {
            AppendTag(tag, *frames_, IsPossibleTagSize(size + kTagPadding) ? size + kTagPadding : size);
            patch.Insert(tag.Bytes());
        }
        KeepSound(patch, layout_);
        AddId3v1(patch);
        return patch;
    }

    // A tag of old that reads the same keeps its bytes.
    void AddId3v1(FilePatch& patch) {
        TID3Tag cut = edit_.Record;  // is shortened to what the tag holds
        ByteWriter bytes;
        WriteID3v1(bytes, cut);
        if (layout_.Id3v1) {
            MemorySource source(bytes.Bytes());
            TID3Tag written;
            TID3Tag old;
            ReadID3v1(source, 0, written);
            ReadID3v1(file_, *layout_.Id3v1, old);
            if (written == old) return patch.Keep(*layout_.Id3v1, kOldTagSize);
        }
        patch.Insert(bytes.Bytes());
    }

    FilePatch BehindSound() {
        FilePatch patch;
        KeepSound(patch, layout_);
        const std::int64_t position = patch.NewSize();
        ByteWriter tag;
        AppendTag(tag, *frames_, SizeOfTag(*frames_));
        AppendTrailer(tag, position);
        if (layout_.Behind.empty())
            Overwrite(patch, file_, {position, file_.Size()}, tag.Bytes());
        else
            patch.Insert(tag.Bytes());
        return patch;
    }

    ByteSource& file_;
    const TagEdit& edit_;
    TagLayout layout_;
    std::optional<std::vector<TagFrame>> frames_;
};

// A damaged tag may lie about its size: what stands behind it must be sound.
void CheckBeginOfSound(ByteSource& file, const TagLayout& layout) {
    if (layout.AreLeadingTagsWhole || layout.Container != TagLayout::Kind::Mpeg) return;
    const auto frame = FindMpegFrame(file, layout.Sound.Begin);
    if (!frame || !frame->Confirmed || frame->Position != layout.Sound.Begin)
        throw EStreamError(u"der ID3v2-Tag ist beschädigt"_s);
}

}  // namespace

FilePatch PlanTag(ByteSource& file, const QString& path, const TagEdit& edit,
                  const TagWriteOptions& options) {
    BufferedSource source(file);
    return Named(path, [&] { return TagPlan(source, path, edit, options).Run(); });
}

FilePatch PlanTagRemoval(ByteSource& file, const QString& path) {
    BufferedSource source(file);
    return Named(path, [&] {
        const TagLayout layout = FindTags(source, path);
        CheckBeginOfSound(source, layout);
        FilePatch patch;
        KeepSound(patch, layout);
        return patch;
    });
}

std::optional<int> ReadTrackTotal(ByteSource& file) {
    BufferedSource source(file);
    const auto position = FindID3v2Tag(source);
    if (!position) return std::nullopt;
    const StoredTag tag = ReadStoredTag(source, *position);
    const int total = ReadTagFrames(tag.Frames, TextRules::Id3v23).TrackTotal;
    if (total == 0) return std::nullopt;
    return total;
}
