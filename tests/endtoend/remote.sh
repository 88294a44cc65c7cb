#!/usr/bin/env bash
# Has tunestead-cli drive the program over a session bus of their own. Arguments: tunestead, tunestead-cli.
source "$(dirname "$0")/private_session.sh"
program=$(realpath "$1")
cli=$(realpath "$2")
export QT_QPA_PLATFORM=offscreen TUNESTEAD_AUDIO=null LC_ALL=C.UTF-8
unset DISPLAY WAYLAND_DISPLAY

remote() { "$cli" remote "$@"; }
# Arguments: what it must answer, then the command.
expect() {
    local wanted=$1 answer
    shift
    answer=$(remote "$@")
    if [ "$answer" = "$wanted" ]; then return 0; fi
    echo "remote $*: '$answer' instead of '$wanted'" >&2
    return 1
}
fails_with() {
    local wanted=$1 status=0 said
    shift
    said=$(remote "$@" 2>&1) || status=$?
    if [ "$status $said" = "1 $wanted" ]; then return 0; fi
    echo "remote $*: $status, '$said'" >&2
    return 1
}

fails_with "Tunestead läuft nicht." status
mkdir "$folder/songs"
song="$folder/songs/Band - Käse Ж.wav"
sox -n -r 44100 -c 2 "$song" synth 3 sine 660
"$program" "$folder/songs" >"$folder/log" 2>&1 &
await remote version
await remote song 0

expect 6 version
expect '{"answer":0}' --json order
remote order 1
expect 1 message 4027
fails_with "Die Sammlung hat keinen Song mit der Nummer 7." song 7
remote open "$song"
fails_with "Datei nicht gefunden: /nix.mp3" open /nix.mp3
expect 3 status
[ "$(remote --json song | jq -r '"\(.artist): \(.title), \(.length)"')" = "Band: Käse Ж, 3" ]
remote play
expect 2 status
remote wait
expect 3 status
expect 0 message 1026
fails_with "Tunestead läuft nicht." status
