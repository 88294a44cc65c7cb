#pragma once

#include <QString>
#include <optional>

#include "ReadMPEGHeader/ID3Tag.h"

// What a file's sound says when it is looked through from its first byte to its last.
struct LengthCheck {
    // Format, length, bit rate and frame size; the other fields are a fresh record's.
    TID3Tag Technical;
    // What is damaged; empty when nothing is.
    QString Damage;
};

// Counts every frame of an MPEG file; WAV and WMA files tell their length in their headers, which are held
// against the bytes that are there. Nothing where the file holds no sound that could be measured. Keeps no
// state, so any number of threads may check at the same time. Throws EStreamError when the file cannot be
// read.
std::optional<LengthCheck> CheckLength(const QString& path);

// Takes over what was measured.
void ApplyLengthCheck(const LengthCheck& check, TID3Tag& record);
