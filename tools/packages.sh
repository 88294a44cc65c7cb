# Debian packages that the programs, the tests and the checks need. Sourced by run.sh and test.sh.

build_packages=(g++ cmake ninja-build ccache qt6-base-dev libgl1-mesa-dev zlib1g-dev)
desktop_packages=(libqt6svg6 qt6-translations-l10n breeze-icon-theme xdg-utils fonts-dejavu-core)
test_packages=(libgtest-dev libbenchmark-dev libtag1-dev libsqlite3-dev pkg-config clang-format clang-tidy jq
    desktop-file-utils appstream shared-mime-info man-db)

# Installs those of the named packages that are missing.
install_packages() {
    local missing=() package
    for package in "$@"; do
        [ "$(dpkg-query -W -f='${db:Status-Status}' "$package" 2>/dev/null)" = installed ] || missing+=("$package")
    done
    [ ${#missing[@]} -gt 0 ] || return 0
    local as_root=()
    if [ "$(id -u)" -ne 0 ]; then
        as_root=(sudo)
    fi
    echo "Installing: ${missing[*]}"
    "${as_root[@]}" apt-get update
    "${as_root[@]}" env DEBIAN_FRONTEND=noninteractive apt-get install -y --no-install-recommends "${missing[@]}"
}
