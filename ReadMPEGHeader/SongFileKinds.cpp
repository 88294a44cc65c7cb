#include "ReadMPEGHeader/SongFileKinds.h"

#include <algorithm>
#include <array>

namespace {

constexpr std::array<SongFileKind, 10> kKinds = {{
    {u".mp3", u"", true, true},
    {u".mp2", u"", true, true},
    {u".wma", u"Windows Media Audio", true, true},
    {u".wav", u"Wave", true, true},
    {u".mpg", u"Video (MPG)", false, true},
    {u".mpeg", u"Video (MPG)", false, true},
    {u".voc", u"VOC Soundfile", false, false},
    {u".avi", u"Video (AVI)", false, false},
    {u".mid", u"Midi Soundfile", false, false},
    {u".mod", u"MOD Soundfile", false, false},
}};

}  // namespace

std::span<const SongFileKind> SongFileKinds() {
    return kKinds;
}

const SongFileKind* KindOfSongFile(const QString& path) {
    const auto found = std::ranges::find_if(kKinds, [&path](const SongFileKind& kind) {
        return path.endsWith(kind.Extension, Qt::CaseInsensitive);
    });
    return found == kKinds.end() ? nullptr : &*found;
}

QString AcceptedExtensions() {
    QString text;
    for (const SongFileKind& kind : kKinds)
        if (kind.IsCollected) text.append(kind.Extension).append(u';');
    return text;
}

bool IsSongFile(const QString& path) {
    const SongFileKind* kind = KindOfSongFile(path);
    return kind != nullptr && kind->IsCollected;
}
