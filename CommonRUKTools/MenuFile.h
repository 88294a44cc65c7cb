#pragma once

#include <QList>
#include <QString>
#include <QStringView>
#include <vector>

// A menu as a user has arranged it, in a text file:
//
//     # a comment
//     Datenbank {
//         101 Neue Sammlung
//         -
//         Ablage {
//             103
//         }
//     }
//
// A line is a command by its number, with a caption where the user wants another one, a line between
// commands, or the begin or the end of a menu.
struct MenuFileItem {
    enum class Kind { Command, Separator, Submenu };

    Kind What = Kind::Command;
    int Line = 0;  // in the file, from 1
    int Id = 0;    // of a command
    QString Caption{};
    std::vector<MenuFileItem> Items{};
};

// Throws ERukException, which names the line, for a text that is no such file.
std::vector<MenuFileItem> ReadMenuFile(QStringView text);

// "Zeile 3: ..."
QString MenuFileFault(int line, const QString& what);
