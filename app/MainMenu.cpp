#include "app/MainMenu.h"

#include <QMenu>
#include <QMenuBar>

#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/commands/Menu.h"

using namespace Qt::StringLiterals;

namespace {

// Other views have commands of their own for the keys of these.
constexpr int kOfTheList[] = {mcPlay, mcMarkAll, mcRemoveFromDatabase, mcRemoveFromDisk, mcBan, mcCopyTo};

}  // namespace

MainMenu::MainMenu(QMenuBar& bar, TMusicDatabase& database)
    : bar_(bar), database_(database), commands_([&database](int id) { database.ClickMenuItem(id); }) {
    changes_ = database.Commands().Changed.Subscribe([this] { Update(); });
    Update();
}

// Before the menus of others, which stay when these are built anew. One of the old menus may just be running
// the command that is the reason.
void MainMenu::Build() {
    commands_.Clear();
    for (QMenu* old : std::exchange(menus_, {})) {
        bar_.removeAction(old->menuAction());
        old->deleteLater();
    }
    QAction* next = bar_.actions().value(0);
    QString letters;
    for (const auto& item : database_.Menu().Items()) {
        auto* menu = new QMenu(WithAccessKey(item->Caption(), letters), &bar_);
        bar_.insertMenu(next, menu);
        menus_ << menu;
        commands_.Fill(*menu, *item);
        if (item->Find(mcPlay) != nullptr) songMenu_ = menu;
    }
}

void MainMenu::BindTo(QWidget& songList) {
    for (const int id : kOfTheList)
        commands_.Bind(id, songList);
}

void MainMenu::Update() {
    const TMenuExItem& menu = database_.Menu();
    if (std::exchange(revision_, database_.Commands().Revision()) != database_.Commands().Revision()) Build();
    commands_.Update(menu);
}
