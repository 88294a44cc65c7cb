#include "app/desktop/WindowPlacement.h"

#include <QSettings>
#include <QWidget>

void StorePlacement(const QWidget& window, const QString& settingsFile, const QString& name) {
    QSettings(settingsFile, QSettings::IniFormat).setValue(name, window.saveGeometry());
}

bool RestorePlacement(QWidget& window, const QString& settingsFile, const QString& name) {
    const QSettings settings(settingsFile, QSettings::IniFormat);
    return window.restoreGeometry(settings.value(name).toByteArray());
}
