#include "app/ArrangementCommands.h"

#include <QMainWindow>
#include <QMenu>

#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/Errors.h"
#include "app/views/SongListWidget.h"

using namespace Qt::StringLiterals;

namespace {

FileDialogOptions DialogOptions(const QString& title) {
    FileDialogOptions options;
    options.Title = title;
    options.DefaultExtension = u"df"_s;
    options.Filter = u"Tunestead Desktop|*.df|Alle Dateien|*.*"_s;
    options.ConfirmOverwrite = true;
    return options;
}

}  // namespace

void ArrangementCommands::AddTo(QMenu& menu) {
    menu.addSeparator();
    QObject::connect(menu.addAction(u"Anordnung &speichern unter..."_s), &QAction::triggered, &menu,
                     Guarded([this] { SaveAs(); }));
    QObject::connect(menu.addAction(u"Anordnung &laden..."_s), &QAction::triggered, &menu,
                     Guarded([this] { Open(); }));
}

void ArrangementCommands::SaveAs() {
    const auto path = UserDialogs().SaveFile(DialogOptions(u"Anordnung speichern unter"_s));
    if (path) WriteArrangement(*path, Current());
}

void ArrangementCommands::Open() {
    const auto path = UserDialogs().OpenFile(DialogOptions(u"Anordnung laden"_s));
    if (path) Load(*path);
}

// A file may be sound and its contents not: only the windows themselves can tell.
void ArrangementCommands::Load(const QString& path) {
    const Arrangement wanted = ReadArrangement(path);
    const Arrangement before = Current();
    if (Apply(wanted)) return;
    Apply(before);
    throw EStreamError(u"Die Anordnung in dieser Datei passt nicht zu diesem Programm: "_s + path);
}

Arrangement ArrangementCommands::Current() const {
    return {window_.saveGeometry(), window_.saveState(), list_.SaveColumns()};
}

bool ArrangementCommands::Apply(const Arrangement& arrangement) {
    // The size first: the docks' are parts of it.
    return window_.restoreGeometry(arrangement.Placement) && window_.restoreState(arrangement.Docks) &&
           list_.RestoreColumns(arrangement.Columns);
}
