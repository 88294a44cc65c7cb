#include "MusicManagment/playlist/PlayListMenu.h"

#include "CommonRUKTools/MenuRows.h"

namespace {

constexpr MenuRow kRows[] = {
    {u"Neue PlayList", pcNew, u"Ctrl+Shift+N", 60},
    {u"PlayList öffnen...", pcOpen, u"Ctrl+Shift+O", 61},
    {u"PlayList speichern", pcSave, u"Ctrl+Shift+S", 62},
    {u"PlayList speichern unter...", pcSaveAs, u"Ctrl+Alt+Shift+S", 63},
    {u"PlayList als Link-Liste speichern...", pcExportAsLinks, {}, 64},
    {},
    {u"Markierte Einträge entfernen", pcRemoveSelected, u"Del", 65},
    {u"Dieses Lied markieren", pcMarkCurrent, u"Ctrl+Shift+F", 66},
    {u"Nicht verfügbare Lieder entfernen", pcRemoveUnavailable, u"Ctrl+Shift+Del", 67},
};

}  // namespace

std::unique_ptr<TMenuExItem> BuildPlayListMenu() {
    return BuildMenu(u"PlayList", kRows);
}
