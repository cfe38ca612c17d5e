# shellcheck shell=bash
# Shared by every part of the simulator: messages, failure, and the place on
# the host where a run keeps its state.

# The module's file system lives below here and sshd chroots into it, so no
# component of the path may be writable by anyone but root: not under /tmp.
SIM_STATE_BASE=/var/lib/quarn-instrument-sim

say() {
    printf 'instrument: %s\n' "$*" >&2
}

die() {
    say "error: $*"
    exit 1
}

require_root() {
    [[ $(id -u) -eq 0 ]] || die "the simulated instrument needs root (namespaces, mounts, sshd); run it with sudo"
}

require_tools() {
    local tool missing=()
    for tool in "$@"; do
        command -v "$tool" >/dev/null 2>&1 || missing+=("$tool")
    done
    ((${#missing[@]} == 0)) || die "missing tools: ${missing[*]} (scripts/install-deps installs them)"
}

# Waits up to $1 seconds for the command after it to succeed.
wait_until() {
    local seconds=$1
    shift
    local deadline=$((SECONDS + seconds))
    until "$@"; do
        ((SECONDS < deadline)) || return 1
        sleep 0.1
    done
}
