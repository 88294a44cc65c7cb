#include "app/dialogs/ReportWindow.h"

#include <QClipboard>
#include <QDialogButtonBox>
#include <QGuiApplication>
#include <QIcon>
#include <QLabel>
#include <QListView>
#include <QLocale>
#include <QPushButton>
#include <QShortcut>
#include <QStringListModel>
#include <QTabWidget>
#include <QVBoxLayout>
#include <algorithm>

#include "CommonRUKTools/CommandRunner.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kWidth = 90;   // average characters
constexpr int kHeight = 24;  // lines

QString PageCaption(const ReportSection& section) {
    QString caption = section.Caption;
    return caption.replace(u'&', u"&&"_s) + u" ("_s +
           QLocale(QLocale::German).toString(section.Lines.size()) + u')';
}

// The rows in the order of the list, whatever the order in which they were chosen.
void CopyChosen(const QListView& list) {
    QModelIndexList rows = list.selectionModel()->selectedIndexes();
    std::sort(rows.begin(), rows.end());
    QStringList lines;
    for (const QModelIndex& row : rows)
        lines << row.data().toString();
    if (!lines.isEmpty()) QGuiApplication::clipboard()->setText(lines.join(u'\n'));
}

QListView* MakeList(const ReportSection& section, QWidget* parent) {
    auto* list = new QListView(parent);
    list->setAccessibleName(section.Caption);
    list->setModel(new QStringListModel(section.Lines, list));
    list->setUniformItemSizes(true);  // a long list is not measured line by line
    list->setAlternatingRowColors(true);
    list->setEditTriggers(QListView::NoEditTriggers);
    list->setSelectionMode(QListView::ExtendedSelection);
    auto* copy = new QShortcut(QKeySequence::Copy, list, nullptr, nullptr, Qt::WidgetShortcut);
    QObject::connect(copy, &QShortcut::activated, list, [list] { CopyChosen(*list); });
    return list;
}

}  // namespace

ReportWindow::ReportWindow(Report report, QWidget* parent) : QDialog(parent), report_(std::move(report)) {
    setObjectName(u"reportWindow"_s);
    setWindowTitle(u"Bericht"_s);
    auto* message = new QLabel(report_.Message, this);
    message->setTextFormat(Qt::PlainText);
    message->setWordWrap(true);
    auto* buttons = new QDialogButtonBox(this);
    auto* close = buttons->addButton(u"&Schließen"_s, QDialogButtonBox::RejectRole);
    close->setDefault(true);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    if (report_.OpenAsText) {
        auto* text = buttons->addButton(u"Als &Text öffnen"_s, QDialogButtonBox::ActionRole);
        text->setAutoDefault(false);
        connect(text, &QPushButton::clicked, this, [this] { RunCommand(report_.OpenAsText); });
    }
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(message);
    layout->addWidget(MakePages(), 1);
    layout->addWidget(buttons);
    close->setFocus();
    resize(kWidth * fontMetrics().averageCharWidth(), kHeight * fontMetrics().height());
}

// What did not go as the user wished is shown first.
QWidget* ReportWindow::MakePages() {
    auto* pages = new QTabWidget(this);
    int shown = -1;
    for (const ReportSection& section : report_.Sections) {
        const int page = pages->addTab(MakeList(section, pages), PageCaption(section));
        if (!section.Complaint) continue;
        pages->setTabIcon(page, QIcon::fromTheme(u"dialog-warning"_s));
        if (shown < 0) shown = page;
    }
    pages->setCurrentIndex(std::max(shown, 0));
    return pages;
}
