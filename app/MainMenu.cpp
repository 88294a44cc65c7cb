#include "app/MainMenu.h"

#include <QAction>
#include <QMenu>
#include <QMenuBar>

#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/commands/Menu.h"
#include "app/MenuIcons.h"
#include "app/desktop/Icons.h"

using namespace Qt::StringLiterals;

namespace {

// Other views have commands of their own for the keys of these.
constexpr int kOfTheList[] = {mcPlay, mcMarkAll, mcRemoveFromDatabase, mcRemoveFromDisk, mcBan, mcCopyTo};

// The keys of the items that are no commands of the database and come behind these.
QString KeysOfOwnItems(bool isFirst, const TMenuExItem& parent) {
    if (parent.Find(mcSearchNew) != nullptr) return u"ei"_s;  // AddSettings
    return isFirst ? u"bi"_s : QString();                     // "Beenden", and settings without "Extras"
}

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
    QMenu* settingsMenu = nullptr;
    for (const auto& item : database_.Menu().Items()) {
        auto* menu = new QMenu(WithAccessKey(item->Caption(), keys), &bar_);
        bar_.insertMenu(next, menu);
        menus_ << menu;
        commands_.Fill(*menu, *item, KeysOfOwnItems(menus_.size() == 1, *item));
        if (item->Find(mcPlay) != nullptr) songMenu_ = menu;
        if (item->Find(mcSearchNew) != nullptr) settingsMenu = menu;
    }
    if (options_) BuildSettings(settingsMenu != nullptr ? *settingsMenu : *menus_.first());
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

void MainMenu::AddSettings(std::function<void()> options, std::function<void()> wizard) {
    options_ = std::move(options);
    wizard_ = std::move(wizard);
    Build();
    Update();
}

// A database that is only read has no menu "Extras".
void MainMenu::BuildSettings(QMenu& menu) {
    menu.addSeparator();
    QAction* first =
        menu.addAction(ThemeIcon(u"configure"_s, QStyle::SP_FileDialogDetailedView), u"&Einstellungen..."_s);
    first->setShortcut(QKeySequence(u"Ctrl+,"_s));
    QAction* second = menu.addAction(ThemeIcon(u"tools-wizard"_s, QStyle::SP_FileDialogInfoView),
                                     u"E&inrichtungsassistent..."_s);
    QObject::connect(first, &QAction::triggered, &menu, [this] { options_(); });
    QObject::connect(second, &QAction::triggered, &menu, [this] { wizard_(); });
    settings_ = {first, second};
}

void MainMenu::SetRunning(bool running) {
    running_ = running;
    Update();
}

void MainMenu::Update() {
    if (readOnly_ != database_.ReadOnly()) Build();
    for (QAction* action : settings_)
        action->setEnabled(!running_);
    commands_.Update(database_.Menu(), running_);
}

void MainMenu::Run(int id) {
    run_(id);
    Update();  // a click on a radio item that was refused leaves the old mark
}
