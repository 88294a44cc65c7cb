#include "MusicManagment/database/batches/FlagBatch.h"

#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/batches/BatchFrame.h"

using namespace Qt::StringLiterals;

namespace {

struct FlagTexts {
    QStringView Question;
    QStringView Prompt;
    BatchTexts Batch;
};

constexpr FlagTexts kSetting = {.Question = u"Flag setzen",
                                .Prompt = u"Welches Flag soll gesetzt werden?",
                                .Batch = {.All = u"Flag für alle Songs setzen",
                                          .Marked = u"Flag für alle markierten Songs setzen",
                                          .One = u"Flag setzen"}};
constexpr FlagTexts kRemoving = {.Question = u"Flag entfernen",
                                 .Prompt = u"Welches Flag soll entfernt werden?",
                                 .Batch = {.All = u"Flag für alle Songs entfernen",
                                           .Marked = u"Flag für alle markierten Songs entfernen",
                                           .One = u"Flag entfernen"}};

const FlagTexts& TextsOf(FlagChange change) {
    return change == FlagChange::Set ? kSetting : kRemoving;
}

}  // namespace

std::optional<TSongFlag> FlagByName(const QString& name) {
    const qsizetype bit = SongFlagNames().indexOf(name);
    if (bit < 0) return std::nullopt;
    return static_cast<TSongFlag>(1u << bit);
}

std::optional<TSongFlag> AskForFlag(FlagChange change) {
    const FlagTexts& texts = TextsOf(change);
    const QStringList names = SongFlagNames();
    const auto chosen =
        UserDialogs().Input(texts.Question.toString(), texts.Prompt.toString(), names, names.first());
    return chosen ? FlagByName(*chosen) : std::nullopt;
}

BatchResult ChangeFlag(TMusicDatabase& database, const BatchSongs& songs, TSongFlag flag, FlagChange change) {
    const FlagTexts& texts = TextsOf(change);
    const auto update = [&](const TID3Tag& song) -> std::optional<TID3Tag> {
        const quint32 flags = change == FlagChange::Set ? song.Flags | flag : song.Flags & ~quint32{flag};
        if (flags == song.Flags) return std::nullopt;
        TID3Tag changed = song;
        changed.Flags = flags;
        return changed;
    };
    return RunBatch(database, songs, texts.Batch, texts.Question.toString(), update);
}
