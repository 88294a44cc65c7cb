#include "app/CorrectionCommands.h"

#include "CommonRUKTools/CommandDispatcher.h"
#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/batches/BatchReport.h"
#include "MusicManagment/database/batches/Corrections.h"
#include "app/SongChoice.h"
#include "app/dialogs/TagPreviewDialog.h"
#include "app/views/SongListWidget.h"
#include "app/views/WindowSettings.h"

using namespace Qt::StringLiterals;

CorrectionCommands::CorrectionCommands(TMusicDatabase& database, SongListWidget& list)
    : database_(database), list_(list) {
    database_.JoinSettings(*this);
    handlers_ +=
        database_.Commands().Handle(mcCorrect, {.Run = [this] { Correct(ChosenSongs(database_, list_)); }});
    handlers_ += database_.Commands().Handle(mcCorrectAll, {.Run = [this] { Correct(AllSongs(database_)); }});
}

void CorrectionCommands::LoadSettings(const TRWReg& settings) {
    file_ = ReadSetting(settings, WindowSettings::kCorrectionFile).value_or(file_);
}

void CorrectionCommands::SaveSettings(TRWReg& settings) const {
    WriteSetting(settings, WindowSettings::kCorrectionFile, file_);
}

void CorrectionCommands::Correct(const BatchSongs& songs) {
    if (songs.IsEmpty()) return;
    const auto path = UserDialogs().OpenFile({.Title = u"Korrekturdatei auswählen"_s,
                                              .DefaultExtension = u"korrektur"_s,
                                              .Filter = u"Korrekturdateien|*.korrektur|Alle Dateien|*.*"_s,
                                              .Preset = file_});
    if (!path) return;
    const Corrections corrections = ReadCorrections(*path);
    file_ = *path;
    const std::vector<SongUpdate> updates = PlanCorrections(database_, songs, corrections);
    if (updates.empty())
        return UserDialogs().ShowMessage(MessageKind::Information,
                                         u"Keiner der Songs wird nach dieser Datei anders geschrieben."_s);
    TagPreviewDialog dialog(u"Nach Korrekturdatei ändern"_s, u"&Korrigieren"_s,
                            PreviewOf(database_, updates, [](SongHandle) { return std::nullopt; }),
                            list_.window());
    if (dialog.exec() == QDialog::Accepted) ReportBatch(ApplyCorrections(database_, songs, corrections));
}
