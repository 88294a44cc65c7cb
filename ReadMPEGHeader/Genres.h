#pragma once

#include <QString>
#include <QStringView>
#include <QtGlobal>
#include <optional>
#include <span>

inline constexpr quint8 kNoGenre = 255;
inline constexpr int kMainGenreCount = 20;

// A row of the genre table.
struct GenreRow {
    const char16_t* Name;
    quint8 Number;
};

// The 148 ID3v1 genres, sorted by name.
std::span<const GenreRow> GenreTable();

// Name of a genre number; 255 "Undefiniert", a number without a row "Unbekannt".
QString GenreName(int number);
// Genre number of a name, compared without regard to case; nothing when no row has it.
std::optional<quint8> GenreByName(QStringView name);

// Main genres: index 0 to 19, taken modulo 128 first; any other index counts as 0 (unknown).
QString MainGenreName(int index);  // short name
QString MainGenreLongName(int index);
quint8 MainGenreGenre(int index);  // genre number that it stands for; 255 for unknown
// Index of a long or short name, compared exactly. Throws ERukException when no row has it.
int MainGenreByName(const QString& name);
