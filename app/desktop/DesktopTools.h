#pragma once

#include <QString>
#include <QStringList>
#include <functional>

// Runs one of the desktop's own tools to its end. Empty when it did its work, and when the system does not
// have it; else what went wrong.
using ToolRunner = std::function<QString(const QString& program, const QStringList& arguments)>;

QString RunDesktopTool(const QString& program, const QStringList& arguments);
