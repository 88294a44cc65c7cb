#pragma once

#include <QByteArray>
#include <QImage>

// A picture from a tag, reduced to what a tool window shows of it. Null when it is damaged, too large or no
// photograph's format.
QImage DecodeCover(const QByteArray& bytes);
