#!/usr/bin/env bash
# clang-tidy over our sources. A source is passed over when its object file of the release build, which ninja keeps up
# to date with the source and its headers, is older than the mark left when it was last found clean.
set -euo pipefail
cd "$(dirname "$(realpath "$0")")/.."
release=build/release
marks=build/lint/clean
cmake --preset lint >/dev/null
mkdir -p "$marks"

pending=()
while read -r source object; do
    source=${source#"$PWD"/}
    case $source in tests/*|bench/*|fuzz/*|build/*) continue ;; esac
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
