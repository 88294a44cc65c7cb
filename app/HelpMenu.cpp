#include "app/HelpMenu.h"

#include <QApplication>
#include <QMenu>
#include <QMenuBar>
#include <QMessageBox>

#include "CommonRUKTools/CommandRunner.h"
#include "app/dialogs/HandbookWindow.h"

using namespace Qt::StringLiterals;

namespace {

QString AboutText() {
    return u"<h3>Tunestead %1</h3>"
           "<p>Ordnet eine Musiksammlung.</p>"
           "<p>Läuft mit Qt %2.</p>"
           "<p>Freie Software unter der GNU General Public License, Version 3 oder später. "
           "Es besteht keinerlei Gewährleistung.</p>"_s.arg(QCoreApplication::applicationVersion(),
                                                            QString::fromLatin1(qVersion()));
}

}  // namespace

void AddHelpMenu(QMenuBar& bar, QWidget& window) {
    QMenu* menu = bar.addMenu(u"&Hilfe"_s);
    QAction* handbook = menu->addAction(u"&Handbuch"_s);
    handbook->setShortcut(QKeySequence::HelpContents);
    QObject::connect(handbook, &QAction::triggered, &window, Guarded([&window] { ShowHandbook(window); }));
    menu->addSeparator();
    QObject::connect(menu->addAction(u"Über &Tunestead..."_s), &QAction::triggered, &window,
                     [&window] { QMessageBox::about(&window, u"Über Tunestead"_s, AboutText()); });
}
