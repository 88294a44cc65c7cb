#include "MusicManagment/database/tsdb/OldRecords.h"

#include <optional>

#include "CommonRUKTools/CodePage.h"
#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/tsdb/DatabaseFormat.h"
#include "ReadMPEGHeader/FileNameTag.h"

namespace {

constexpr std::size_t kFileNameField = 261;
constexpr std::size_t kNumbersOffset = 1287;
constexpr quint16 kReservedUnset = 4095;  // later versions use 65535
constexpr quint32 kFlagsUnset = 0xFFFFFFFF;

template <typename T>
std::optional<T> Unless(T unset, T value) {
    return value == unset ? std::nullopt : std::optional<T>(value);
}

QString TextUpToZero(ByteSpan field) {
    return CodePage::FromSystem(field.first(AsText(field).substr(0, AsText(field).find('\0')).size()));
}

SongOverrides StoredValues(ByteSpan bytes, int version) {
    ByteReader reader(bytes);
    reader.Seek(kNumbersOffset);
    SongOverrides values;
    values.Length = Unless<quint16>(0, reader.U16Le());
    values.MainGenre = Unless<quint8>(0, reader.U8());
    reader.Skip(1);
    values.Reserved = Unless(kReservedUnset, reader.U16Le());
    values.PlayCount = Unless<quint32>(0, reader.U32Le());
    if (version == DatabaseFormat::kVersion10) return values;
    values.AddTime = Unless<double>(0, reader.F64Le());
    values.Flags = Unless(kFlagsUnset, reader.U32Le());
    return values;
}

// What is known about a song without its file.
TID3Tag RecordOf(const QString& path, const SongOverrides& values, const TMusicDatabase& database) {
    TID3Tag record;
    if (database.KeepLostSongs() && !IsCdPath(path))
        record = TagFromFileName(path, database.AudioReadOptions().ExcludedArtistFolders);
    else
        ResetTag(false, record, 0);
    record.AddTime = values.AddTime.value_or(0);
    record.Length = values.Length.value_or(0);
    record.MainGenre = values.MainGenre.value_or(0);
    record.Reserved = values.Reserved.value_or(record.Reserved);
    record.PlayCount = values.PlayCount.value_or(0);
    record.Flags = values.Flags.value_or(0);
    return record;
}

}  // namespace

std::size_t OldRecordSize(int version) {
    return version == DatabaseFormat::kVersion10 ? 1297 : 1337;
}

void AddOldSong(TMusicDatabase& database, ByteSpan bytes, int version, bool isCounted, LostSongs& lost) {
    const AddAs as = isCounted ? AddAs::Loaded : AddAs::LoadedUncounted;
    const QString path = TextUpToZero(bytes.first(kFileNameField));
    const SongOverrides values = StoredValues(bytes, version);
    bool isThere = true;
    try {
        if (database.AddSong(path, values, as) >= 0) return;
        isThere = FileSource::Exists(path);
        if (isThere || !(IsCdPath(path) || database.KeepLostSongs())) {
            ++lost.Left;
            return;
        }
    } catch (const EStreamError&) {
        // The file is there but cannot be read now: rights, a bad sector. The song stays, as below.
    }
    // Such a song, and one on a medium that is not there, loses its tags but not its place in the collection.
    const AddAs unseen = isThere || isCounted || IsCdPath(path) ? as : AddAs::Returning;
    const bool added = database.AddEntry(path, RecordOf(path, values, database), unseen) >= 0;
    ++(added ? lost.Kept : lost.Left);
}
