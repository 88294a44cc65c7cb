#pragma once

#include <QByteArray>
#include <QtGlobal>

// The stored choices of the format conversion. The records belong to the encoders and are kept as raw bytes
// of fixed size: 12 for WAV and MP3, 10 for WMA; a stored value of another size is not taken over.
struct ConversionSettings {
    QByteArray Wav = QByteArray(12, '\0');
    QByteArray Mp3 = QByteArray(12, '\0');
    QByteArray Wma = QByteArray(10, '\0');
    quint8 LastMusicFormat = 0;  // last target format chosen
};
