#pragma once

#include <QString>

// Texts for generated songs. The same number always gives the same text.
namespace SongNames {

QString Artist(int number);
QString Album(int artist, int number);
QString Title(int number);

}  // namespace SongNames
