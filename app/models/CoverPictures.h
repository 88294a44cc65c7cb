#pragma once

#include <QByteArray>
#include <QString>

#include "ReadMPEGHeader/TagWriting.h"

class QMimeData;

// Pictures that become covers: PNG and JPEG, up to 10 MiB. Each throws ERukException, with a message for the
// user, for anything else.
CoverPicture PictureOf(const QByteArray& bytes);
CoverPicture ReadPicture(const QString& path);
// What was dropped or pasted: a file, or a picture from another program.
CoverPicture PictureFrom(const QMimeData& data);
bool MayHoldPicture(const QMimeData& data);

// "JPEG, 600 × 600 Pixel, 118 KB"; without its size where it cannot be decoded.
QString DescribePicture(const QByteArray& bytes);
// "jpg"
QString SuffixOfPicture(const QByteArray& bytes);
