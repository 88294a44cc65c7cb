#include "app/desktop/DesktopTools.h"

#include <QProcess>
#include <QStandardPaths>

using namespace Qt::StringLiterals;

namespace {

// These tools take well below a second for the folders of one user.
constexpr int kPatience = 15'000;  // milliseconds

}  // namespace

QString RunDesktopTool(const QString& program, const QStringList& arguments) {
    const QString path = QStandardPaths::findExecutable(program);
    if (path.isEmpty()) return {};
    QProcess process;
    process.setProcessChannelMode(QProcess::MergedChannels);
    process.start(path, arguments);
    if (!process.waitForFinished(kPatience)) {
        const QString reason = process.errorString();
        process.kill();
        process.waitForFinished();
        return program + u": "_s + reason;
    }
    if (process.exitStatus() == QProcess::NormalExit && process.exitCode() == 0) return {};
    return program + u": "_s + QString::fromLocal8Bit(process.readAll()).trimmed();
}
