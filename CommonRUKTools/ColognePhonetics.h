#pragma once

#include <QByteArray>
#include <QStringView>

// How a name sounds in German, as digits: names of the same code sound alike ("Meyer", "Maier"). The rules
// are those of the Cologne phonetics (H. J. Postel, 1969). Marks above letters do not count, other characters
// than letters of the Latin script and digits are passed over. Empty when nothing is left.
QByteArray ColognePhonetics(QStringView name);
