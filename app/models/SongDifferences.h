#pragma once

#include <vector>

#include "MusicManagment/database/SongFields.h"
#include "app/models/FileDetails.h"

// A fact about two songs side by side.
struct DifferenceRow {
    QString Name{};
    QString First{};
    QString Second{};

    bool Differs() const { return First != Second; }
};

// Every field of the two records; what neither says is left out.
std::vector<DifferenceRow> FieldDifferences(const TID3Tag& first, const TID3Tag& second);
// What the files tell beside that: size and time. Of files that are not read yet nothing is known.
std::vector<DifferenceRow> FileDifferences(const FileDetails& first, const FileDetails& second);
