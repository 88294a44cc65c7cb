#include "ReadMPEGHeader/writing/RecordFrames.h"

#include <QStringList>

#include "ReadMPEGHeader/FileTypeText.h"
#include "ReadMPEGHeader/id3v2/XrukFrame.h"
#include "ReadMPEGHeader/writing/FrameTextWriter.h"

namespace {

TagFrame Frame(TagField field, const ByteWriter& body) {
    TagFrame frame;
    frame.Id = FrameIdOf(field);
    frame.ShownId = QString::fromStdString(frame.Id);
    frame.Stored = body.Bytes();
    frame.Field = field;
    return frame;
}

std::vector<TagFrame> TextFrame(TagField field, const QString& text, const WritingRules& rules) {
    const FrameTextWriter texts(rules, {text});
    ByteWriter body;
    body.U8(texts.Encoding());
    texts.Text(body, text);
    return {Frame(field, body)};
}

std::vector<TagFrame> TextFrame(TagField field, const std::optional<QString>& text,
                                const WritingRules& rules) {
    if (!text) return {};
    return TextFrame(field, *text, rules);
}

// The description is empty.
std::vector<TagFrame> CommentFrames(const RecordContents& contents, const WritingRules& rules) {
    const QString& text = contents.Comment.Comment;
    const FrameTextWriter texts(rules, {text});
    ByteWriter body;
    body.U8(texts.Encoding());
    body.Raw(contents.Language);
    texts.Text(body, QString());
    texts.Terminator(body);
    texts.Text(body, text);
    return {Frame(TagField::Comment, body)};
}

std::vector<TagFrame> PrivateFrames(const RecordContents& contents, const WritingRules& rules) {
    if (contents.Comment.Private.isEmpty()) return {};
    ByteWriter body;
    body.Raw(PlainTextBytes(rules, contents.Comment.Private));
    return {Frame(TagField::Private, body)};
}

std::vector<TagFrame> AddressFrames(const RecordContents& contents, const WritingRules& rules) {
    std::vector<TagFrame> frames;
    for (const CommentFields::Address& address : contents.Comment.Addresses) {
        const FrameTextWriter texts(rules, {address.Description});
        ByteWriter body;
        body.U8(texts.Encoding());
        texts.Text(body, address.Description);
        texts.Terminator(body);
        body.Raw(PlainTextBytes(rules, address.Url));
        frames.push_back(Frame(TagField::Address, body));
    }
    return frames;
}

std::vector<TagFrame> PlayCountFrames(const RecordContents& contents, const WritingRules& rules) {
    ByteWriter body;
    rules.WritePlayCount(body, contents.Record.PlayCount);
    return {Frame(TagField::PlayCount, body)};
}

std::vector<TagFrame> OwnFrames(const RecordContents& contents, const WritingRules& rules) {
    ByteWriter body;
    XrukFrame::Write(body, contents.Record, PlainTextBytes(rules, contents.Record.MPEGLayer));
    return {Frame(TagField::Own, body)};
}

}  // namespace

std::vector<TagFrame> FramesOfField(TagField field, const RecordContents& contents,
                                    const WritingRules& rules) {
    const TID3Tag& record = contents.Record;
    switch (field) {
        case TagField::Title:
            return TextFrame(field, record.Title, rules);
        case TagField::Artist:
            return TextFrame(field, record.Artist, rules);
        case TagField::Album:
            return TextFrame(field, record.Album, rules);
        case TagField::Year:
            return TextFrame(field, record.Year, rules);
        case TagField::Comment:
            return CommentFrames(contents, rules);
        case TagField::Private:
            return PrivateFrames(contents, rules);
        case TagField::Address:
            return AddressFrames(contents, rules);
        case TagField::FileType:
            return TextFrame(field, FileTypeFromFormat(record.MPEGLayer), rules);
        case TagField::Length:
            return TextFrame(field, QString::number(record.Length * 1000), rules);
        case TagField::Genre:
            return TextFrame(field, rules.GenreText(record), rules);
        case TagField::Track:
            return TextFrame(field, rules.TrackText(record.Track, contents.TrackTotal), rules);
        case TagField::PlayCount:
            return PlayCountFrames(contents, rules);
        case TagField::Own:
            return OwnFrames(contents, rules);
    }
    return {};
}
