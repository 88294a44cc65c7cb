#include "app/dialogs/FileFilters.h"

using namespace Qt::StringLiterals;

namespace {

// "*.*" means every file, also one whose name has no dot. Some desktops' dialogs distinguish capitals.
QString PatternList(const QString& patterns) {
    QStringList result;
    for (const QString& pattern : patterns.split(u';', Qt::SkipEmptyParts)) {
        if (pattern == u"*.*"_s) return u"*"_s;
        result << pattern.trimmed();
        if (pattern.toUpper() != pattern) result << pattern.trimmed().toUpper();
    }
    return result.join(u' ');
}

}  // namespace

QStringList NameFilters(const QString& filter) {
    QStringList result;
    const QStringList parts = filter.split(u'|');
    for (qsizetype i = 0; i + 1 < parts.size(); i += 2) {
        const QString patterns = PatternList(parts[i + 1]);
        if (!patterns.isEmpty()) result << parts[i] + u" ("_s + patterns + u')';
    }
    return result;
}
