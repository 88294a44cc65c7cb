#!/usr/bin/env bash
# Installs what is missing, builds the desktop program and starts it with the given arguments.
set -euo pipefail
arguments=()
for argument in "$@"; do
    # Names relative to where the command was given stay valid after the change of folder.
    if [ -e "$argument" ]; then argument=$(realpath -s -- "$argument"); fi
    arguments+=("$argument")
done
cd "$(dirname "$(realpath "$0")")"
. tools/packages.sh
install_packages "${build_packages[@]}" "${desktop_packages[@]}"

cmake --preset release -DTUNESTEAD_TESTS=OFF -DTUNESTEAD_BENCH=OFF >/dev/null
cmake --build --preset release --target tunestead tunestead-cli
exec build/release/bin/tunestead "${arguments[@]}"
