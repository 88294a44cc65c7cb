#!/usr/bin/env bash
# clang-tidy over our sources: with --all over every one of them, which takes about a quarter of an hour on two
# processors and is due before a release; else over those that the last commits of the main line and the work tree
# have changed. A source is passed over when its object file of the release build, which ninja keeps up to date with the
# source and its headers, is older than the mark left when it was last found clean.
set -euo pipefail
cd "$(dirname "$(realpath "$0")")/.."
commits=8
base=
if [ "${1:-}" != --all ]; then
    base=$(git rev-list --first-parent --skip=$commits --max-count=1 HEAD)
fi
declare -A changed
while read -r source; do changed[$source]=1; done < <(git diff --name-only "${base:-HEAD}" -- '*.cpp')
release=build/release
marks=build/lint/clean
cmake --preset lint >/dev/null
mkdir -p "$marks"

pending=()
while read -r source object; do
    source=${source#"$PWD"/}
    case $source in tests/*|bench/*|fuzz/*|build/*) continue ;; esac
    if [ -n "$base" ] && [ -z "${changed[$source]:-}" ]; then continue; fi
    mark=$marks/${source//\//_}
    if [ ! -e "$mark" ] || [ "$release/$object" -nt "$mark" ] || [ .clang-tidy -nt "$mark" ]; then
        pending+=("$source")
    fi
done < <(jq -r '.[] | "\(.file) \(.command | capture(" -o (?<object>\\S+)").object)"' "$release/compile_commands.json" |
    sort -u -k1,1)

check() {
    if clang-tidy --quiet -p build/lint "$2"; then
        touch "$1/${2//\//_}"
    else
        echo "clang-tidy: $2" >&2
        return 1
    fi
}
export -f check
if [ ${#pending[@]} -gt 0 ]; then
    printf '%s\n' "${pending[@]}" | xargs -P "$(nproc)" -I{} bash -c 'check "$@"' _ "$marks" {} 2> >(grep -v 'warnings generated\.$' >&2)
fi
echo "${#pending[@]} sources checked"
