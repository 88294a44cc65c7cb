#pragma once

#include <QByteArray>
#include <QString>
#include <QStringList>

// The texts that an installation for one user works on.

// The desktop entry of a package, changed so that it starts `program` (absolute).
QByteArray EntryFor(const QByteArray& packed, const QString& program);
// The program that an entry made by EntryFor() starts; empty for any other entry.
QString InstalledProgram(const QByteArray& entry);

// A mimeapps.list without `entryName` as the default of these types; every other line stays as it is.
QByteArray WithoutDefaults(const QByteArray& list, const QString& entryName, const QStringList& types);
