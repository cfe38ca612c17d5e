#!/usr/bin/env bash
# One end-to-end run: a front end of the updater on the simulated instrument
# in one scenario, judged by the simulator against what the scenario expects
# (the outcome shown or reported, the head's packages, the module's files,
# the service journal, the drive and the engine log). Exits 77 (skipped)
# when not run as root.
set -euo pipefail

usage() {
    echo "usage: run-front-end.sh main-head|declining|remote-head SCENARIO PROGRAM OUTPUT_DIR" >&2
    exit 1
}

(($# == 4)) || usage
front_end=$1
scenario=$2
program=$3
output=$4

if [[ $(id -u) -ne 0 ]]; then
    echo "SKIPPED: the simulated instrument needs root (network and mount namespaces, sshd); CI runs this as root"
    exit 77
fi

simulator=$(cd "$(dirname "$(readlink -f "${BASH_SOURCE[0]}")")/../../simulator" && pwd)
case $front_end in
remote-head) expect=remote driver=("$simulator/front-ends/remote-head" "$program") ;;
main-head) expect=main driver=("$simulator/front-ends/main-head" "$program") ;;
declining) expect=declined driver=("$simulator/front-ends/main-head" --answer no "$program") ;;
*) usage ;;
esac

exec "$simulator/instrument" --scenario "$scenario" --expect "$expect" --output "$output" \
    --expose "$(dirname "$(readlink -f "$program")")" -- "${driver[@]}"
