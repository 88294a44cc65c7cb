#!/usr/bin/env bash
# Holds every include of our own headers against the rooms: a file may include what lies in its own target and in the
# targets that it links, and within the database only what lies in its own room or on a lower floor. Argument: the
# build folder, whose build system is asked for the links.
set -euo pipefail
build=$(realpath "$1")
cd "$(dirname "$(realpath "$0")")/.."

# The rooms of the database, from the ground up. Rooms of one line may not see each other.
floors="sidefile
core sorting
journal
search songfiles tsdb
media
batches duplicates intake
backup
commands"

links=$(mktemp)
trap 'rm -f "$links"*' EXIT
cmake -S . -B "$build" --graphviz="$links" >/dev/null

# FOLDER TARGET for each library and program, and FILE TARGET where a folder has several.
targets() {
    local list folder
    while read -r list; do
        folder=$(dirname "$list")
        awk -v folder="$folder" '
            /^ *(tunestead_library|add_library|add_executable)\(/ {
                sub(/^ *[a-z_]*\(/, ""); target = $1; sub(/\)$/, "", target); if (target ~ /[$]/) { target = ""; next } ++count
                if (count == 1) print folder, target
            }
            target && match($0, /[A-Za-z0-9_\/]+\.cpp/) {
                file = substr($0, RSTART, RLENGTH); sub(/\.cpp$/, "", file)
                if (count > 1) { print folder "/" file ".cpp", target; print folder "/" file ".h", target }
            }
            /\)/ && !/\(/ { target = "" }' "$list"
    done < <(git ls-files 'CommonRUKTools/*CMakeLists.txt' 'ReadMPEGHeader/*CMakeLists.txt' \
        'HTTPRetrieval/*CMakeLists.txt' 'MusicManagment/*CMakeLists.txt' 'MusicManagmentRemoteControl/*CMakeLists.txt' \
        'app/*CMakeLists.txt' 'cli/*CMakeLists.txt' 'tsplayer/*CMakeLists.txt')
}

git ls-files '*.h' '*.cpp' | grep -vE '^(tests|bench|fuzz|cmake)/' | xargs grep -nE '^#include "' |
    awk -v floors="$floors" -v links="$links" -v targets="$(targets)" '
    function target_of(path,    part) {
        for (part = path; part != ""; ) {
            if (part in target) return target[part]
            if (!sub(/\/[^\/]*$/, "", part)) return ""
        }
        return ""
    }
    function room_of(path,    part) {
        if (path !~ /^MusicManagment\/database\//) return ""
        part = path; sub(/^MusicManagment\/database\//, "", part)
        return sub(/\/.*/, "", part) ? part : "core"
    }
    function reaches(from, to,    next_, i, names) {
        if (from == to) return 1
        if ((from, to) in known) return known[from, to]
        known[from, to] = 0
        split(linked[from], names, " ")
        for (i in names) if (reaches(names[i], to)) return known[from, to] = 1
        return 0
    }
    BEGIN {
        count = split(targets, rows, "\n")
        for (i = 1; i <= count; ++i) { split(rows[i], row, " "); target[row[1]] = row[2] }
        while ((getline line < links) > 0)
            if (match(line, /\/\/ .* -> .*/)) {
                split(substr(line, RSTART + 3), edge, " -> ")
                linked[edge[1]] = linked[edge[1]] " " edge[2]
            }
        count = split(floors, rows, "\n")
        for (i = 1; i <= count; ++i) {
            rooms = split(rows[i], row, " ")
            for (j = 1; j <= rooms; ++j) floor[row[j]] = i
        }
        # The object and the order of its songs are one floor that may see itself.
        together["core"] = together["sorting"] = 1
    }
    {
        split($0, parts, ":"); file = parts[1]
        match($0, /"[^"]+"/); header = substr($0, RSTART + 1, RLENGTH - 2)
        from = target_of(file); to = target_of(header)
        if (to == "") { print file ": " header " lies in no target"; bad = 1; next }
        if (!reaches(from, to)) { print file ": " from " does not link " to " (" header ")"; bad = 1 }
        a = room_of(file); b = room_of(header)
        if (a == "" || b == "" || a == b) next
        if (!(a in floor) || !(b in floor)) { print file ": no floor for " a " or " b; bad = 1; next }
        if (floor[b] > floor[a] || (floor[a] == floor[b] && !(a in together))) {
            print file ": " a " does not stand above " b " (" header ")"; bad = 1
        }
    }
    END { exit bad }'
