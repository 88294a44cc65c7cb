#pragma once

#include <QString>

// The program's own recycle folder: in the root folder of each volume, or beside the user's data where nobody
// may write there.
inline constexpr QStringView kOwnRecycleFolder = u"Tunestead Recycle-Bin";

// Moves a file to the system's recycle bin or, when that refuses, into the program's own recycle folder on
// the same volume. An empty path or one on a catalogued CD counts as done. When both fail the user is told,
// in words that depend on `banned`, and the result is false.
bool MoveToRecycleBin(const QString& path, bool banned);
// These words.
QString RecycleFailure(const QString& path, bool banned);

// --- The same for who brings the file back later ---
// Where the file would lie, in the one or the other; empty when neither takes it.
QString RecyclePlaceFor(const QString& path);
bool MoveToRecyclePlace(const QString& path, const QString& place);
// False when the file is not there any more, or something has its old name.
bool BringBack(const QString& place, const QString& path);
