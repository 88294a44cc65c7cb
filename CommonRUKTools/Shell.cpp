#include "CommonRUKTools/Shell.h"

#include <QDir>
#include <QProcess>

using namespace Qt::StringLiterals;

namespace {

class DesktopShell : public Shell {
 public:
    bool OpenWithDefaultProgram(const QString& path) override {
#ifdef Q_OS_WIN
        return QProcess::startDetached(u"explorer.exe"_s, {QDir::toNativeSeparators(path)});
#else
        return QProcess::startDetached(u"xdg-open"_s, {path});
#endif
    }
    bool StartProgram(const QString& program, const QStringList& arguments) override {
        return QProcess::startDetached(program, arguments);
    }
};

Shell*& Installed() {
    static Shell* shell = nullptr;
    return shell;
}

}  // namespace

Shell& CurrentShell() {
    static DesktopShell desktop;
    return Installed() != nullptr ? *Installed() : desktop;
}

void SetShell(Shell* shell) {
    Installed() = shell;
}
