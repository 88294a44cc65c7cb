#pragma once

#include <QString>
#include <QStringList>
#include <optional>

// A program that plays music and can be driven over the bus.
struct PlayerProgram {
    QString Path;           // executable
    QStringList Arguments;  // given before the file
};

// The program of this name or path; nothing when it is not installed.
std::optional<PlayerProgram> FindPlayerProgram(const QString& nameOrPath);
// The first installed of those that are known to work.
std::optional<PlayerProgram> FindKnownPlayer();
// Their names, the one to prefer first in front.
QStringList KnownPlayers();

// Starts it with a file, to run on without us. Nothing when that is not possible, else the process.
std::optional<qint64> StartPlayer(const PlayerProgram& program, const QString& file);
// Ends a process that was started for nothing; one that is not this program any more is left alone.
void EndPlayer(const PlayerProgram& program, qint64 process);
