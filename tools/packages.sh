# Debian packages that the programs, the tests and the checks need. Sourced by run.sh and test.sh.

build_packages=(g++ cmake ninja-build ccache pkg-config qt6-base-dev libgl1-mesa-dev zlib1g-dev
    libsdl2-dev libavformat-dev libavcodec-dev libswresample-dev libavutil-dev libopenmpt-dev libfluidsynth-dev
    libfftw3-dev libmp3lame-dev libmpg123-dev libsndfile1-dev libgstreamer1.0-dev libgstreamer-plugins-base1.0-dev)
# What the programs look for only when they run: sounds for MIDI, what makes WMA, the system's player and its decoders.
sound_packages=(timgm6mb-soundfont ffmpeg gstreamer1.0-plugins-base gstreamer1.0-plugins-good gstreamer1.0-plugins-ugly
    gstreamer1.0-plugins-bad gstreamer1.0-libav gstreamer1.0-alsa)
desktop_packages=(libqt6svg6 qt6-translations-l10n breeze-icon-theme xdg-utils fonts-dejavu-core "${sound_packages[@]}")
test_packages=(libgtest-dev libbenchmark-dev libtag1-dev libsqlite3-dev clang-format clang-tidy jq dbus openssl
    sox pipewire pipewire-pulse wireplumber pulseaudio-utils audacious audacious-plugins
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
