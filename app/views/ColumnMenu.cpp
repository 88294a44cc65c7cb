#include "app/views/ColumnMenu.h"

#include <QHeaderView>

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
