#!/usr/bin/env bash
# The simulated instrument leaves nothing behind on the host: not after a
# command that succeeds, not after one that fails, and not after Ctrl-C in
# the middle of a run. "Nothing" is: no state directory, no process of the
# instrument's units (and with them no namespace, link or mount), and no
# mount of the host that names the state directory. Exits 77 (skipped) when
# not run as root.
set -euo pipefail

usage() {
    echo "usage: leaves-nothing-behind.sh OUTPUT_DIR" >&2
    exit 1
}
(($# == 1)) || usage
output=$1

if [[ $(id -u) -ne 0 ]]; then
    echo "SKIPPED: the simulated instrument needs root (network and mount namespaces, sshd); CI runs this as root"
    exit 77
fi

instrument=$(cd "$(dirname "$(readlink -f "${BASH_SOURCE[0]}")")/../../simulator" && pwd)/instrument
failures=0

fail() {
    echo "FAIL: $*"
    failures=$((failures + 1))
}

# The units and state directory that the run in $1 recorded are all gone.
expect_nothing_left() {
    local run=$1 state pids pid
    [[ -s $run/instrument.units ]] || {
        fail "$run: the instrument recorded no units"
        return
    }
    state=$(awk '$1 == "state" { print $2 }' "$run/instrument.units")
    pids=$(awk '$1 != "state" { $1 = ""; print }' "$run/instrument.units")
    [[ ! -e $state ]] || fail "$run: the state directory $state is still there"
    for pid in $pids; do
        [[ ! -e /proc/$pid ]] || fail "$run: process $pid of the instrument is still running: $(tr '\0' ' ' <"/proc/$pid/cmdline")"
    done
    ! grep -qF "$state" /proc/self/mountinfo || fail "$run: the host has a mount below $state"
}

expect_status() {
    local description=$1 expected=$2 got=$3
    [[ $got == "$expected" ]] || fail "$description: exit status $got, expected $expected"
}

rm -rf "$output"
mkdir -p "$output"

status=0
"$instrument" --scenario nothing-to-update --output "$output/success" -- true || status=$?
expect_status "a command that succeeds" 0 "$status"
expect_nothing_left "$output/success"

status=0
"$instrument" --scenario nothing-to-update --output "$output/failure" -- false || status=$?
expect_status "a command that fails" 1 "$status"
expect_nothing_left "$output/failure"

# Ctrl-C reaches every process of the terminal's foreground group: here the
# instrument's own process group, while its command is waiting on the head.
set -m
# shellcheck disable=SC2016 # $SIM_OUTPUT is the head's, expanded there
"$instrument" --scenario both-updates --output "$output/interrupted" -- \
    bash -c 'touch "$SIM_OUTPUT/running"; sleep 120' &
instrument_pid=$!
set +m
for _ in $(seq 300); do
    [[ -e $output/interrupted/running ]] && break
    sleep 0.1
done
[[ -e $output/interrupted/running ]] || fail "the interrupted run never got to its command"
kill -INT -- "-$instrument_pid"
status=0
wait "$instrument_pid" || status=$?
expect_status "a run ended by Ctrl-C" 130 "$status"
expect_nothing_left "$output/interrupted"

if ((failures > 0)); then
    echo "$failures check(s) failed"
    exit 1
fi
echo "the instrument left nothing behind in all three runs"
