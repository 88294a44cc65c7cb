#include "MusicManagment/database/batches/MediaCopies.h"

#include <QDir>
#include <QFileInfo>
#include <QLocale>

#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/platform/FileCalls.h"
#include "MusicManagment/database/songfiles/BlockCopy.h"

using namespace Qt::StringLiterals;

namespace {

// As the record tells: the medium need not be there.
qint64 SizeOf(const TID3Tag& song) {
    constexpr qint64 kBytesPerKilobit = 125;
    return qint64{song.Length} * song.BitRate * kBytesPerKilobit;
}

// -1 where nobody tells.
qint64 RoomIn(const QString& folder) {
    QString there = QDir::cleanPath(folder);
    while (!QFileInfo(there).isDir() && FolderOf(there) != there)
        there = FolderOf(there);
    return FileCalls::FreeBytes(there);
}

QString Amount(qint64 bytes) {
    return QLocale(QLocale::German).formattedDataSize(bytes, 1, QLocale::DataSizeTraditionalFormat);
}

}  // namespace

bool CopyProgress::Reach(const QString& name, qint64 done, qint64 size) const {
    return Database.Progress(
        {.Cur = Number, .Max = Total, .CurSub = done, .MaxSub = size, .Type = ptOther, .Description = name});
}

bool MayCopy(TMusicDatabase& database, const std::vector<SongHandle>& songs, const QString& folder) {
    qint64 needed = 0;
    for (const SongHandle handle : songs)
        if (const TID3Tag* song = database.Songs().Find(handle)) needed += SizeOf(*song);
    const qint64 room = RoomIn(folder);
    const bool fits = room < 0 || needed < room;
    const QString amount = (songs.size() == 1 ? u"Es wird "_s : u"Es werden "_s) +
                           SongCountText(songs.size()) + u" mit etwa "_s + Amount(needed) + u" nach "_s +
                           folder + u" kopiert. "_s;
    const QString free = room < 0 ? QString() : u"Dort sind "_s + Amount(room) + u" frei. "_s;
    return UserDialogs().Confirm(
        amount + free + (fits ? u"Fortfahren?"_s : u"Das reicht nicht. Trotzdem fortfahren?"_s),
        u"Fortfahren"_s, fits ? ReturnKey::Agrees : ReturnKey::Declines);
}

bool CopyWhole(const QString& from, const QString& to, const CopyProgress& progress) {
    FileSource source(from);
    if (!QDir().mkpath(QFileInfo(to).path()))
        throw EStreamError(u"Kann den Ordner nicht anlegen: "_s + QFileInfo(to).path());
    SafeFile target(to);
    const QString name = QFileInfo(to).fileName();
    if (!CopyBlocks(source, target,
                    [&](std::int64_t done) { return progress.Reach(name, done, source.Size()); }))
        return false;
    target.Commit();
    return true;
}

void ReportMediaBatch(const MediaBatchResult& result, const QString& done) {
    QString text = SongCountText(static_cast<std::size_t>(result.Done)) + u' ' + done;
    if (!result.Failed.isEmpty())
        text += u", bei "_s + QString::number(result.Failed.size()) + u" ging es nicht"_s;
    text += result.Stopped ? u". Abgebrochen; was bis dahin geschehen ist, bleibt."_s : u"."_s;
    std::vector<ReportSection> sections = {{u"Nicht gelungen"_s, result.Failed, true},
                                           {u"Datenträger nicht eingelegt"_s, result.Missing, true}};
    std::erase_if(sections, [](const ReportSection& section) { return section.Lines.isEmpty(); });
    UserDialogs().ShowReport({.Message = text, .Sections = std::move(sections), .OpenAsText = {}});
}
