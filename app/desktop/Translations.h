#pragma once

class QCoreApplication;

// Numbers, dates and the texts that come from Qt itself (file dialogs, context menus) become German. The
// program's own windows do not depend on it: Qt's translation may be missing on a system.
void InstallGerman(QCoreApplication& application);
