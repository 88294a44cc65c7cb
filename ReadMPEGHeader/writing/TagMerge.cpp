#include "ReadMPEGHeader/writing/TagMerge.h"

#include <algorithm>
#include <array>
#include <bitset>

#include "ReadMPEGHeader/DerivedGenre.h"
#include "ReadMPEGHeader/Genres.h"
#include "ReadMPEGHeader/TitleCleaning.h"
#include "ReadMPEGHeader/writing/CoverFrames.h"
#include "ReadMPEGHeader/writing/FrameConversion.h"
#include "ReadMPEGHeader/writing/RecordFrames.h"
#include "ReadMPEGHeader/writing/TagReading.h"
#include "ReadMPEGHeader/writing/WritingRules.h"

namespace {

// A set of fields.
class FieldSet {
 public:
    bool Has(TagField field) const { return bits_[static_cast<std::size_t>(field)]; }
    void Set(TagField field, bool has) { bits_[static_cast<std::size_t>(field)] = has; }
    bool All() const { return bits_.all(); }

 private:
    std::bitset<kTagFields.size()> bits_;
};

bool IsLanguageByte(std::uint8_t byte) {
    return byte >= 0x20 && byte < 0x80;
}

// The language of the comment that is shown.
FrameLanguage LanguageOf(const std::vector<TagFrame>& frames, const std::vector<bool>& folded) {
    for (std::size_t i = 0; i < frames.size(); ++i) {
        if (!folded[i] || frames[i].Id != "COMM") continue;
        FrameLanguage language{};
        const ByteSpan body = frames[i].Body();
        const bool hasLanguage = body.size() > language.size() &&
                                 std::ranges::all_of(body.subspan(1, language.size()), IsLanguageByte);
        if (hasLanguage) std::copy_n(body.begin() + 1, language.size(), language.begin());
        return language;
    }
    return {};
}

class TagMerge {
 public:
    TagMerge(std::vector<StoredTag> tags, const TagEdit& edit, const TID3Tag& asRead, ReadProfile profile)
        : edit_(edit),
          record_(edit.Record),
          asRead_(asRead),
          rules_(WritingRulesOf(profile)),
          contents_{.Record = edit.Record},
          isNew_(tags.empty()) {
        if (!tags.empty()) ReadFirst(tags.front());
        ChooseContents();
        for (const TagField field : kTagFields)
            made_[static_cast<std::size_t>(field)] = FramesOfField(field, contents_, rules_);
        wanted_ = ReadTagFrames(AllMade(), rules_.Reading());
        for (std::size_t i = 0; i < tags.size(); ++i)
            Convert(std::move(tags[i]), i == 0);
    }

    std::optional<std::vector<TagFrame>> Run() {
        FieldSet kept;
        for (const TagField field : kTagFields)
            kept.Set(field, !isNew_ && IsUnchanged(field));
        const bool changesCover = edit_.Cover && ChangesCovers(first_, *edit_.Cover);
        if (kept.All() && !changesCover) return std::nullopt;
        auto frames = Assembled(kept);
        if (RemoveLost(kept, frames)) frames = Assembled(kept);
        if (edit_.Cover) ChangeCovers(frames, *edit_.Cover);
        return frames;
    }

 private:
    // Not every value survives the way into another version: of those our own frames are made anew. True when
    // there are any.
    bool RemoveLost(FieldSet& kept, const std::vector<TagFrame>& frames) const {
        const TagReading read = ReadTagFrames(frames, rules_.Reading());
        const TagReading readModern = ReadTagFrames(frames, TextRules::Id3v23);
        bool any = false;
        for (const TagField field : kTagFields) {
            if (!kept.Has(field) || SayTheSame(field, read, old_) ||
                SayTheSame(field, readModern, oldModern_))
                continue;
            kept.Set(field, false);
            any = true;
        }
        return any;
    }

    // As it stands, before any conversion.
    void ReadFirst(StoredTag& tag) {
        const TextRules modern = tag.Version == 4 ? TextRules::Id3v24 : TextRules::Id3v23;
        oldModern_ = ReadTagFrames(tag.Frames, modern);
        old_ = rules_.Reading() == TextRules::Classic ? ReadTagFrames(tag.Frames, TextRules::Classic)
                                                      : oldModern_;
        contents_.Language = LanguageOf(tag.Frames, old_.Folded);
        for (std::size_t i = 0; i < tag.Frames.size(); ++i)
            tag.Frames[i].Field = FieldIn(tag.Frames[i], old_.Folded[i]);
    }

    // Of the frames that the comment is made of only those in it are ours.
    static std::optional<TagField> FieldIn(const TagFrame& frame, bool isFolded) {
        if (!frame.IsReadable()) return std::nullopt;
        const auto field = FieldOfFrame(frame.Id);
        const bool canBeFolded =
            field == TagField::Comment || field == TagField::Private || field == TagField::Address;
        return canBeFolded && !isFolded ? std::nullopt : field;
    }

    void Convert(StoredTag tag, bool isFirst) {
        if (!isFirst) {
            const TagReading reading = ReadTagFrames(tag.Frames, rules_.Reading());
            for (std::size_t i = 0; i < tag.Frames.size(); ++i)
                tag.Frames[i].Field = FieldIn(tag.Frames[i], reading.Folded[i]);
        }
        auto frames = ConvertedTo23(std::move(tag.Frames), tag.Version, rules_);
        auto& target = isFirst ? first_ : others_;
        std::ranges::move(frames, std::back_inserter(target));
    }

