#include "app/MenuIcons.h"

#include "MusicManagment/database/Menu.h"
#include "app/desktop/Icons.h"

namespace {

struct CommandIcon {
    int Id;
    const char16_t* Name;  // in the freedesktop icon themes
    QStyle::StandardPixmap Substitute;
};

constexpr CommandIcon kIcons[] = {
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
};

}  // namespace

QIcon MenuIcon(int id) {
    for (const CommandIcon& icon : kIcons)
        if (icon.Id == id) return ThemeIcon(QString::fromUtf16(icon.Name), icon.Substitute);
    return {};
}
