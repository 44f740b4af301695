# What the commands of the tests use. PALLAX is the program, STEPS_OUT the file for what
# they print.
# shellcheck shell=bash

exec >"$STEPS_OUT" 2>&1
WORLDS=$(dirname "${BASH_SOURCE[0]}")
folder=$(mktemp -d "${TMPDIR:-/tmp}/modem-steps.XXXXXX")
mkdir -m 700 "$folder/run"
export XDG_RUNTIME_DIR=$folder/run HOME=$folder XDG_CONFIG_HOME=$folder
pallax_pid=
trap 'end_pallax; rm -rf "$folder"' EXIT

# begin_pallax ARGUMENT...: in the background; what it prints is looked at by `shows`.
begin_pallax() {
    : >"$folder/out"
    "$PALLAX" "$@" >"$folder/out" 2>"$folder/err" </dev/null &
    pallax_pid=$!
}

# end_pallax: as Ctrl-C does; prints what it wrote to standard error.
end_pallax() {
    if [ -n "$pallax_pid" ]; then
        kill -INT "$pallax_pid" 2>/dev/null
        wait "$pallax_pid"
        pallax_pid=
        cat "$folder/err"
    fi
}

# The latest picture, without the marks of changes, each value with its section.
latest() {
    tac "$folder/out" | sed '/^== /q' | tac | sed 's/^\*/ /' |
        awk '/^[A-Z]/ { section = $0 } /^ / { sub(/^ +/, ""); print section "/" $0 }'
}

# shows TEXT [SECONDS]: waits until a line of the latest picture is TEXT, and tells how it went.
shows() {
    local end=$((SECONDS + ${2:-20}))
    until latest | grep -qxF -- "$1"; do
        if [ $SECONDS -ge $end ]; then
            echo "missing: $1"
            latest
            return
        fi
        sleep 0.1
    done
    echo "$1"
}

# succeeds COMMAND: waits until it does.
succeeds() {
    local end=$((SECONDS + 20))
    until eval "$1"; do
        if [ $SECONDS -ge $end ]; then
            echo "failed: $1"
            return
        fi
        sleep 0.1
    done
}

# modem_manager_pid: of the ModemManager on the bus.
modem_manager_pid() {
    gdbus call --system --dest org.freedesktop.DBus --object-path /org/freedesktop/DBus \
        --method org.freedesktop.DBus.GetConnectionUnixProcessID org.freedesktop.ModemManager1 |
        grep -o '[0-9]*,' | tr -d ,
}
