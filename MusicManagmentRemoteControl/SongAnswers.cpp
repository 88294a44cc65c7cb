#include "MusicManagmentRemoteControl/SongAnswers.h"

#include "CommonRUKTools/CodePage.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/tsdb/PackedRecord.h"
#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagmentRemoteControl/RemoteMessages.h"

namespace {

constexpr qint32 kPlayingSong = -1;

// In the order of their messages.
constexpr QString TID3Tag::*kTexts[] = {&TID3Tag::FileName, &TID3Tag::Title, &TID3Tag::Artist,
                                        &TID3Tag::Album, &TID3Tag::Comment};

bool WantsUtf8(quint32 window) {
    return (window & ~kWindowMask) == kUtf8Window;
}

}  // namespace

QByteArray EncodeForWindow(const QString& text, quint32 window) {
    return WantsUtf8(window) ? text.toUtf8() : CodePage::ToLegacy(text);
}

std::optional<SongAnswer> AnswerAboutSong(const TMusicDatabase& database, const TPlaySound* player,
                                          quint32 message, qint32 index, quint32 window) {
    if (index == kPlayingSong) index = player == nullptr ? -1 : player->SongInDatabase();
    if (index < 0 || index >= database.Count()) return std::nullopt;
    const TID3Tag& song = database.Song(index);
    if (message == rmSongRecord) {
        const auto record = PackedRecord(song);
        return SongAnswer{message, QByteArray(reinterpret_cast<const char*>(record.data()), record.size())};
    }
    const quint32 code = WantsUtf8(window) ? message + kUtf8Code : message;
    return SongAnswer{code, EncodeForWindow(song.*kTexts[message - rmSongFileName], window)};
}
