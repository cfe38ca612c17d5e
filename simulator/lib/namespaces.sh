# shellcheck shell=bash
# The instrument's two units as namespaces on this host: the head, where the
# updater runs, and the Vexa module. Each has its own network, mount and
# process namespace; a veth pair between them is the instrument's internal
# link and the only link either has. Nothing is configured in the host's own
# namespaces, so ending the units' first processes removes everything.

HEAD_INIT_PID=""
MODULE_INIT_PID=""
UNIT_UNSHARE_PIDS=()

# Starts the unit $1 and stores the PID of its first process in the
# variable named $2.
start_unit() {
    local name=$1
    local -n init_pid_of_unit=$2
    unshare --net --mount --pid --fork --propagation private --mount-proc -- "$SIM_DIR/lib/unit-init" \
        </dev/null >>"$STATE/log/$name-unit.log" 2>&1 &
    local unshare_pid=$!
    UNIT_UNSHARE_PIDS+=("$unshare_pid")
    wait_until 5 has_child "$unshare_pid" || die "the $name unit did not start"
    read -r init_pid_of_unit <"/proc/$unshare_pid/task/$unshare_pid/children" || true
}

has_child() {
    local children=""
    read -r children 2>/dev/null <"/proc/$1/task/$1/children" || true
    [[ -n $children ]]
}

start_units() {
    start_unit head HEAD_INIT_PID
    start_unit module MODULE_INIT_PID
    # Whoever checks that the instrument left nothing behind looks for these.
    printf 'state %s\nhead %s\nmodule %s\nunshare %s\n' "$STATE" "$HEAD_INIT_PID" "$MODULE_INIT_PID" \
        "${UNIT_UNSHARE_PIDS[*]}" >"$OUTPUT/instrument.units"
    ip link add vexa0 netns "$HEAD_INIT_PID" type veth peer name eth0 netns "$MODULE_INIT_PID"
}

in_head() {
    nsenter --target "$HEAD_INIT_PID" --mount --net --pid -- "$@"
}

in_module() {
    nsenter --target "$MODULE_INIT_PID" --mount --net --pid -- "$@"
}

# Ends both units: every process in them dies with their first process, and
# with the last process go their mounts, addresses and the link.
stop_units() {
    local pid
    for pid in "$HEAD_INIT_PID" "$MODULE_INIT_PID"; do
        [[ -n $pid ]] && kill -KILL "$pid" 2>/dev/null
    done
    # A unit whose first process was never known: its unshare still holds it.
    local first_process
    for pid in "${UNIT_UNSHARE_PIDS[@]}"; do
        first_process=""
        read -r first_process 2>/dev/null <"/proc/$pid/task/$pid/children" || true
        [[ -n $first_process ]] && kill -KILL "$first_process" 2>/dev/null
    done
    for pid in "${UNIT_UNSHARE_PIDS[@]}"; do
        wait "$pid" 2>/dev/null
    done
    return 0
}

units_alive() {
    local pid
    for pid in "$HEAD_INIT_PID" "$MODULE_INIT_PID"; do
        [[ -n $pid && -e /proc/$pid ]] && return 0
    done
    return 1
}

# True while the head still has the drive mounted.
drive_mounted_in_head() {
    awk '$5 == "/root/USB_MOUNT" { found = 1 } END { exit !found }' "/proc/$HEAD_INIT_PID/mountinfo"
}
