#pragma once

#include <QString>

// The one spelling under which a file is known: absolute, without ".", "..", doubled separators and one at
// the end. Symbolic links stay as the user sees them, except in front of a "..", which means the folder above
// the link's target. An empty text stays empty.
QString AbsolutePath(const QString& path);