    void ChooseContents() {
        const int total = edit_.TrackTotal.value_or(old_.TrackTotal);
        contents_.TrackTotal = total;
        if (record_.Comment == old_.Comment.Join() && !isNew_) {
            contents_.Comment = old_.Comment;
        } else if (const auto changed = WithOldTail()) {
            contents_.Comment = *changed;
        } else {
            contents_.Comment = rules_.SplitComment(record_.Comment);
        }
    }

    // What the comment frame holds when only the text before the other parts has changed.
    std::optional<CommentFields> WithOldTail() const {
        CommentFields tail = old_.Comment;
        tail.Comment.clear();
        const QString text = u'\n' + tail.Join();
        if (text.size() < 2 || !record_.Comment.endsWith(text)) return std::nullopt;
        tail.Comment = record_.Comment.chopped(text.size());
        if (tail.Join() != record_.Comment) return std::nullopt;
        return tail;
    }

    std::vector<TagFrame> AllMade() const {
        std::vector<TagFrame> all;
        for (const auto& frames : made_)
            all.insert(all.end(), frames.begin(), frames.end());
        return all;
    }

    const std::vector<TagFrame>& Made(TagField field) const { return made_[static_cast<std::size_t>(field)]; }

    bool IsUnchanged(TagField field) const {
        switch (field) {
            case TagField::Title:
                return record_.Title == CleanedTitle(old_) || Says(field);
            case TagField::Length:
                return Says(field) || (HasFrame(field) && IsLengthAsRead());
            case TagField::FileType:
                return Says(field) || (HasFrame(field) && IsFormatAsRead());
            case TagField::Genre:
                return IsGenreUnchanged();
            case TagField::Comment:
            case TagField::Private:
            case TagField::Address:
                return SayTheSame(field, {.Comment = contents_.Comment}, old_) || Says(field);
            default:
                return Says(field);
        }
    }

    bool Says(TagField field) const {
        return SayTheSame(field, wanted_, old_) || SayTheSame(field, wanted_, oldModern_);
    }

    // The sound tells it, not the frame; and who does not know it has nothing to say against the frame.
    bool IsLengthAsRead() const { return record_.Length == 0 || record_.Length == asRead_.Length; }
    bool IsFormatAsRead() const {
        TID3Tag unknown;
        ResetTag(false, unknown, 0);
        const QString& format = record_.MPEGLayer;
        return format.isEmpty() || format == unknown.MPEGLayer || format == asRead_.MPEGLayer;
    }

    bool HasFrame(TagField field) const {
        return std::ranges::any_of(first_, [field](const TagFrame& frame) { return frame.Field == field; });
    }

    // The reader takes the artist off the front of a title.
    QString CleanedTitle(const TagReading& reading) const {
        TID3Tag tag;
        tag.Title = reading.Record.Title;
        tag.Artist = record_.Artist;
        CleanTitles(tag, {});
        return tag.Title;
    }

    // The record may have genre and main genre from each other; neither was in the frame then.
    bool IsGenreUnchanged() const {
        const TID3Tag& old = old_.Record;
        const quint8 oldMainGenre = old_.Own ? old_.Own->MainGenre : quint8{0};
        const bool isDerivedMainGenre =
            !old_.Own && (record_.MainGenre == oldModern_.Record.MainGenre ||
                          record_.MainGenre == MainGenreOfGenre(oldModern_.Record.Genre));
        const bool sameMainGenre = record_.MainGenre == oldMainGenre || isDerivedMainGenre;
        const bool sameGenre = record_.Genre == old.Genre ||
                               (old.Genre == kNoGenre && record_.Genre == MainGenreGenre(oldMainGenre));
        const bool oldRemix = old.Remix || (old_.Own && old_.Own->Remix);
        return sameMainGenre && sameGenre && record_.Remix == oldRemix;
    }

    std::vector<TagFrame> Assembled(const FieldSet& kept) const {
        std::vector<TagFrame> frames;
        FieldSet written = kept;
        for (const TagFrame& frame : first_) {
            if (!frame.Field || kept.Has(*frame.Field)) {
                frames.push_back(frame);
            } else if (!written.Has(*frame.Field)) {
                AddMade(*frame.Field, frames);
                written.Set(*frame.Field, true);
            }
        }
        AddOthers(frames);
        for (const TagField field : kTagFields)
            if (!written.Has(field)) AddMade(field, frames);
        MoveOddIdsBack(frames);
        return frames;
    }

    void AddMade(TagField field, std::vector<TagFrame>& frames) const {
        frames.insert(frames.end(), Made(field).begin(), Made(field).end());
    }

    // From further tags comes what the first one has not, and what is none of ours.
    void AddOthers(std::vector<TagFrame>& frames) const {
        for (const TagFrame& frame : others_) {
            const bool isSingle = frame.Id.starts_with('T') && frame.Id != "TXXX";
            const auto isSame = [&](const TagFrame& other) {
                return other.Id == frame.Id && (isSingle || other.Stored == frame.Stored);
            };
            if (!frame.Field && std::ranges::none_of(frames, isSame)) frames.push_back(frame);
        }
    }

    const TagEdit& edit_;
    const TID3Tag& record_;
    const TID3Tag& asRead_;
    const WritingRules& rules_;
    RecordContents contents_;
    bool isNew_;
    std::vector<TagFrame> first_;   // of the tag that is read, converted
    std::vector<TagFrame> others_;  // of further ones
    TagReading old_;
    TagReading oldModern_;
    std::array<std::vector<TagFrame>, kTagFields.size()> made_{};
    TagReading wanted_;
};

}  // namespace

std::optional<std::vector<TagFrame>> MergedFrames(std::vector<StoredTag> tags, const TagEdit& edit,
                                                  const TID3Tag& asRead, ReadProfile profile) {
    return TagMerge(std::move(tags), edit, asRead, profile).Run();
}
