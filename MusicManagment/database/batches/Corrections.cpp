#include "MusicManagment/database/batches/Corrections.h"

#include <QFile>
#include <algorithm>

#include "CommonRUKTools/ByteReader.h"
#include "CommonRUKTools/CodePage.h"
#include "CommonRUKTools/Errors.h"
#include "MusicManagment/database/batches/BatchFrame.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kMostBytes = 16 * 1024 * 1024;

constexpr int kLongestChain = 16;

constexpr BatchTexts kTexts = {.All = u"Korrektur aller Songs",
                               .Marked = u"Korrektur aller markierter Songs",
                               .One = u"Korrektur eines Songs"};

[[noreturn]] void Refuse(int line, const QString& what) {
    throw ERukException(u"Zeile %1: "_s.arg(line) + what);
}

}  // namespace

Corrections Corrections::FromText(QStringView text) {
    Corrections corrections;
    Replacements* section = nullptr;
    int number = 0;
    for (QStringView line : text.split(u'\n')) {
        ++number;
        line = line.trimmed();
        if (line.isEmpty() || line.startsWith(u'#')) continue;
        if (line.compare(u"[Artist]", Qt::CaseInsensitive) == 0)
            section = &corrections.artists_;
        else if (line.compare(u"[Titel]", Qt::CaseInsensitive) == 0)
            section = &corrections.titles_;
        else if (section == nullptr)
            Refuse(number, u"Davor fehlt eine Zeile [Artist] oder [Titel]."_s);
        else
            Add(*section, line, number);
    }
    FollowChains(corrections.artists_);
    FollowChains(corrections.titles_);
    return corrections;
}

void Corrections::Add(Replacements& replacements, QStringView line, int number) {
    constexpr QStringView kBetween = u" = ";
    const qsizetype between = line.indexOf(kBetween);
    if (between < 0 || line.indexOf(kBetween, between + 1) >= 0)
        Refuse(number, u"Erwartet wird \"falsch = richtig\"."_s);
    const QString wrong = line.left(between).trimmed().toString().toCaseFolded();
    if (const auto known = replacements.constFind(wrong); known != replacements.constEnd())
        Refuse(number, u"Für diesen Text steht schon in Zeile %1 eine Korrektur."_s.arg(known->Line));
    replacements.insert(wrong, {line.mid(between + kBetween.size()).trimmed().toString(), number});
}

// What a replacement leads to may be wrong itself.
void Corrections::FollowChains(Replacements& replacements) {
    const Replacements asWritten = replacements;
    int endless = 0;  // the first line that leads nowhere; the replacements have no order
    for (Replacement& replacement : replacements) {
        for (int steps = 0;; ++steps) {
            const auto next = asWritten.constFind(replacement.Right.toCaseFolded());
            if (next == asWritten.constEnd() || next->Right == replacement.Right) break;
            if (steps == kLongestChain) {
                endless = endless == 0 ? replacement.Line : std::min(endless, replacement.Line);
                break;
            }
            replacement.Right = next->Right;
        }
    }
    if (endless != 0) Refuse(endless, u"Diese Korrektur führt im Kreis oder über zu viele andere."_s);
}

std::optional<TID3Tag> Corrections::Corrected(const TID3Tag& song) const {
    TID3Tag corrected = song;
    const auto correct = [](QString& text, const Replacements& replacements) {
        const auto found = replacements.constFind(text.trimmed().toCaseFolded());
        if (found != replacements.constEnd()) text = found->Right;
    };
    correct(corrected.Artist, artists_);
    correct(corrected.Title, titles_);
    return corrected != song ? std::optional(corrected) : std::nullopt;
}

Corrections ReadCorrections(const QString& path) {
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly))
        throw ERukException(u"Kann die Datei %1 nicht lesen: %2"_s.arg(path, file.errorString()));
    if (file.size() > kMostBytes) throw ERukException(u"Die Datei %1 ist zu groß."_s.arg(path));
    try {
        return Corrections::FromText(CodePage::FromSystem(AsBytes(file.read(kMostBytes).toStdString())));
    } catch (const ERukException& fault) {
        throw ERukException(path + u"\n"_s + fault.Message());
    }
}

std::vector<SongUpdate> PlanCorrections(const TMusicDatabase& database, const BatchSongs& songs,
                                        const Corrections& corrections) {
    std::vector<SongUpdate> updates;
    for (const SongHandle song : songs.Songs) {
        const TID3Tag* record = database.Songs().Find(song);
        if (record == nullptr) continue;
        if (auto corrected = corrections.Corrected(*record))
            updates.push_back({.Song = song, .Basis = *record, .Record = std::move(*corrected)});
    }
    return updates;
}

BatchResult ApplyCorrections(TMusicDatabase& database, const BatchSongs& songs,
                             const Corrections& corrections) {
    return RunBatch(database, songs, kTexts, u"Korrigieren"_s,
                    [&](const TID3Tag& song) { return corrections.Corrected(song); });
}
