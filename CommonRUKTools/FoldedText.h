#pragma once

#include <QString>
#include <QStringView>

// Search that ignores case and marks on letters: "Motley" finds "Mötley", "strasse" finds "Straße".

// A text in the form in which it is searched for.
QString FoldText(QStringView text);

// True when `text` contains `needle`, which must have been folded. Nothing is copied for ordinary texts.
bool ContainsFolded(QStringView text, QStringView needle);
