#include "ReadMPEGHeader/writing/TagReading.h"

#include <QStringList>
#include <algorithm>

#include "ReadMPEGHeader/id3v2/ID3v2Frames.h"

namespace {

// Of "COMM" only the last that was taken is shown.
void MarkFolded(std::vector<bool>& folded, const std::vector<TagFrame>& frames, std::size_t index) {
    if (frames[index].Id == "COMM")
        for (std::size_t i = 0; i < index; ++i)
            if (frames[i].Id == "COMM") folded[i] = false;
    folded[index] = true;
}

QStringList AddressTexts(const CommentFields& comment) {
    QStringList texts;
    for (const CommentFields::Address& address : comment.Addresses)
        texts += AddressText(address);
    return texts;
}

}  // namespace

TagReading ReadTagFrames(const std::vector<TagFrame>& frames, TextRules rules) {
    TagReading reading;
    reading.Folded.resize(frames.size());
    std::optional<XrukFrame> own;
    const FrameListener nobody;
    ID3v2Frames reader(rules, reading.Record, nobody, &own);
    reader.Fill([&] {
        for (std::size_t i = 0; i < frames.size(); ++i) {
            const TagFrame& frame = frames[i];
            if (!frame.IsReadable() || !reader.NeedsBody(frame.Id)) continue;
            const int before = reader.FoldedFrames();
            reader.Take(frame.Id, frame.ShownId, frame.Body());
            if (reader.FoldedFrames() > before) MarkFolded(reading.Folded, frames, i);
            if (frame.Id != "TRCK") continue;
            FrameBody body(frame.Body(), rules);
            body.ReadEncoding();
            reading.TrackTotal = TrackTotalOf(body.Values().value(0));
        }
    });
    if (reading.Record.Track > reading.TrackTotal) reading.TrackTotal = 0;
    reading.Comment = reader.Comment();
    if (own) reading.Own = own->Fields;
    return reading;
}

bool SayTheSame(TagField field, const TagReading& one, const TagReading& other) {
    const TID3Tag& a = one.Record;
    const TID3Tag& b = other.Record;
    switch (field) {
        case TagField::Title:
            return a.Title == b.Title;
        case TagField::Artist:
            return a.Artist == b.Artist;
        case TagField::Album:
            return a.Album == b.Album;
        case TagField::Year:
            return a.Year == b.Year;
        case TagField::Comment:
            return one.Comment.Comment == other.Comment.Comment;
        case TagField::Private:
            return one.Comment.Private == other.Comment.Private;
        case TagField::Address:
            return AddressTexts(one.Comment) == AddressTexts(other.Comment);
        case TagField::FileType:
            return a.MPEGLayer == b.MPEGLayer;
        case TagField::Length:
            return a.Length == b.Length;
        case TagField::Genre:
            return a.Genre == b.Genre && a.Remix == b.Remix;
        case TagField::Track:
            return a.Track == b.Track && one.TrackTotal == other.TrackTotal;
        case TagField::PlayCount:
            return a.PlayCount == b.PlayCount;
        case TagField::Own:
            return one.Own == other.Own;
    }
    return false;
}

int TrackTotalOf(const QString& text) {
    const qsizetype slash = text.indexOf(u'/');
    return slash < 0 ? 0 : std::max(0, QStringView(text).sliced(slash + 1).trimmed().toInt());
}
