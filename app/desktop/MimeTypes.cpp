#include "app/desktop/MimeTypes.h"

#include <QFileInfo>
#include <algorithm>

#include "ReadMPEGHeader/SongFileKinds.h"

namespace {

// data/tunestead-mime.xml says the same to the desktop.
constexpr FileType kOwnTypes[] = {
    {u"application/x-tunestead-playlist", u"RUK PlayList", {u".rukpl", u".rpl"}, FileKind::PlayList},
    {u"application/x-tunestead-extended-playlist",
     u"Erweiterte PlayList",
     {u".extpl", u".m3u", u".m3u8"},
     FileKind::PlayList},
    {u"application/x-tunestead-ascii-playlist",
     u"PlayList (ASCII-Format)",
     {u".pl", u".txtpl"},
     FileKind::PlayList},
    {u"application/x-tunestead-ini-playlist",
     u"PlayList (INI-Format)",
     {u".pls", u".inipl"},
     FileKind::PlayList},
    {u"application/x-tunestead-database", u"Tunestead Datenbank", {u".tsdb", {}}, FileKind::Database},
    {u"application/x-tunestead-desktop", u"Tunestead Desktop", {u".df", {}}, FileKind::Arrangement}};

bool Holds(std::span<const QStringView> extensions, const QString& extension) {
    return !extension.isEmpty() && std::ranges::count(extensions, QStringView(extension)) > 0;
}

}  // namespace

std::span<const FileType> OwnFileTypes() {
    return kOwnTypes;
}

QString FileExtension(const QString& path) {
    const QString name = QFileInfo(path).fileName();
    const auto dot = name.lastIndexOf(u'.');
    return dot < 0 ? QString() : name.mid(dot);
}

FileKind KindOfFile(const QString& path) {
    const QString extension = FileExtension(path).toLower();
    const SongFileKind* song = KindOfSongFile(path);
    if (song != nullptr && song->IsOpened) return FileKind::Song;
    const auto type = std::ranges::find_if(
        kOwnTypes, [&](const FileType& candidate) { return Holds(candidate.Extensions, extension); });
    return type == std::end(kOwnTypes) ? FileKind::Unknown : type->Kind;
}
