#include "MusicManagment/playback/PlaySoundMenu.h"

using namespace Qt::StringLiterals;

namespace {

struct MenuRow {
    QStringView Caption;  // empty: a separator
    int Id = 0;
    QStringView Shortcut{};
    int ImageIndex = -1;
};

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
    using Kind = TMenuExItem::ItemKind;
    auto root = std::make_unique<TMenuExItem>(Kind::Submenu, u"Player"_s);
    for (const MenuRow& row : kRows) {
        const Kind kind = row.Caption.isEmpty() ? Kind::Separator : Kind::Command;
        root->Add(kind, row.Caption.toString(), row.Id, row.Shortcut.toString())
            .SetImageIndex(row.ImageIndex);
    }
    return root;
}
