#pragma once

#include <QString>
#include <optional>
#include <span>

#include "ReadMPEGHeader/ID3Tag.h"

// What a place-holder of a name pattern stands for.
struct PlaceholderText {
    const char16_t* Name;  // "%TITLE%"
    const char16_t* Meaning;
};

// Every place-holder, the ones that are used most first.
std::span<const PlaceholderText> PlaceholderTexts();

// An invented song, without a path.
TID3Tag ExampleSong();
// The file name that a pattern gives an invented song.
QString ExampleName(const QString& pattern);

// What is wrong with a pattern that files are to be named by, for the user; nothing when it can be used.
std::optional<QString> FaultOfPattern(const QString& pattern);
// The same of one that their names are to be read by.
std::optional<QString> FaultOfReading(const QString& pattern);
