#include "MusicManagment/database/batches/BatchReport.h"

using namespace Qt::StringLiterals;

namespace {

QString Sentence(const BatchResult& result) {
    QString text = SongCountText(static_cast<std::size_t>(result.Changed)) + u" geändert"_s;
    if (result.Renamed > 0)
        text += u", "_s + SongCountText(static_cast<std::size_t>(result.Renamed)) + u" umbenannt"_s;
    if (!result.Failed.isEmpty())
        text += u", "_s + SongCountText(static_cast<std::size_t>(result.Failed.size())) +
                u" konnte(n) nicht geändert werden"_s;
    return text + (result.Stopped ? u". Abgebrochen; was bis dahin geändert ist, bleibt."_s : u"."_s);
}

}  // namespace

void ReportBatch(const BatchResult& result, std::vector<ReportSection> sections) {
    sections.insert(sections.begin(), {u"Nicht geändert werden konnte(n)"_s, result.Failed, true});
    // A complaint about nothing would open the report all the same.
    std::erase_if(sections, [](const ReportSection& section) { return section.Lines.isEmpty(); });
    UserDialogs().ShowReport(
        {.Message = Sentence(result), .Sections = std::move(sections), .OpenAsText = {}});
}

void ReportAdaption(const GenreAdaption& result) {
    ReportBatch(result.Updates, {{u"Kein passendes Genre"_s, result.WithoutGenre, false}});
}

void ReportLengths(const LengthBatchResult& result) {
    std::vector<ReportSection> sections = {{u"Beschädigt"_s, result.Damaged, true}};
    if (!result.Remark.isEmpty()) sections.push_back({u"Hinweis"_s, {result.Remark}});
    ReportBatch(result.Updates, std::move(sections));
}

void TellOfPassedMarks(const BatchSongs& songs) {
    if (songs.Passed == 0) return;
    UserDialogs().ShowMessage(MessageKind::Warning, u"Es werden höchstens "_s + SongCountText(kMostMarks) +
                                                        u" auf einmal bearbeitet. Übergangen: "_s +
                                                        SongCountText(songs.Passed));
}
