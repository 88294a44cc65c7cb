#!/usr/bin/env bash
# clang-tidy over our sources: with --all over every one of them, which takes about a quarter of an hour on two
# processors and is due before a release; else over those that the last commits of the main line and the work tree
# have changed. A source is passed over when neither it nor a header of ours that it reaches has changed since it was
# last found clean.
set -euo pipefail
cd "$(dirname "$(realpath "$0")")/.."
commits=8
base=
if [ "${1:-}" != --all ]; then
    base=$(git rev-list --first-parent --skip=$commits --max-count=1 HEAD)
fi
declare -A changed
while read -r source; do changed[$source]=1; done < <(git diff --name-only "${base:-HEAD}" -- '*.cpp')
marks=build/lint/clean
cmake --preset lint >/dev/null
mkdir -p "$marks"
started=$(mktemp)
trap 'rm -f "$started"' EXIT

# TIME SOURCE for each source: when it, or a header of ours that it reaches, was last changed.
change_times() {
    git ls-files --deduplicate '*.cpp' '*.h' | xargs stat -c 'time %Y %n'
    git grep -H '^#include "' -- '*.cpp' '*.h' | sed -E 's/^([^:]+):#include "([^"]+)".*/includes \1 \2/'
}
newest() {
    awk '
        function newest(file,    latest, here, count, i, names) {
            if (file in seen) return 0
            seen[file] = 1
            latest = time[file]
            count = split(includes[file], names, " ")
            for (i = 1; i <= count; ++i) { here = newest(names[i]); if (here > latest) latest = here }
            return latest
        }
        $1 == "time" { time[$3] = $2 }
        $1 == "includes" { includes[$2] = includes[$2] " " $3 }
        END { for (file in time) if (file ~ /[.]cpp$/) { delete seen; print newest(file), file } }'
}

pending=()
while read -r time source; do
    case $source in tests/*|bench/*|fuzz/*) continue ;; esac
    if [ -n "$base" ] && [ -z "${changed[$source]:-}" ]; then continue; fi
    if ! grep -qF "\"file\": \"$PWD/$source\"" build/lint/compile_commands.json; then continue; fi
    mark=$marks/${source//\//_}
    if [ ! -e "$mark" ] || [ "$time" -ge "$(stat -c %Y "$mark")" ] || [ .clang-tidy -nt "$mark" ]; then
        pending+=("$source")
    fi
done < <(change_times | newest | sort -k2)

check() {
    if clang-tidy --quiet -p build/lint "$3"; then
        touch -r "$1" "$2/${3//\//_}"
    else
        echo "clang-tidy: $3" >&2
        return 1
    fi
}
export -f check
if [ ${#pending[@]} -gt 0 ]; then
    printf '%s\n' "${pending[@]}" | xargs -P "$(nproc)" -I{} bash -c 'check "$@"' _ "$started" "$marks" {} 2> >(grep -v 'warnings generated\.$' >&2)
fi
echo "${#pending[@]} sources checked"
