#include "app/desktop/RaiseWindow.h"

#include <QWidget>

void RaiseWindow(QWidget& window, const QString& activationToken) {
    // The toolkit takes it from there when it asks the desktop for the focus.
    if (!activationToken.isEmpty()) qputenv("XDG_ACTIVATION_TOKEN", activationToken.toUtf8());
    window.setWindowState(window.windowState() & ~Qt::WindowMinimized);
    window.raise();
    window.activateWindow();
}
