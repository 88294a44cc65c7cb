#!/usr/bin/env bash
# Has Audacious, as it comes, play two songs for the engine that hands songs to other players: the first has to start
# it, the second finds it running. Records both. Argument: tunestead-cli.
source "$(dirname "$0")/private_session.sh"
cli=$(realpath "$1")
export QT_QPA_PLATFORM=offscreen
unset DISPLAY WAYLAND_DISPLAY
start_sound_server
start_recorder

# Its interface of the other toolkit wants a display.
mkdir -p "$folder/.config/audacious"
printf '[audacious]\nuse_qt=TRUE\n' >"$folder/.config/audacious/config"

bus() {
    dbus-send --session --print-reply=literal --dest=org.freedesktop.DBus / "org.freedesktop.DBus.$1" \
        string:org.mpris.MediaPlayer2.audacious 2>/dev/null
}
is_running() { bus NameHasOwner | grep -qw true; }
player() { dbus-send --session --print-reply=literal --dest=org.mpris.MediaPlayer2.audacious /org/mpris/MediaPlayer2 "$@"; }

# "STATUS POSITION URL", the position in microseconds, of the player; nothing when it is not there.
state() {
    player org.freedesktop.DBus.Properties.GetAll string:org.mpris.MediaPlayer2.Player 2>/dev/null |
        awk '$1 == "PlaybackStatus" { status = $3 }
             $1 == "Position" { position = $4 }
             $1 == "xesam:url" { url = $3 }
             END { print status, position, url }'
}

# Plays a song of three seconds, watching the player meanwhile: it must have had the song, and told where it was. It is up to
# a second behind with that.
play() {
    local song=$1 url=$2 furthest=0 status position playing log=$folder/log
    timeout 90 "$cli" play --engine winamp "$song" >"$log" 2>&1 &
    local run=$!
    while kill -0 "$run" 2>/dev/null; do
        read -r status position playing <<<"$(state)" || true
        if [ "$status $playing" = "Playing $url" ] && [ "$position" -gt "$furthest" ]; then furthest=$position; fi
        sleep 0.05
    done
    local result=0
    wait "$run" || result=$?
    echo "$(basename "$song"): heard up to $furthest µs, result $result"
    if [ "$result" -ne 0 ] || [ "$furthest" -lt 1000000 ] || ! grep -qxF "$song" "$log"; then
        echo "the program said:" >&2
        cat "$log" >&2
        return 1
    fi
}

sox -n -r 44100 -c 2 "$folder/Ärger & 100 % Spaß #1.wav" synth 3 sine 660 gain -8
sox -n -r 44100 -c 2 "$folder/second.aiff" synth 3 sine 440 gain -8
if is_running; then
    echo "the player runs already" >&2
    exit 1
fi
play "$folder/Ärger & 100 % Spaß #1.wav" "file://$folder/%C3%84rger%20%26%20100%20%25%20Spa%C3%9F%20%231.wav"
first=$(bus GetConnectionUnixProcessID)
play "$folder/second.aiff" "file://$folder/second.aiff"
if [ "$first" != "$(bus GetConnectionUnixProcessID)" ]; then
    echo "the second song was played by another player" >&2
    exit 1
fi

stop_recorder
length=$(soxi -D "$folder/heard.wav")
echo "heard $length s"
if ! awk -v length_="$length" 'BEGIN { exit !(length_ > 5.5 && length_ < 6.5) }'; then
    echo "these are not two songs of 3 s from start to end" >&2
    exit 1
fi

player org.mpris.MediaPlayer2.Quit >/dev/null
has_gone() { ! is_running; }
await has_gone
