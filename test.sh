#!/usr/bin/env bash
# Installs what is missing, builds everything and runs every check: format, tests, lint. The programs as they are shipped
# are tested as they are, the engine under the sanitizers; "ctest --preset release" tests it optimised as well.
set -euo pipefail
cd "$(dirname "$(realpath "$0")")"
. tools/packages.sh
install_packages "${build_packages[@]}" "${desktop_packages[@]}" "${test_packages[@]}"

echo "== Format"
git ls-files '*.h' '*.cpp' | xargs clang-format --dry-run -Werror

echo "== Build and test"
cmake --preset release -DTUNESTEAD_ENGINE_TESTS=OFF >/dev/null
cmake --build --preset release
tools/check_includes.sh build/release
tools/check_data.sh build/release/bin
ctest --preset release --parallel "$(nproc)"

echo "== Tests of the engine under the address and undefined-behaviour sanitizers"
cmake --preset asan >/dev/null
cmake --build --preset asan
ctest --preset asan --parallel "$(nproc)"

echo "== Lint"
tools/lint.sh
