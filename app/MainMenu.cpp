#include "app/MainMenu.h"

#include <QAction>
#include <QMenu>
#include <QMenuBar>

#include "MusicManagment/database/Menu.h"
#include "MusicManagment/database/MusicManagment.h"
#include "app/MenuIcons.h"
#include "app/desktop/Icons.h"

using namespace Qt::StringLiterals;

namespace {

// Other views have commands of their own for the keys of these.
constexpr int kOfTheList[] = {mcPlay, mcMarkAll, mcRemoveFromDatabase, mcRemoveFromDisk, mcBan, mcCopyTo};

}  // namespace

MainMenu::MainMenu(QMenuBar& bar, TMusicDatabase& database, std::function<void(int id)> run,
                   std::function<void()> exit)
    : bar_(bar), database_(database), run_(std::move(run)), exit_(std::move(exit)) {
    Build();
    Update();
}

// Before the menus of others, which stay when these are built anew.
void MainMenu::Build() {
    qDeleteAll(std::exchange(menus_, {}));
    commands_.Clear();
    readOnly_ = database_.ReadOnly();
    QAction* next = bar_.actions().value(0);
    QString keys;
    for (const auto& item : database_.Menu().Items()) {
        auto* menu = new QMenu(WithAccessKey(item->Caption(), keys), &bar_);
        bar_.insertMenu(next, menu);
        menus_ << menu;
        commands_.Fill(*menu, *item, menus_.size() == 1 ? u"b"_s : QString());  // "Beenden" comes behind
        if (item->Find(mcPlay) != nullptr) songMenu_ = menu;
    }
    AddExit();
}

void MainMenu::AddExit() {
    QMenu& first = *menus_.first();
    first.addSeparator();
    QAction* last =
        first.addAction(ThemeIcon(u"application-exit"_s, QStyle::SP_DialogCloseButton), u"&Beenden"_s);
    last->setShortcut(QKeySequence(u"Ctrl+Q"_s));
    QObject::connect(last, &QAction::triggered, &first, [this] { exit_(); });
}

void MainMenu::BindTo(QWidget& songList) {
    for (const int id : kOfTheList)
        commands_.Bind(id, songList);
}

void MainMenu::SetRunning(bool running) {
    running_ = running;
    Update();
}

void MainMenu::Update() {
    if (readOnly_ != database_.ReadOnly()) Build();
    commands_.Update(database_.Menu(), running_);
}

void MainMenu::Run(int id) {
    run_(id);
    Update();  // a click on a radio item that was refused leaves the old mark
}
