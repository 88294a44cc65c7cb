#include "app/CommandMenu.h"

#include <QAction>
#include <QActionGroup>
#include <QMenu>

#include "CommonRUKTools/CommandDispatcher.h"
#include "CommonRUKTools/CommandRunner.h"
#include "app/MenuIcons.h"

using namespace Qt::StringLiterals;

QString WithAccessKey(const QString& caption, QString& taken) {
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

void AddAccessKeys(const QMenu& menu) {
    QString taken;
    QList<QAction*> unmarked;
    for (QAction* action : menu.actions()) {
        const qsizetype mark = action->text().indexOf(u'&');
        if (mark >= 0)
            taken += action->text().mid(mark + 1, 1).toLower();
        else if (!action->isSeparator())
            unmarked << action;
    }
    for (QAction* action : unmarked)
        action->setText(WithAccessKey(action->text(), taken));
}

namespace {

// The Enter key of the number block does what Return does.
QList<QKeySequence> ShortcutsOf(const TMenuExItem& item) {
    QList<QKeySequence> shortcuts{QKeySequence(item.Shortcut())};
    if (shortcuts[0] == QKeySequence(Qt::Key_Return)) shortcuts << QKeySequence(Qt::Key_Enter);
    return shortcuts;
}

// With its own letter, or with the first that is not taken.
QString CaptionOf(const TMenuExItem& item, QString& taken) {
    if (item.Letter().isNull()) return WithAccessKey(item.Caption(), taken);
    QString text = item.Caption();
    text.replace(u'&', u"&&"_s);
    return text.insert(text.indexOf(item.Letter(), 0, Qt::CaseInsensitive), u'&');
}

}  // namespace

CommandMenu::CommandMenu(CommandDispatcher& commands) : commands_(commands) {
    changes_ = commands.Changed.Subscribe([this] { Update(); });
}

void CommandMenu::Fill(QMenu& menu, const TMenuExItem& parent) {
    menu.setToolTipsVisible(true);
    auto* group = new QActionGroup(&menu);
    QString taken;
    for (const auto& item : parent.Items())
        if (!item->Letter().isNull()) taken += item->Letter();
    for (const auto& item : parent.Items()) {
        switch (item->Kind()) {
            case TMenuExItem::ItemKind::Separator:
                menu.addSeparator();
                break;
            case TMenuExItem::ItemKind::Submenu:
                Fill(*menu.addMenu(WithAccessKey(item->Caption(), taken)), *item);
                break;
            default:
                AddCommand(menu, *item, taken);
        }
        if (item->Kind() == TMenuExItem::ItemKind::Radio) group->addAction(actions_[item->Id()]);
    }
}

void CommandMenu::AddCommand(QMenu& menu, const TMenuExItem& item, QString& taken) {
    QAction* action = menu.addAction(MenuIcon(item.Icon()), CaptionOf(item, taken));
    action->setShortcuts(ShortcutsOf(item));
    action->setCheckable(item.Checkable());
    if (item.IsDefault()) menu.setDefaultAction(action);
    QObject::connect(action, &QAction::triggered, &menu,
                     Guarded([this, action, id = item.Id()] { commands_.Run(id, action); }));
    actions_.insert(item.Id(), action);
    BindAction(*action, item.Id());
}

// The keys of the old actions are free at once, also where these live on for a while.
void CommandMenu::Clear() {
    for (auto action = actions_.cbegin(); action != actions_.cend(); ++action)
        if (QWidget* view = views_.value(action.key())) view->removeAction(*action);
    actions_.clear();
}

void CommandMenu::Bind(int id, QWidget& view) {
    views_[id] = &view;
    if (QAction* action = actions_.value(id)) BindAction(*action, id);
}

void CommandMenu::BindAction(QAction& action, int id) {
    QWidget* view = views_.value(id);
    if (view == nullptr) return;
    action.setShortcutContext(Qt::WidgetShortcut);
    view->addAction(&action);
}

void CommandMenu::Update() {
    const TMenuExItem& root = commands_.ShownMenu();
    for (auto action = actions_.cbegin(); action != actions_.cend(); ++action) {
        const TMenuExItem* item = root.Find(action.key());
        if (item == nullptr) continue;
        (*action)->setEnabled(item->Enabled());
        (*action)->setToolTip(item->Hint());
        if (item->Checkable()) (*action)->setChecked(item->Checked());
        if (QString none; !item->Letter().isNull()) (*action)->setText(CaptionOf(*item, none));
    }
}
