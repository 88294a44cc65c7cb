#include "MusicManagmentRemoteControl/MessageTable.h"

#include <algorithm>

#include "CommonRUKTools/CodePage.h"
#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playlist/PlayList.h"
#include "MusicManagmentRemoteControl/SongAnswers.h"

namespace {

// The components without which a message does nothing.
enum Needs : unsigned { kNothing = 0, kPlayer = 1, kList = 2, kDatabase = 4 };

struct Call {
    const RemoteParts& Parts;
    quint32 Message;
    quint32 P;
    quint32 L;
};

constexpr qint32 kDone = 1;
constexpr qint32 kNoAnswer = 0;  // of messages that tell nobody whether they did anything

struct MessageRow {
    quint32 Message;
    unsigned Needed;
    qint32 Missing;  // the answer when one of these is not there
    qint32 (*Run)(const Call& call);
};

qint32 Answer(quint32 milliseconds) {
    return static_cast<qint32>(milliseconds);  // 32 bits, whatever they mean
}

qint32 MoveTo(const Call& call, quint32 position) {
    call.Parts.PlaySound->SetPosition(position);
    return kNoAnswer;
}

// Opening and closing alone do not tell those who show the player.
qint32 ShowPlayer(const Call& call) {
    call.Parts.PlaySound->RedrawPanel();
    return kDone;
}

qint32 UseEngine(const Call& call, bool EngineSettings::*engine) {
    EngineSettings settings = call.Parts.PlaySound->Engines();
    settings.*engine = call.P != 0;
    call.Parts.PlaySound->SetEngines(settings);
    return kDone;
}

qint32 SendFileName(const Call& call) {
    const QString& name = call.Parts.PlaySound->FileName();
    const QByteArray text = EncodeForWindow(name, call.P);
    return call.Parts.SendCopyData(call.P & kWindowMask, call.L, text) ? kDone : kNoAnswer;
}

qint32 SendSong(const Call& call) {
    if (const auto answer = AnswerAboutSong(*call.Parts.Database, call.Parts.PlaySound, call.Message,
                                            static_cast<qint32>(call.P), call.L))
        call.Parts.SendCopyData(call.L & kWindowMask, answer->Code, answer->Bytes);
    return kNoAnswer;
}

qint32 SetPlayOrder(const Call& call) {
    if (call.P <= poStopAfterPlay) call.Parts.PlayList->SetPlayOrder(static_cast<TPlayOrder>(call.P));
    return kNoAnswer;
}

// There is deliberately no message for the first engine, and "next" and "previous" fade as the player's own
// commands do.
constexpr MessageRow kRows[] = {
    {rmVersion, kNothing, 0, [](const Call&) { return kRemoteVersion; }},
    {rmPlay, kPlayer, 0, [](const Call& call) { return call.Parts.PlaySound->Play(), kDone; }},
    {rmStop, kPlayer, 0,
     [](const Call& call) {
         TPlaySound& player = *call.Parts.PlaySound;
         return player.Stop(player.StopOnDemand()), kDone;
     }},
    {rmPauseResume, kPlayer, 0, [](const Call& call) { return call.Parts.PlaySound->PauseResume(), kDone; }},
    {rmSetPosition, kPlayer, 0, [](const Call& call) { return MoveTo(call, call.P), kDone; }},
    {rmPosition, kPlayer, -1, [](const Call& call) { return Answer(call.Parts.PlaySound->GetPosition()); }},
    {rmLength, kPlayer, -1, [](const Call& call) { return Answer(call.Parts.PlaySound->GetLength()); }},
    {rmStatus, kPlayer, -1, [](const Call& call) { return call.Parts.PlaySound->GetStatus() & 0x7F; }},
    // The sum and the difference wrap, as the numbers of the protocol do.
    {rmForward, kPlayer, 0,
     [](const Call& call) { return MoveTo(call, call.Parts.PlaySound->GetPosition() + call.P); }},
    {rmBack, kPlayer, 0,
     [](const Call& call) { return MoveTo(call, call.Parts.PlaySound->GetPosition() - call.P); }},
    {rmUseMCI, kPlayer, 0, [](const Call& call) { return UseEngine(call, &EngineSettings::UseMCI); }},
    {rmUseEldoS, kPlayer, 0, [](const Call& call) { return UseEngine(call, &EngineSettings::UseEldoS); }},
    {rmUseWinAmp, kPlayer, 0, [](const Call& call) { return UseEngine(call, &EngineSettings::UseWinAmp); }},
    {rmOpen, kPlayer, 0, [](const Call& call) { return call.Parts.PlaySound->Open(), ShowPlayer(call); }},
    {rmClosePlayer, kPlayer, 0,
     [](const Call& call) { return call.Parts.PlaySound->Close(), ShowPlayer(call); }},
    {rmFileName, kPlayer, 0, &SendFileName},
    {rmSongRecord, kDatabase, 0, &SendSong},
    {rmSongFileName, kDatabase, 0, &SendSong},
    {rmSongTitle, kDatabase, 0, &SendSong},
    {rmSongArtist, kDatabase, 0, &SendSong},
    {rmSongAlbum, kDatabase, 0, &SendSong},
    {rmSongComment, kDatabase, 0, &SendSong},
    {rmNext, kPlayer | kList, 0,
     [](const Call& call) {
         return call.Parts.PlayList->PlayNext(call.Parts.PlaySound->ChangeOnDemand()), kNoAnswer;
     }},
    {rmPrevious, kPlayer | kList, 0,
     [](const Call& call) {
         return call.Parts.PlayList->PlayPrevious(call.Parts.PlaySound->ChangeOnDemand()), kNoAnswer;
     }},
    {rmPlayOrder, kList, 0, [](const Call& call) { return qint32{call.Parts.PlayList->PlayOrder()}; }},
    {rmSetPlayOrder, kList, 0, &SetPlayOrder},
    {rmRepeatAll, kList, 0, [](const Call& call) { return qint32{call.Parts.PlayList->RepeatAll()}; }},
    {rmSetRepeatAll, kList, 0,
     [](const Call& call) { return call.Parts.PlayList->SetRepeatAll(call.P != 0), kNoAnswer; }},
    {rmScan, kList, 0, [](const Call& call) { return qint32{call.Parts.PlayList->Scan()}; }},
    {rmSetScan, kList, 0,
     [](const Call& call) { return call.Parts.PlayList->SetScan(call.P != 0), kNoAnswer; }},
    {rmScanTime, kList, -1, [](const Call& call) { return qint32{call.Parts.PlayList->ScanTime()}; }},
    {rmSetScanTime, kList, 0,
     [](const Call& call) { return call.Parts.PlayList->SetScanTime(static_cast<int>(call.P)), kDone; }},
};

bool AreThere(const RemoteParts& parts, unsigned needed) {
    return ((needed & kPlayer) == 0 || parts.PlaySound != nullptr) &&
           ((needed & kList) == 0 || parts.PlayList != nullptr) &&
           ((needed & kDatabase) == 0 || parts.Database != nullptr);
}

}  // namespace

std::optional<qint32> HandleRemoteMessage(const RemoteParts& parts, quint32 message, quint32 p, quint32 l) {
    const auto* row = std::ranges::find(kRows, message, &MessageRow::Message);
    if (row == std::end(kRows)) return std::nullopt;
    return AreThere(parts, row->Needed) ? row->Run({parts, message, p, l}) : row->Missing;
}
