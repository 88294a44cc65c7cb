# For the tests that need a desktop's services and must not meet those of the user. Sourced first: runs the test again
# under a session bus of its own, with folders of its own in $folder, which go when it ends.
set -euo pipefail
if [ "${PRIVATE_SESSION:-}" != yes ]; then
    exec env PRIVATE_SESSION=yes dbus-run-session -- "$0" "$@"
fi

folder=$(mktemp -d)
export XDG_RUNTIME_DIR=$folder/run HOME=$folder
unset XDG_CONFIG_HOME XDG_DATA_HOME XDG_STATE_HOME XDG_CACHE_HOME PULSE_SERVER TUNESTEAD_AUDIO
mkdir -m 700 "$XDG_RUNTIME_DIR"
trap 'kill $(jobs -p) 2>/dev/null || true; wait; rm -rf "$folder"' EXIT

# Tries a command up to so many times, 50 ms apart, until it succeeds.
poll() {
    local attempt attempts=$1
    shift
    for attempt in $(seq "$attempts"); do
        if "$@" >/dev/null 2>&1; then return 0; fi
        sleep 0.05
    done
    return 1
}

# Waits for a command to succeed; a minute at most, for busy machines.
await() {
    if poll 1200 "$@"; then return 0; fi
    echo "waited in vain for: $*" >&2
    return 1
}

# Arguments: the processes of its parts.
serves() { kill -0 "$@" && timeout 5 pactl list short sinks | grep -q auto_null; }

# A sound server whose only sink is a virtual one, "auto_null". Its parts give up when they come before the first, and now
# and then they miss each other: then they are started again.
start_sound_server() {
    local part parts attempt
    pipewire >"$folder/pipewire.log" 2>&1 &
    await pw-cli info 0
    for attempt in 1 2 3 4; do
        parts=()
        for part in wireplumber pipewire-pulse; do
            "$part" >"$folder/$part.log" 2>&1 &
            parts+=($!)
        done
        if poll 200 serves "${parts[@]}"; then return 0; fi
        kill "${parts[@]}" 2>/dev/null || true
        wait "${parts[@]}" || true
    done
    echo "the sound server does not start:" >&2
    tail "$folder"/*.log >&2
    return 1
}

# Writes down what the sink is given; returns when it does.
start_recorder() {
    rm -f "$folder/heard.raw"
    parec -d auto_null.monitor --latency-msec=30 --rate=44100 --channels=2 --format=s16le >"$folder/heard.raw" &
    recorder=$!
    await test -s "$folder/heard.raw"
}

# Ends that, and leaves what was heard in $folder/heard.wav, without the silence.
stop_recorder() {
    kill "$recorder"
    wait "$recorder" || true
    sox -r 44100 -c 2 -e signed -b 16 -t raw "$folder/heard.raw" "$folder/heard.wav" silence 1 0.05 1% -1 0.05 1%
}
