#include "app/MainMenu.h"

#include <QMenu>
#include <QMenuBar>

#include "CommonRUKTools/CommandDispatcher.h"
#include "MusicManagment/database/Command.h"

using namespace Qt::StringLiterals;

namespace {

// Other views have commands of their own for the keys of these.
constexpr int kOfTheList[] = {mcPlay, mcMarkAll, mcRemoveFromDatabase, mcRemoveFromDisk, mcBan, mcCopyTo};

}  // namespace

MainMenu::MainMenu(QMenuBar& bar, CommandDispatcher& commands)
    : bar_(bar), commands_(commands), shown_(commands) {
    changes_ = commands.Changed.Subscribe([this] { BuildWhenOther(); });
    BuildWhenOther();
}

// Before the menus of others, which stay when these are built anew. One of the old menus may just be running
// the command that is the reason.
void MainMenu::Build() {
    shown_.Clear();
    for (QMenu* old : std::exchange(menus_, {})) {
        bar_.removeAction(old->menuAction());
        old->deleteLater();
    }
    songMenu_ = nullptr;
    QAction* next = bar_.actions().value(0);
    QString letters;
    for (const auto& item : commands_.ShownMenu().Items()) {
        auto* menu = new QMenu(WithAccessKey(item->Caption(), letters), &bar_);
        bar_.insertMenu(next, menu);
        menus_ << menu;
        shown_.Fill(*menu, *item);
        if (item->Find(mcPlay) != nullptr) songMenu_ = menu;
    }
}

void MainMenu::BindTo(QWidget& songList) {
    for (const int id : kOfTheList)
        shown_.Bind(id, songList);
}

void MainMenu::BuildWhenOther() {
    commands_.Menu();
    if (std::exchange(revision_, commands_.Revision()) == commands_.Revision()) return;
    Build();
    shown_.Update();
}
