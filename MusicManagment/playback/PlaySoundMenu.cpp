#include "MusicManagment/playback/PlaySoundMenu.h"

#include "CommonRUKTools/MenuRows.h"

namespace {

constexpr MenuRow kRows[] = {
    {u"Play", plPlay, u"F5", 69},
    {u"Pause", plPause, u"F6", 70},
    {u"Stop", plStop, u"F7", 71},
    {},
    {u"Vorheriges", plPrevious, u"F9", 72},
    {u"Nächstes", plNext, u"F10", 73},
    {},
    {u"10 Sek zurück", plBack, u"Alt+Left", 74},
    {u"10 Sek vor", plForward, u"Alt+Right", 75},
    {},
    {u"Aktuelles Lied markieren", plMarkSong, {}, 76},
};

}  // namespace

std::unique_ptr<TMenuExItem> BuildPlaySoundMenu() {
    return BuildMenu(u"Player", kRows);
}
