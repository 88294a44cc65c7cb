#include "MusicManagment/conversion/ConversionTargets.h"

#include "CommonRUKTools/FileChange.h"

using namespace Qt::StringLiterals;

namespace {

QString WithoutExtension(const QString& path) {
    const qsizetype dot = path.lastIndexOf(u'.');
    const qsizetype name = path.lastIndexOf(u'/') + 1;
    return dot > name ? path.left(dot) : path;
}

}  // namespace

QString ConversionTargets::For(const QString& source, const QString& folder) {
    const QString name = source.mid(source.lastIndexOf(u'/') + 1);
    const QString path = folder.isEmpty() ? source : folder + (folder.endsWith(u'/') ? u""_s : u"/"_s) + name;
    return Free(WithoutExtension(path), source);
}

QString ConversionTargets::Instead(const QString& path) {
    return Free(WithoutExtension(path), path);
}

QString ConversionTargets::Free(const QString& base, const QString& own) {
    QString target = base + extension_;
    const bool isOwn = target.compare(own, Qt::CaseInsensitive) == 0;
    for (int number = 2; taken_.contains(target) || target.compare(own, Qt::CaseInsensitive) == 0 ||
                         (isOwn && StateOf(target).Exists());
         ++number)
        target = base + u" (%1)"_s.arg(number) + extension_;
    taken_.insert(target);
    return target;
}
