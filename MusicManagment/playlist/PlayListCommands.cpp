#include <QDir>

#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/playlist/LinkFolder.h"
#include "MusicManagment/playlist/ListNames.h"
#include "MusicManagment/playlist/PlayList.h"
#include "MusicManagment/playlist/PlayListFiles.h"
#include "MusicManagment/playlist/PlayListMenu.h"
#include "MusicManagment/playlist/PlayListView.h"

// Loading and saving, and the commands for that.

using namespace Qt::StringLiterals;

namespace {

FileDialogOptions DialogOptions(const QString& title, const QString& filter, const QString& preset) {
    FileDialogOptions options;
    options.Title = title;
    options.DefaultExtension = u"rukpl"_s;
    options.Filter = filter;
    options.Preset = preset;
    return options;
}

std::optional<QString> AskForTarget(const QString& filter, const QString& preset) {
    FileDialogOptions options = DialogOptions(u"PlayList speichern unter"_s, filter, preset);
    options.ConfirmOverwrite = true;
    return UserDialogs().SaveFile(options);
}

}  // namespace

void TPlayList::SetPlayListFileName(const QString& fileName) {
    if (fileName.isEmpty()) return Replace({}, {});
    try {
        Replace(ReadList(fileName), fileName);
    } catch (const EUnknownPlayListVersion&) {
        Replace({}, {});  // without a name, so that nothing empty is saved over a list
        throw;
    }
}

std::vector<PlayListEntry> TPlayList::ReadList(const QString& fileName) const {
    ListOrigin origin{.FileName = fileName};
    if (database_) origin.Known = [this](const QString& name) { return database_->Songs().Find(name); };
    return ReadPlayList(*rules_, origin);
}

void TPlayList::Replace(std::vector<PlayListEntry> entries, const QString& fileName) {
    Clear();
    entries_.Assign(std::move(entries));
    SetFile(fileName);
    events_.Loaded.Tell();
}

// The file holds what the list is now.
void TPlayList::SetFile(const QString& fileName) {
    const bool differs = fileName != playListFileName_ || modified_;
    playListFileName_ = fileName;
    modified_ = false;
    if (differs) events_.NameChanged.Tell();
}

std::vector<EntryToSave> TPlayList::EntriesForSaving() const {
    std::vector<EntryToSave> entries;
    entries.reserve(static_cast<std::size_t>(Count()));
    for (int index = 0; index < Count(); ++index)
        entries.push_back({&Entry(index), ResolvedPath(NameAt(index), {.Ask = false})});
    return entries;
}

void TPlayList::Save(const QString& fileName) {
    WritePlayList(fileName, rules_->FormatOfName(fileName), EntriesForSaving());
    SetFile(fileName);
}

bool TPlayList::SaveOrAsk(bool askForName) {
    std::optional<QString> target = playListFileName_;
    if (askForName || target->isEmpty()) target = AskForTarget(rules_->DialogFilter(), playListFileName_);
    if (!target || target->isEmpty()) return false;
    Save(*target);
    return true;
}

bool TPlayList::MayBeReplaced() {
    const bool isNothing = Count() == 0 && playListFileName_.isEmpty();
    // The next list takes the place of one that has come from the last run.
    const bool isHomeless = Count() > 0 && playListFileName_ == standardFileName_;
    if (isNothing || !(modified_ || isHomeless)) return true;
    enum { buSave, buDiscard, buCancel };
    const int answer = UserDialogs().Ask(
        {.Text = modified_ ? u"Die PlayList wurde geändert. Sollen die Änderungen gespeichert werden?"_s
                           : u"Die PlayList hat noch keine eigene Datei. Soll sie gespeichert werden?"_s,
         .Buttons = {u"Speichern"_s, u"Nicht speichern"_s, u"Abbrechen"_s},
         .Cancel = buCancel,
         .Default = buSave});
    if (answer == buSave) return SaveOrAsk(playListFileName_ == standardFileName_);
    return answer == buDiscard;
}

void TPlayList::ExportAsLinks(const QString& folder) {
    QStringList paths;
    for (const EntryToSave& entry : EntriesForSaving())
        if (!entry.Path.isEmpty() && !IsCdPath(entry.Path) && !IsAddress(entry.Path)) paths << entry.Path;
    WriteLinkFolder(folder, paths);
}

void TPlayList::OpenFromDialog() {
    if (!MayBeReplaced()) return;
    const auto chosen = UserDialogs().OpenFile(
        DialogOptions(u"PlayList öffnen"_s, rules_->DialogFilter(), playListFileName_));
    if (chosen && !chosen->isEmpty()) SetPlayListFileName(*chosen);
}

void TPlayList::ExportFromDialog() {
    const auto folder =
        UserDialogs().ChooseFolder(u"PlayList als Link-Liste speichern"_s, QDir::currentPath());
    if (folder && !folder->isEmpty()) ExportAsLinks(*folder);
}

// --- Commands ---

namespace {

constexpr ComponentCommand<TPlayList> kRows[] = {
    {.Id = pcNew,
     .Caption = u"Neue PlayList",
     .Keys = u"Ctrl+Shift+N",
     .Icon = u"document-new",
     .Run =
         [](TPlayList& list, int) {
             if (list.MayBeReplaced()) list.SetPlayListFileName(QString());
         },
     .Image = 60},
    {.Id = pcOpen,
     .Caption = u"PlayList öffnen...",
     .Keys = u"Ctrl+Shift+O",
     .Icon = u"document-open",
     .Run = [](TPlayList& list, int) { list.OpenFromDialog(); },
     .Image = 61},
    {.Id = pcSave,
     .Caption = u"PlayList speichern",
     .Keys = u"Ctrl+Shift+S",
     .Icon = u"document-save",
     .Run = [](TPlayList& list, int) { list.SaveOrAsk(); },
     .Image = 62},
    {.Id = pcSaveAs,
     .Caption = u"PlayList speichern unter...",
     .Keys = u"Ctrl+Alt+Shift+S",
     .Icon = u"document-save-as",
     .Run = [](TPlayList& list, int) { list.SaveOrAsk(true); },
     .Image = 63},
    {.Id = pcExportAsLinks,
     .Caption = u"PlayList als Link-Liste speichern...",
     .Icon = u"folder-music",
     .Run = [](TPlayList& list, int) { list.ExportFromDialog(); },
     .Image = 64},
};

}  // namespace

constinit const PlayListCommands kListFileCommands = kRows;
