#pragma once

#include <QStringView>
#include <QtGlobal>

// The main genre that a tag's genre belongs to; 0 (unknown) where it says nothing of a style.

quint8 MainGenreOfGenre(int number);
// A long or short name of a main genre, in any case.
quint8 MainGenreNamed(QStringView text);
// A name of a main genre or a genre, or what people write for one ("Hip Hop", "Deutschrock"), without regard
// to case and marks on letters. Of several ("Indie; Pop") the first that is known counts.
quint8 MainGenreOfText(QStringView text);
