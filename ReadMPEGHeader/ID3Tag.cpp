#include "ReadMPEGHeader/ID3Tag.h"

#include "ReadMPEGHeader/SongFileKinds.h"

using namespace Qt::StringLiterals;

namespace {

void CopyTags(TID3Tag& target, const TID3Tag& source) {
    if (target.FileName.isEmpty()) target.FileName = source.FileName;
    target.Title = source.Title;
    target.Artist = source.Artist;
    target.Album = source.Album;
    target.Year = source.Year;
    target.Comment = source.Comment;
    target.Genre = source.Genre;
    target.Track = source.Track;
}

void FillEmpty(TID3Tag& target, const TID3Tag& source) {
    if (target.MPEGLayer.isEmpty()) target.MPEGLayer = source.MPEGLayer;
    if (target.Length == 0) target.Length = source.Length;
    if (target.PlayCount == 0) target.PlayCount = source.PlayCount;
}

// Every field that the tags do not already cover; the track among them.
void CopyTechnical(TID3Tag& target, const TID3Tag& source) {
    TID3Tag merged = source;
    merged.FileName = target.FileName;
    merged.Title = target.Title;
    merged.Artist = target.Artist;
    merged.Album = target.Album;
    merged.Year = target.Year;
    merged.Comment = target.Comment;
    merged.Genre = target.Genre;
    target = merged;
}

}  // namespace

void ResetTag(bool keep, TID3Tag& tag, double fileTime) {
    tag = TID3Tag();
    if (keep) return;
    tag.Year = u"0000"_s;
    tag.MPEGLayer = u"MPEG ??? Layer ???"_s;
    tag.AddTime = fileTime;
}

void MergeTag(TID3Tag& target, const TID3Tag& source, MergeMode mode) {
    CopyTags(target, source);
    if (mode == MergeMode::FillEmpty) FillEmpty(target, source);
    if (mode == MergeMode::Technical) CopyTechnical(target, source);
}

void DescribeByExtension(const QString& path, TID3Tag& tag) {
    const SongFileKind* kind = KindOfSongFile(path);
    if (kind != nullptr && !kind->Description.isEmpty()) tag.MPEGLayer = kind->Description.toString();
}
