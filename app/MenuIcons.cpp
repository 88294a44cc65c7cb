#include "app/MenuIcons.h"

#include <algorithm>
#include <iterator>

#include "app/desktop/Icons.h"

namespace {

// Where the desktop has no icon theme, or not this icon.
struct Substitute {
    QStringView Name;
    QStyle::StandardPixmap Pixmap;
};

constexpr Substitute kSubstitutes[] = {
    {u"application-exit", QStyle::SP_DialogCloseButton},
    {u"audio-x-generic", QStyle::SP_FileIcon},
    {u"configure", QStyle::SP_FileDialogDetailedView},
    {u"document-new", QStyle::SP_FileIcon},
    {u"document-open", QStyle::SP_DialogOpenButton},
    {u"document-save", QStyle::SP_DialogSaveButton},
    {u"document-save-as", QStyle::SP_DialogSaveButton},
    {u"edit-clear-list", QStyle::SP_DialogResetButton},
    {u"edit-copy", QStyle::SP_FileIcon},
    {u"edit-find", QStyle::SP_FileDialogContentsView},
    {u"edit-select-all", QStyle::SP_FileDialogListView},
    {u"edit-undo", QStyle::SP_ArrowBack},
    {u"folder-music", QStyle::SP_DirIcon},
    {u"go-jump", QStyle::SP_FileDialogContentsView},
    {u"list-remove", QStyle::SP_TrashIcon},
    {u"media-playback-pause", QStyle::SP_MediaPause},
    {u"media-playback-start", QStyle::SP_MediaPlay},
    {u"media-playback-stop", QStyle::SP_MediaStop},
    {u"media-playlist-append", QStyle::SP_ArrowRight},
    {u"media-seek-backward", QStyle::SP_MediaSeekBackward},
    {u"media-seek-forward", QStyle::SP_MediaSeekForward},
    {u"media-skip-backward", QStyle::SP_MediaSkipBackward},
    {u"media-skip-forward", QStyle::SP_MediaSkipForward},
    {u"tools-wizard", QStyle::SP_FileDialogInfoView},
    {u"view-refresh", QStyle::SP_BrowserReload},
};

}  // namespace

QIcon MenuIcon(QStringView name) {
    if (name.isEmpty()) return {};
    const auto* found = std::ranges::find(kSubstitutes, name, &Substitute::Name);
    return ThemeIcon(name.toString(), found == std::end(kSubstitutes) ? QStyle::SP_FileIcon : found->Pixmap);
}
