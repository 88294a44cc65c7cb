#include "app/ConversionCommands.h"

#include "CommonRUKTools/CommandDispatcher.h"
#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/batches/BatchReport.h"
#include "app/SongChoice.h"
#include "app/dialogs/ConversionDialog.h"
#include "app/views/SongListWidget.h"
#include "app/views/WindowSettings.h"

using namespace Qt::StringLiterals;

ConversionCommands::ConversionCommands(TMusicDatabase& database, SongListWidget& list)
    : database_(database), list_(list) {
    database_.JoinSettings(*this);
    for (const int id : {mcConvert, mcConvertMarked})
        handlers_ += database_.Commands().Handle(id, {.Run = [this] { Convert(); }});
}

void ConversionCommands::Convert() {
    if (database_.Count() == 0) return;
    const BatchSongs marked = MarkedIn(database_, list_);
    ConversionSettings& stored = database_.Conversion();
    ConversionChoice choice{
        .Range = BatchRange::Marked,
        .Order = {.Format = FormatOf(stored.LastMusicFormat), .Place = place_, .Folder = folder_},
        .Settings = ReadEncoderSettings(stored)};
    ConversionDialog dialog(choice, marked.Songs.size(), static_cast<std::size_t>(database_.Count()),
                            list_.window());
    if (dialog.exec() != QDialog::Accepted) return;
    choice = dialog.Choice();
    StoreEncoderSettings(choice.Settings, stored);
    stored.LastMusicFormat = static_cast<quint8>(choice.Order.Format);
    place_ = choice.Order.Place;
    folder_ = choice.Order.Folder;
    if (choice.Range == BatchRange::Marked) TellOfPassedMarks(marked);
    ReportMediaBatch(
        ConvertSongs(database_, choice.Range == BatchRange::All ? AllSongs(database_) : marked, choice.Order),
        u"konvertiert"_s);
}

void ConversionCommands::LoadSettings(const TRWReg& settings) {
    if (const auto place = ReadSetting(settings, WindowSettings::kConversionPlace))
        place_ = static_cast<ConversionPlace>(*place);
    folder_ = ReadSetting(settings, WindowSettings::kConversionFolder).value_or(folder_);
}

void ConversionCommands::SaveSettings(TRWReg& settings) const {
    WriteSetting(settings, WindowSettings::kConversionPlace, static_cast<int>(place_));
    WriteSetting(settings, WindowSettings::kConversionFolder, folder_);
}
