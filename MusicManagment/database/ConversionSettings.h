#pragma once

#include <QByteArray>
#include <QString>
#include <QtGlobal>

inline constexpr qsizetype kWavRecordSize = 12;
inline constexpr qsizetype kMp3RecordSize = 12;
inline constexpr qsizetype kWmaRecordSize = 10;

// The stored choices of the format conversion. The records belong to the encoders and are kept as raw bytes
// of fixed size; a stored value of another size is not taken over.
struct ConversionSettings {
    QByteArray Wav = QByteArray(kWavRecordSize, '\0');
    QByteArray Mp3 = QByteArray(kMp3RecordSize, '\0');
    QByteArray Wma = QByteArray(kWmaRecordSize, '\0');
    quint8 LastMusicFormat = 0;  // last target format chosen
    QString WmaScript{};         // the program that makes WMA; empty: the one that comes with Tunestead
    QString WmaArguments{};      // of that program, with place-holders; empty: the usual ones
};
