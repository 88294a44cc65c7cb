#include "MusicManagment/playback/PlaySoundMenu.h"

#include "CommonRUKTools/MenuRows.h"

namespace {

constexpr MenuRow kRows[] = {
    {u"Play", plPlay, u"F5", 69, u"media-playback-start"},
    {u"Pause", plPause, u"F6", 70, u"media-playback-pause"},
    {u"Stop", plStop, u"F7", 71, u"media-playback-stop"},
    {},
    {u"Vorheriges", plPrevious, u"F9", 72, u"media-skip-backward"},
    {u"Nächstes", plNext, u"F10", 73, u"media-skip-forward"},
    {},
    {u"10 Sek zurück", plBack, u"Alt+Left", 74, u"media-seek-backward"},
    {u"10 Sek vor", plForward, u"Alt+Right", 75, u"media-seek-forward"},
    {},
    {u"Aktuelles Lied markieren", plMarkSong, {}, 76, u"go-jump"},
};

}  // namespace

std::unique_ptr<TMenuExItem> BuildPlaySoundMenu() {
    return BuildMenu(u"Player", kRows);
}
