#pragma once

#include <QString>

// Writes a sound file of two seconds, 44100 Hz stereo: one second of a 440 Hz tone, one of 880 Hz, both at
// half of full scale. The format goes by the file's extension: mp3, mp2, wma or wav. Throws
// std::runtime_error.
void WriteTwoTones(const QString& path);

inline constexpr int kToneRate = 44100;
inline constexpr double kFirstTone = 440;
inline constexpr double kSecondTone = 880;
