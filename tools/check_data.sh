#!/usr/bin/env bash
# Checks what the programs tell the desktop and the manual about themselves. Argument: the folder of the programs.
set -euo pipefail
programs=$(realpath "$1")
cd "$(dirname "$(realpath "$0")")/../data"

desktop-file-validate tunestead.desktop
appstreamcli validate --no-net de.tunestead.Tunestead.metainfo.xml

folder=$(mktemp -d)
trap 'rm -r "$folder"' EXIT
mkdir -p "$folder/mime/packages"
cp tunestead-mime.xml "$folder/mime/packages"
complaints=$(XDG_DATA_HOME=$folder update-mime-database "$folder/mime" 2>&1)

# man says what is wrong with a page, and is content with it all the same.
for page in man/*.1; do
    complaints+=$(man --warnings -E UTF-8 -l -Tutf8 -Z "$page" 2>&1 >/dev/null)
done

# Every option that a program's help names is in its page.
options() { "$@" --help | grep -o -- '--[a-z][a-z-]*' | sort -u; }
pages_lack() {
    local page=$1 option
    shift
    while read -r option; do
        grep -qF -- "${option//-/\\-}" "$page" || echo "$page: $option is missing"
    done < <(options "$@")
}
complaints+=$(pages_lack man/tunestead.1 "$programs/tunestead")
commands=$("$programs/tunestead-cli" --help | sed -nE 's/^  ([a-z][a-z-]*) .*/\1/p')
for command in ${commands:?the help names none}; do
    complaints+=$(pages_lack man/tunestead-cli.1 "$programs/tunestead-cli" "$command")
done

if [ -n "$complaints" ]; then
    echo "$complaints" >&2
    exit 1
fi
