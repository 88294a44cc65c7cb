#include "app/MenuIcons.h"

#include <span>

#include "MusicManagment/database/commands/Menu.h"
#include "MusicManagment/playback/PlaySoundMenu.h"
#include "MusicManagment/playlist/PlayListMenu.h"
#include "app/desktop/Icons.h"

namespace {

struct CommandIcon {
    int Id;
    const char16_t* Name;  // in the freedesktop icon themes
    QStyle::StandardPixmap Substitute;
};

constexpr CommandIcon kOfDatabase[] = {
    {mcNew, u"document-new", QStyle::SP_FileIcon},
    {mcOpen, u"document-open", QStyle::SP_DialogOpenButton},
    {mcSave, u"document-save", QStyle::SP_DialogSaveButton},
    {mcSaveAs, u"document-save-as", QStyle::SP_DialogSaveButton},
    {mcUpdate, u"view-refresh", QStyle::SP_BrowserReload},
    {mcAddSongs, u"audio-x-generic", QStyle::SP_FileIcon},
    {mcAddFolder, u"folder-music", QStyle::SP_DirIcon},
    {mcFind, u"edit-find", QStyle::SP_FileDialogContentsView},
    {mcMarkAll, u"edit-select-all", QStyle::SP_FileDialogListView},
    {mcRemoveFromDatabase, u"list-remove", QStyle::SP_TrashIcon},
    {mcCopyTo, u"edit-copy", QStyle::SP_FileIcon},
    {mcPlay, u"media-playback-start", QStyle::SP_MediaPlay},
    {mcAddToPlayList, u"media-playlist-append", QStyle::SP_ArrowRight},
};

constexpr CommandIcon kOfPlayList[] = {
    {pcNew, u"document-new", QStyle::SP_FileIcon},
    {pcOpen, u"document-open", QStyle::SP_DialogOpenButton},
    {pcSave, u"document-save", QStyle::SP_DialogSaveButton},
    {pcSaveAs, u"document-save-as", QStyle::SP_DialogSaveButton},
    {pcExportAsLinks, u"folder-music", QStyle::SP_DirLinkIcon},
    {pcRemoveSelected, u"list-remove", QStyle::SP_TrashIcon},
    {pcMarkCurrent, u"go-jump", QStyle::SP_FileDialogContentsView},
    {pcRemoveUnavailable, u"edit-clear-list", QStyle::SP_DialogResetButton},
};

constexpr CommandIcon kOfPlayer[] = {
    {plPlay, u"media-playback-start", QStyle::SP_MediaPlay},
    {plPause, u"media-playback-pause", QStyle::SP_MediaPause},
    {plStop, u"media-playback-stop", QStyle::SP_MediaStop},
    {plPrevious, u"media-skip-backward", QStyle::SP_MediaSkipBackward},
    {plNext, u"media-skip-forward", QStyle::SP_MediaSkipForward},
    {plBack, u"media-seek-backward", QStyle::SP_MediaSeekBackward},
    {plForward, u"media-seek-forward", QStyle::SP_MediaSeekForward},
    {plMarkSong, u"go-jump", QStyle::SP_FileDialogContentsView},
};

QIcon Find(std::span<const CommandIcon> icons, int id) {
    for (const CommandIcon& icon : icons)
        if (icon.Id == id) return ThemeIcon(QString::fromUtf16(icon.Name), icon.Substitute);
    return {};
}

}  // namespace

QIcon MenuIcon(int id) {
    return Find(kOfDatabase, id);
}

QIcon PlayListIcon(int id) {
    return Find(kOfPlayList, id);
}

QIcon PlayerIcon(int id) {
    return Find(kOfPlayer, id);
}
