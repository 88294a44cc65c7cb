#pragma once

#include <QString>
#include <QStringList>
#include <functional>
#include <optional>

// How a program that burns discs is started, with a folder put into a new disc of data.
struct BurningCall {
    QString Name;  // of the program, for people
    QString Program;
    QStringList Arguments;
};

// Where a program lies; empty when it is not installed.
using ProgramFinder = std::function<QString(const QString& program)>;

// Of the programs that we know the first one that is installed; `folder` is absolute.
std::optional<BurningCall> FindBurningProgram(const QString& folder, const ProgramFinder& find);
