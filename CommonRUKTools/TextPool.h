#pragma once

#include <QByteArray>
#include <QHash>
#include <QString>

#include "CommonRUKTools/ByteReader.h"

// Turns system texts of a file into QStrings, of which equal ones share their characters: a text that was
// seen before is neither converted nor allocated again. Forgets everything when it has grown to some
// megabytes, so that a file whose texts are all different costs no more than that.
class TextPool {
 public:
    QString Get(ByteSpan bytes);

 private:
    QHash<QByteArray, QString> texts_;  // by the bytes in the file
    std::size_t held_ = 0;              // bytes, roughly
};
