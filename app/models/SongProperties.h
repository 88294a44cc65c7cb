#pragma once

#include <QString>
#include <vector>

#include "ReadMPEGHeader/ID3Tag.h"

struct PropertyRow {
    QString Name;
    QString Value;

    bool operator==(const PropertyRow&) const = default;
};

// Rows under a heading.
struct PropertyGroup {
    QString Caption;
    std::vector<PropertyRow> Rows{};
};

// What the record of a song tells, without a look at its file; rows that would say nothing are left out.
std::vector<PropertyRow> TagProperties(const TID3Tag& song);
std::vector<PropertyRow> TechnicalProperties(const TID3Tag& song);
std::vector<PropertyRow> CollectionProperties(const TID3Tag& song);
// Name and folder.
std::vector<PropertyRow> PathProperties(const TID3Tag& song);

// Groups as plain text, a row a line: "Titel: ...".
QString PropertyLine(const PropertyRow& row);
QString PropertyText(const std::vector<PropertyGroup>& groups);
