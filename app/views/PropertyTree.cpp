#include "app/views/PropertyTree.h"

#include <QAction>
#include <QClipboard>
#include <QContextMenuEvent>
#include <QGuiApplication>
#include <QHeaderView>
#include <QKeyEvent>
#include <QMenu>
#include <QSet>

using namespace Qt::StringLiterals;

namespace {

constexpr int kLeastRows = 12;  // lines of text that can be seen
constexpr int kNameColumn = 0;
constexpr int kValueColumn = 1;

QTreeWidgetItem* MakeHeading(const QString& caption) {
    auto* heading = new QTreeWidgetItem({caption});
    QFont font = heading->font(kNameColumn);
    font.setBold(true);
    heading->setFont(kNameColumn, font);
    return heading;
}

QTreeWidgetItem* MakeRow(const PropertyRow& row) {
    QString line = row.Value;
    line.replace(u'\n', u' ');
    auto* item = new QTreeWidgetItem({row.Name, line});
    // As rich text it is wrapped; a value that looks like it must not be taken for it.
    const QString escaped = row.Value.toHtmlEscaped().replace(u'\n', u"<br>"_s);
    item->setToolTip(kValueColumn, u"<qt>"_s + escaped + u"</qt>"_s);
    return item;
}

}  // namespace

PropertyTree::PropertyTree(QWidget* parent) : QTreeWidget(parent) {
    setColumnCount(2);
    setHeaderLabels({u"Eigenschaft"_s, u"Wert"_s});
    setSelectionMode(ExtendedSelection);
    setAllColumnsShowFocus(true);
    setRootIsDecorated(true);
    setUniformRowHeights(true);
    header()->setSectionsMovable(false);
    header()->setStretchLastSection(true);
    FitToFont();
}

void PropertyTree::SetGroups(const std::vector<PropertyGroup>& groups) {
    QSet<QString> folded;
    for (int i = 0; i < topLevelItemCount(); ++i)
        if (!topLevelItem(i)->isExpanded()) folded.insert(topLevelItem(i)->text(kNameColumn));
    groups_ = groups;
    std::erase_if(groups_, [](const PropertyGroup& group) { return group.Rows.empty(); });
    clear();
    for (const PropertyGroup& group : groups_) {
        QTreeWidgetItem* heading = MakeHeading(group.Caption);
        for (const PropertyRow& row : group.Rows)
            heading->addChild(MakeRow(row));
        addTopLevelItem(heading);
        heading->setFirstColumnSpanned(true);
        heading->setExpanded(!folded.contains(group.Caption));
    }
}

// --- Copying ---

QString PropertyTree::ChosenText() const {
    QStringList lines;
    for (int i = 0; i < topLevelItemCount(); ++i) {
        const QTreeWidgetItem* heading = topLevelItem(i);
        const PropertyGroup& group = groups_[static_cast<std::size_t>(i)];
        if (heading->isSelected()) lines << group.Caption;
        for (int row = 0; row < heading->childCount(); ++row)
            if (heading->isSelected() || heading->child(row)->isSelected())
                lines << PropertyLine(group.Rows[static_cast<std::size_t>(row)]);
    }
    return lines.join(u'\n');
}

void PropertyTree::CopyChosen() const {
    const QString text = ChosenText();
    if (!text.isEmpty()) QGuiApplication::clipboard()->setText(text);
}

void PropertyTree::CopyAll() const {
    QGuiApplication::clipboard()->setText(AllText());
}

// The main menu may have a command with the same keys; here they copy.
bool PropertyTree::event(QEvent* event) {
    if (event->type() == QEvent::ShortcutOverride &&
        static_cast<QKeyEvent*>(event)->matches(QKeySequence::Copy)) {
        event->accept();
        return true;
    }
    return QTreeWidget::event(event);
}

void PropertyTree::keyPressEvent(QKeyEvent* event) {
    if (event->matches(QKeySequence::Copy)) return CopyChosen();
    QTreeWidget::keyPressEvent(event);
}

void PropertyTree::contextMenuEvent(QContextMenuEvent* event) {
    QMenu menu(this);
    const QString keys = QKeySequence(QKeySequence::Copy).toString(QKeySequence::NativeText);
    QAction* copy = menu.addAction(u"&Kopieren\t"_s + keys);
    copy->setEnabled(!selectedItems().isEmpty());
    QAction* copyAll = menu.addAction(u"&Alles kopieren"_s);
    copyAll->setEnabled(topLevelItemCount() > 0);
    const QAction* chosen = menu.exec(event->globalPos());
    if (chosen == copy) CopyChosen();
    if (chosen == copyAll) CopyAll();
}

// --- Look ---

// No name is cut, whatever the font.
void PropertyTree::FitToFont() {
    // Beside other tool windows it would be given no more than a peephole.
    setMinimumHeight(kLeastRows * fontMetrics().height());
    ensurePolished();
    const int widest = fontMetrics().horizontalAdvance(u"Änderungsdatum"_s);
    const int frame = 3 * fontMetrics().averageCharWidth();
    const int indent = 2 * indentation();  // of a row under its heading
    header()->resizeSection(kNameColumn, indent + widest + frame);
}

void PropertyTree::changeEvent(QEvent* event) {
    QTreeWidget::changeEvent(event);
    if (event->type() == QEvent::FontChange || event->type() == QEvent::StyleChange) FitToFont();
}
