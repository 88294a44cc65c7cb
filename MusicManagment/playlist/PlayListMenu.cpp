#include "MusicManagment/playlist/PlayListMenu.h"

#include "CommonRUKTools/MenuRows.h"

namespace {

constexpr MenuRow kRows[] = {
    {u"Neue PlayList", pcNew, u"Ctrl+Shift+N", 60, u"document-new"},
    {u"PlayList öffnen...", pcOpen, u"Ctrl+Shift+O", 61, u"document-open"},
    {u"PlayList speichern", pcSave, u"Ctrl+Shift+S", 62, u"document-save"},
    {u"PlayList speichern unter...", pcSaveAs, u"Ctrl+Alt+Shift+S", 63, u"document-save-as"},
    {u"PlayList als Link-Liste speichern...", pcExportAsLinks, {}, 64, u"folder-music"},
    {},
    {u"Markierte Einträge entfernen", pcRemoveSelected, u"Del", 65, u"list-remove"},
    {u"Dieses Lied markieren", pcMarkCurrent, u"Ctrl+Shift+F", 66, u"go-jump"},
    {u"Nicht verfügbare Lieder entfernen", pcRemoveUnavailable, u"Ctrl+Shift+Del", 67, u"edit-clear-list"},
};

}  // namespace

std::unique_ptr<TMenuExItem> BuildPlayListMenu() {
    return BuildMenu(u"PlayList", kRows);
}
