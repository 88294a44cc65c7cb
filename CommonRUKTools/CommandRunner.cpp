#include "CommonRUKTools/CommandRunner.h"

#include <QScopedValueRollback>
#include <QStringList>
#include <new>

#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/Errors.h"

using namespace Qt::StringLiterals;

namespace {

// A timer that fails at each tick must not pile up boxes.
void Show(const QString& text) {
    static QStringList waiting;
    static bool showing = false;
    if (!waiting.contains(text)) waiting << text;
    if (showing) return;
    const QScopedValueRollback rollback(showing, true);
    while (!waiting.isEmpty()) {
        UserDialogs().ShowMessage(MessageKind::Error, waiting.first());
        waiting.removeFirst();
    }
}

}  // namespace

void ShowCaughtException() {
    try {
        throw;
    } catch (const EAbort&) {
        // The user has been told already, or chose to stop.
    } catch (const ERukException& error) {
        Show(error.Message());
    } catch (const std::bad_alloc&) {
        Show(u"Der Arbeitsspeicher reicht für diese Aktion nicht aus."_s);
    } catch (const std::exception& error) {
        Show(u"Unerwarteter Fehler: "_s + QString::fromUtf8(error.what()));
    }
}
