#!/usr/bin/env bash
# Plays a tone with every engine that sounds by itself, through a sound server of the test's whose only sink is a virtual
# one, records what the sink was given and looks for the tone in it. Argument: tunestead-cli. Runs itself again under a
# session bus of its own.
set -euo pipefail
cli=$(realpath "$1")
if [ "${2:-}" != inside ]; then
    exec dbus-run-session -- "$0" "$cli" inside
fi

folder=$(mktemp -d)
export XDG_RUNTIME_DIR=$folder/run HOME=$folder
unset XDG_CONFIG_HOME XDG_DATA_HOME XDG_STATE_HOME PULSE_SERVER TUNESTEAD_AUDIO
mkdir -m 700 "$XDG_RUNTIME_DIR"
trap 'kill $(jobs -p) 2>/dev/null || true; wait; rm -rf "$folder"' EXIT

# Waits for a command to succeed; a minute at most, for busy machines.
await() {
    local attempt
    for attempt in $(seq 1200); do
        if "$@" >/dev/null 2>&1; then return 0; fi
        sleep 0.05
    done
    echo "waited in vain for: $*" >&2
    return 1
}

for server in pipewire wireplumber pipewire-pulse; do
    "$server" >"$folder/$server.log" 2>&1 &
done
await sh -c 'pactl list short sinks | grep -q auto_null'

sox -n -r 44100 -c 2 "$folder/tone.wav" synth 4 sine 660 gain -8
value() { awk -F: -v name="$1" '{ gsub(/ +/, " ", $1) } $1 == name { print $2 + 0 }' <<<"$figures"; }

# Arguments: those of the command line that play the tone.
hear() {
    local recorder figures length loudness pitch
    rm -f "$folder/heard.raw"
    parec -d auto_null.monitor --latency-msec=30 --rate=44100 --channels=2 --format=s16le >"$folder/heard.raw" &
    recorder=$!
    await test -s "$folder/heard.raw"
    "$cli" play "$@" "$folder/tone.wav"
    kill "$recorder"

    # The sound server begins and ends with silence.
    sox -r 44100 -c 2 -e signed -b 16 -t raw "$folder/heard.raw" "$folder/heard.wav" \
        silence 1 0.05 1% reverse silence 1 0.05 1% reverse
    figures=$(sox "$folder/heard.wav" -n remix 1 stat 2>&1)  # of both channels at once it tells a wrong frequency
    length=$(value 'Length (seconds)')
    loudness=$(value 'RMS amplitude')
    pitch=$(value 'Rough frequency')
    echo "$*: heard $length s, loudness $loudness, about $pitch Hz"
    awk -v length_="$length" -v loudness="$loudness" -v pitch="$pitch" 'BEGIN {
        # -8 dB of a full sine is 0.281; the clock of a virtual sink may be some per cent off.
        exit !(length_ > 3.5 && length_ < 4.5 && loudness > 0.25 && loudness < 0.31 && pitch > 640 && pitch < 680)
    }'
}

hear --engine fmod --output pulseaudio
hear --engine eldos
hear --engine mci
