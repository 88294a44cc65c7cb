#pragma once

#include <QCollator>
#include <QLocale>
#include <QStringView>

// Comparison of texts as a reader of the user's language orders them. German rules until another locale is
// set.
namespace Collation {

void SetLocale(const QLocale& locale);

// Below, equal or above 0, as the texts follow one another.
int CompareIgnoringCase(QStringView a, QStringView b);
// A total order: different texts never compare equal.
int CompareExactly(QStringView a, QStringView b);

// The collator behind CompareIgnoringCase, for whoever makes sort keys from many texts.
const QCollator& CaseInsensitive();

}  // namespace Collation
