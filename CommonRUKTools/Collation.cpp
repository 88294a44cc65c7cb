#include "CommonRUKTools/Collation.h"

namespace {

QCollator Make(const QLocale& locale, Qt::CaseSensitivity sensitivity) {
    QCollator collator(locale);
    collator.setCaseSensitivity(sensitivity);
    return collator;
}

struct Collators {
    explicit Collators(const QLocale& locale)
        : insensitive(Make(locale, Qt::CaseInsensitive)), sensitive(Make(locale, Qt::CaseSensitive)) {}
    QCollator insensitive;
    QCollator sensitive;
};

Collators& Current() {
    static Collators collators(QLocale(QLocale::German, QLocale::Germany));
    return collators;
}

}  // namespace

namespace Collation {

void SetLocale(const QLocale& locale) {
    Current() = Collators(locale);
}

int CompareIgnoringCase(QStringView a, QStringView b) {
    // Songs that are compared are often by the same artist.
    if (a == b) return 0;
    return Current().insensitive.compare(a, b);
}

int CompareExactly(QStringView a, QStringView b) {
    const int result = Current().sensitive.compare(a, b);
    return result != 0 ? result : a.compare(b);
}

const QCollator& CaseInsensitive() {
    return Current().insensitive;
}

}  // namespace Collation
