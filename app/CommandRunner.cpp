#include "app/CommandRunner.h"

#include <QString>
#include <new>

#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/Errors.h"

using namespace Qt::StringLiterals;

void RunCommand(const std::function<void()>& command) {
    const auto show = [](const QString& text) { UserDialogs().ShowMessage(MessageKind::Error, text); };
    try {
        command();
    } catch (const EAbort&) {
        // The user has been told already, or chose to stop.
    } catch (const ERukException& error) {
        show(error.Message());
    } catch (const std::bad_alloc&) {
        show(u"Der Arbeitsspeicher reicht für diese Aktion nicht aus."_s);
    } catch (const std::exception& error) {
        show(u"Unerwarteter Fehler: "_s + QString::fromUtf8(error.what()));
    }
}
