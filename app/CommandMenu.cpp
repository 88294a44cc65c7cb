#include "app/CommandMenu.h"

#include <QAction>
#include <QActionGroup>
#include <QMenu>

#include "CommonRUKTools/MenuItem.h"

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

}  // namespace

void CommandMenu::Fill(QMenu& menu, const TMenuExItem& parent, QString taken) {
    menu.setToolTipsVisible(true);
    auto* group = new QActionGroup(&menu);
    for (const auto& item : parent.Items()) {
        switch (item->Kind()) {
            case TMenuExItem::ItemKind::Separator:
                menu.addSeparator();
                break;
            case TMenuExItem::ItemKind::Submenu:
                Fill(*menu.addMenu(WithAccessKey(item->Caption(), taken)), *item);
                break;
            default:
                AddCommand(menu, *item);
        }
        if (item->Kind() == TMenuExItem::ItemKind::Radio) group->addAction(actions_[item->Id()]);
        if (QAction* action = actions_.value(item->Id()))
            action->setText(WithAccessKey(item->Caption(), taken));
    }
}

void CommandMenu::AddCommand(QMenu& menu, const TMenuExItem& item) {
    QAction* action = menu.addAction(icons_(item.Id()), item.Caption());
    action->setShortcuts(ShortcutsOf(item));
    action->setCheckable(item.Checkable());
    if (item.IsDefault()) menu.setDefaultAction(action);
    QObject::connect(action, &QAction::triggered, &menu, [this, id = item.Id()] { run_(id); });
    actions_.insert(item.Id(), action);
    BindAction(*action, item.Id());
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

void CommandMenu::Update(const TMenuExItem& root, bool resting) {
    for (auto action = actions_.cbegin(); action != actions_.cend(); ++action) {
        const TMenuExItem* item = root.Find(action.key());
        if (item == nullptr) continue;
        (*action)->setEnabled(item->Enabled() && !resting);
        (*action)->setToolTip(item->Hint());
        if (item->Checkable()) (*action)->setChecked(item->Checked());
    }
}
