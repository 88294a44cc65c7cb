#include <QDir>

#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/playlist/LinkFolder.h"
#include "MusicManagment/playlist/ListNames.h"
#include "MusicManagment/playlist/PlayList.h"
#include "MusicManagment/playlist/PlayListFiles.h"
#include "MusicManagment/playlist/PlayListMenu.h"
#include "MusicManagment/playlist/PlayListView.h"

// Loading and saving, and the commands of the menu.

using namespace Qt::StringLiterals;

namespace {

FileDialogOptions DialogOptions(const QString& title, const QString& preset) {
    FileDialogOptions options;
    options.Title = title;
    options.DefaultExtension = u"rukpl"_s;
    options.Filter =
        u"Alle PlayLists|*.rukpl;*.rpl;*.m3u;*.extpl;*.pl;*.txtpl;*.pls;*.inipl|RUK Playlist|*.rukpl;*.rpl|"
        "M3U PlayLists|*.m3u;*.extpl|PL PlayLists|*.pl;*.txtpl|PLS PlayLists|*.pls;*.inipl|"
        "Alle Dateien|*.*"_s;
    options.Preset = preset;
    return options;
}

std::optional<QString> AskForTarget(const QString& preset) {
    FileDialogOptions options = DialogOptions(u"PlayList speichern unter"_s, preset);
    options.ConfirmOverwrite = true;
    return UserDialogs().SaveFile(options);
}

}  // namespace

void TPlayList::SetPlayListFileName(const QString& fileName) {
    if (fileName.isEmpty()) return Replace({}, {});
    try {
        Replace(ReadPlayList(fileName), fileName);
    } catch (const EUnknownPlayListVersion&) {
        Replace({}, {});  // without a name, so that nothing empty is saved over a list
        throw;
    }
}

void TPlayList::Replace(std::vector<PlayListEntry> entries, const QString& fileName) {
    Clear();
    entries_.Assign(std::move(entries));
    playListFileName_ = fileName;
    RaiseChange(-1, ctChanged);
}

std::vector<EntryToSave> TPlayList::EntriesForSaving() const {
    std::vector<EntryToSave> entries;
    entries.reserve(static_cast<std::size_t>(Count()));
    for (int index = 0; index < Count(); ++index)
        entries.push_back({&Entry(index), ResolvedPath(NameAt(index), {.Ask = false})});
    return entries;
}

void TPlayList::Save(const QString& fileName) {
    WritePlayList(fileName, EntriesForSaving());
    playListFileName_ = fileName;
}

bool TPlayList::SaveOrAsk(bool askForName) {
    std::optional<QString> target = playListFileName_;
    if (askForName || target->isEmpty()) target = AskForTarget(playListFileName_);
    if (!target || target->isEmpty()) return false;
    Save(*target);
    return true;
}

void TPlayList::ExportAsLinks(const QString& folder) {
    QStringList paths;
    for (const EntryToSave& entry : EntriesForSaving())
        if (!entry.Path.isEmpty() && !IsCdPath(entry.Path) && !IsAddress(entry.Path)) paths << entry.Path;
    WriteLinkFolder(folder, paths);
}

// --- Menu ---

TMenuExItem& TPlayList::Menu() {
    if (!menu_) menu_ = BuildPlayListMenu();
    return *menu_;
}

void TPlayList::OpenFromDialog() {
    const auto chosen = UserDialogs().OpenFile(DialogOptions(u"PlayList öffnen"_s, playListFileName_));
    if (chosen && !chosen->isEmpty()) SetPlayListFileName(*chosen);
}

void TPlayList::ExportFromDialog() {
    const auto folder =
        UserDialogs().ChooseFolder(u"PlayList als Link-Liste speichern"_s, QDir::currentPath());
    if (folder && !folder->isEmpty()) ExportAsLinks(*folder);
}

bool TPlayList::ClickMenuItem(int id) {
    switch (id) {
        case pcNew:
            SetPlayListFileName(QString());
            return true;
        case pcOpen:
            OpenFromDialog();
            return true;
        case pcSave:
            SaveOrAsk();
            return true;
        case pcSaveAs:
            SaveOrAsk(true);
            return true;
        case pcExportAsLinks:
            ExportFromDialog();
            return true;
        case pcRemoveSelected:
            if (view_ != nullptr) Remove(view_->SelectedEntries());
            return true;
        case pcMarkCurrent:
            MarkSong();
            return true;
        case pcRemoveUnavailable:
            RemoveUnavailable();
            return true;
        default:
            return false;
    }
}
