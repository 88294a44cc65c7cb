#include "app/MainMenu.h"

#include <QAction>
#include <QActionGroup>
#include <QMenu>
#include <QMenuBar>

#include "MusicManagment/database/Menu.h"
#include "MusicManagment/database/MusicManagment.h"
#include "app/MenuIcons.h"
#include "app/desktop/Icons.h"

using namespace Qt::StringLiterals;

namespace {

// Marks the first letter that no other item of the menu is chosen by.
QString WithKey(const QString& caption, QString& taken) {
    QString text = caption;
    text.replace(u'&', u"&&"_s);
    for (qsizetype i = 0; i < caption.size(); ++i) {
        const QChar letter = caption[i].toLower();
        if (!letter.isLetter() || taken.contains(letter) || caption.contains(u'&')) continue;
        taken += letter;
        return text.insert(i, u'&');
    }
    return text;
}

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
    actions_.clear();
    readOnly_ = database_.ReadOnly();
    QAction* next = bar_.actions().value(0);
    QString keys;
    QMenu* settingsMenu = nullptr;
    for (const auto& item : database_.Menu().Items()) {
        auto* menu = new QMenu(WithKey(item->Caption(), keys), &bar_);
        bar_.insertMenu(next, menu);
        menus_ << menu;
        AddItems(*menu, *item);
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
    TMenuExItem& menu = database_.Menu();
    for (auto action = actions_.cbegin(); action != actions_.cend(); ++action) {
        const TMenuExItem* item = menu.Find(action.key());
        if (item == nullptr) continue;
        (*action)->setEnabled(item->Enabled() && !running_);
        (*action)->setToolTip(item->Hint());
        if (item->Checkable()) (*action)->setChecked(item->Checked());
    }
}

void MainMenu::AddItems(QMenu& menu, const TMenuExItem& parent) {
    menu.setToolTipsVisible(true);
    QString keys = KeysOfOwnItems(&menu == menus_.first(), parent);
    auto* group = new QActionGroup(&menu);
    for (const auto& item : parent.Items()) {
        switch (item->Kind()) {
            case TMenuExItem::ItemKind::Separator:
                menu.addSeparator();
                break;
            case TMenuExItem::ItemKind::Submenu:
                AddItems(*menu.addMenu(WithKey(item->Caption(), keys)), *item);
                break;
            default:
                AddCommand(menu, *item);
        }
        if (item->Kind() == TMenuExItem::ItemKind::Radio) group->addAction(actions_[item->Id()]);
        if (QAction* action = actions_.value(item->Id())) action->setText(WithKey(item->Caption(), keys));
    }
}

void MainMenu::AddCommand(QMenu& menu, const TMenuExItem& item) {
    QAction* action = menu.addAction(MenuIcon(item.Id()), item.Caption());
    action->setShortcut(QKeySequence(item.Shortcut()));
    action->setCheckable(item.Checkable());
    if (item.IsDefault()) menu.setDefaultAction(action);
    QObject::connect(action, &QAction::triggered, &menu, [this, id = item.Id()] {
        run_(id);
        Update();  // a click on a radio item that was refused leaves the old mark
    });
    actions_.insert(item.Id(), action);
}
