#!/usr/bin/env bash
# Plays a tone through a sound server of its own, whose only sink is a virtual one, records what the sink was given and
# looks for the tone in it; with each engine that plays by itself. Argument: tunestead-cli.
source "$(dirname "$0")/private_session.sh"
cli=$(realpath "$1")
start_sound_server

sox -n -r 44100 -c 2 "$folder/tone.wav" synth 3 sine 660 gain -8

value() { awk -F: -v name="$1" '{ gsub(/ +/, " ", $1) } $1 == name { print $2 + 0 }' <<<"$figures"; }

hear() {
    start_recorder
    "$cli" play "$@" "$folder/tone.wav"
    stop_recorder
    local figures length loudness pitch
    figures=$(sox "$folder/heard.wav" -n remix 1 stat 2>&1)  # of both channels at once it tells a wrong frequency
    length=$(value 'Length (seconds)')
    loudness=$(value 'RMS amplitude')
    pitch=$(value 'Rough frequency')
    echo "$*: heard $length s, loudness $loudness, about $pitch Hz"
    awk -v length_="$length" -v loudness="$loudness" -v pitch="$pitch" 'BEGIN {
        # -8 dB of a full sine is 0.281; the clock of a virtual sink may be some per cent off.
        exit !(length_ > 2.6 && length_ < 3.4 && loudness > 0.25 && loudness < 0.31 && pitch > 640 && pitch < 680)
    }'
}

hear --engine fmod --output pulseaudio
hear --engine eldos
hear --engine mci
