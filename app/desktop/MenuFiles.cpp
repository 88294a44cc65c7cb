#include "app/desktop/MenuFiles.h"

#include <QDir>
#include <QFile>

#include "CommonRUKTools/ByteReader.h"
#include "CommonRUKTools/CodePage.h"
#include "CommonRUKTools/CommandDispatcher.h"
#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/MenuFile.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kMostBytes = 256 * 1024;

}  // namespace

QString ArrangeMenu(CommandDispatcher& commands, const QString& folder, const QString& name) {
    const QString fileName = u"Tunestead3_%1_Menu.menu"_s.arg(name);
    QFile file(QDir(folder).filePath(fileName));
    if (!file.exists()) return {};
    const QString fault = fileName + u" gilt nicht. "_s;
    if (!file.open(QIODevice::ReadOnly)) return fault + file.errorString();
    if (file.size() > kMostBytes) return fault + u"Die Datei ist zu groß."_s;
    try {
        commands.Arrange(ReadMenuFile(CodePage::FromSystem(AsBytes(file.read(kMostBytes).toStdString()))));
    } catch (const ERukException& error) {
        return fault + error.Message();
    }
    return {};
}
