#pragma once

#include <QString>

// Makes a folder that nobody but this user may enter, in a place where others may make files too. A folder
// that is there is taken when it is this user's own. False when it cannot be made, and when the name is taken
// by another user's folder, by a link or by a file.
bool MakePrivateFolder(const QString& path);

// A private folder in the system's temporary folder, with a number behind the name where somebody else has
// that one. Throws EStreamError when none can be made.
QString PrivateTemporaryFolder(const QString& name);
