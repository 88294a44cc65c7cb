#include "app/views/ColumnMenu.h"

#include <QActionGroup>
#include <QHeaderView>

#include "app/CommandMenu.h"
#include "app/models/SongColumns.h"

using namespace Qt::StringLiterals;

ColumnMenu::ColumnMenu(QHeaderView& header, int section, QWidget* parent) : QMenu(parent) {
    setObjectName(u"columnMenu"_s);
    AddColumns(header);
    addSeparator();
    QAction* fit = addAction(u"Spaltenbreite &anpassen"_s);
    fit->setEnabled(section >= 0);
    connect(fit, &QAction::triggered, this, [this, section] {
        if (OnFit) OnFit(section);
    });
    connect(addAction(u"Alle Spalten &zurücksetzen"_s), &QAction::triggered, this, [this] {
        if (OnReset) OnReset();
    });
}

void ColumnMenu::AddFlags(quint32 shown, std::function<void(quint32)> choose) {
    QMenu* menu = addMenu(u"Spalte „&Flags“ zeigt"_s);
    menu->setObjectName(u"flagMenu"_s);
    auto* group = new QActionGroup(menu);
    QString letters;
    const auto add = [&](const QString& caption, quint32 flag) {
        QAction* action = menu->addAction(WithAccessKey(caption, letters));
        action->setCheckable(true);
        action->setChecked(flag == shown);
        group->addAction(action);
        connect(action, &QAction::triggered, this, [choose, flag] { choose(flag); });
    };
    add(u"Alle Flags als Text"_s, 0);
    const QStringList names = SongFlagNames();
    for (int i = 0; i < names.size(); ++i)
        add(names[i], 1U << i);
}

void ColumnMenu::AddColumns(QHeaderView& header) {
    for (int section = 0; section < header.count(); ++section) {
        const SongColumn& column = SongColumns()[static_cast<std::size_t>(section)];
        QAction* action = addAction(column.Caption());
        action->setCheckable(true);
        action->setChecked(!header.isSectionHidden(section));
        action->setEnabled(column.Id != SongFieldId::Title);  // a list of songs without names helps nobody
        connect(action, &QAction::toggled, &header,
                [&header, section](bool shown) { header.setSectionHidden(section, !shown); });
    }
}
