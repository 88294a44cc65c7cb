#pragma once

#include <QString>
#include <optional>
#include <string_view>

#include "ReadMPEGHeader/ID3Tag.h"
#include "ReadMPEGHeader/id3v2/CommentFields.h"
#include "ReadMPEGHeader/id3v2/FrameListener.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameBody.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameWalk.h"
#include "ReadMPEGHeader/id3v2/XrukFrame.h"

// Takes the frames of one tag in their order: fills the record and tells the listener. Ids are those of
// ID3v2.3 and 2.4, four characters.
class ID3v2Frames : public ID3v2FrameSink {
 public:
    // Everything given must live as long as this object; `xruk` may be missing.
    ID3v2Frames(TextRules rules, TID3Tag& tag, const FrameListener& listener, std::optional<XrukFrame>* xruk)
        : rules_(rules), tag_(tag), listener_(listener), xruk_(xruk) {
        if (xruk_) xruk_->reset();
    }

    // Runs `walk`, which hands over the frames, and completes the record with what it has found so far, also
    // when it throws.
    template <typename Walk>
    void Fill(Walk walk) {
        try {
            walk();
        } catch (...) {
            Finish();
            throw;
        }
        Finish();
    }

    // False for a frame that is the listener's alone.
    static bool FillsRecord(std::string_view id) { return EffectOf(id) != nullptr; }
    // The comment's parts so far, and how many frames went into it; of "COMM" the last that was taken counts.
    const CommentFields& Comment() const { return comment_; }
    int FoldedFrames() const { return foldedFrames_; }
    // False for a frame whose body changes nothing, so that it need not be read.
    bool NeedsBody(std::string_view id) const override;
    void Take(std::string_view id, const QString& shownId, ByteSpan body) override;
    // For a frame that cannot be decoded: the listener hears its size and the reason.
    void TakeUnreadable(const QString& shownId, std::int64_t size, const QString& reason) override;

 private:
    using Effect = void (ID3v2Frames::*)(FrameBody&);
    struct EffectRow;
    static Effect EffectOf(std::string_view id);
    void Finish();

    void TakeTitle(FrameBody& body);
    void TakeArtist(FrameBody& body);
    void TakeAlbum(FrameBody& body);
    void TakeYear(FrameBody& body);
    void TakeRecordingTime(FrameBody& body);
    void TakeLength(FrameBody& body);
    void TakeTrack(FrameBody& body);
    void TakeGenre(FrameBody& body);
    void TakeComment(FrameBody& body);
    void TakeFileType(FrameBody& body);
    void TakeAddress(FrameBody& body);
    void TakePrivate(FrameBody& body);
    void TakePlayCount(FrameBody& body);
    void TakeXruk(FrameBody& body);
    bool IsBetterComment(const QString& description, const QString& text);

    TextRules rules_;
    TID3Tag& tag_;
    const FrameListener& listener_;
    std::optional<XrukFrame>* xruk_;
    CommentFields comment_;
    bool hasPlainComment_ = false;
    QString recordingYear_;
    int foldedFrames_ = 0;
    bool hasOwnFrame_ = false;
    std::optional<quint32> turnedPlayCount_{};  // the bytes of a count read from the other end
};
