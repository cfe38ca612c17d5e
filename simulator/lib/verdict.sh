# shellcheck shell=bash
# After the command: did the update end as the scenario expects? Compares the
# outcome the front end showed or reported, what is installed on the head and
# the module, the service journal, the drive and the engine log. Every check
# writes one line to $OUTPUT/verdict.txt.

VERDICT_FAILURES=0

check() {
    local description=$1
    shift
    if "$@"; then
        printf 'ok    %s\n' "$description" >>"$OUTPUT/verdict.txt"
    else
        printf 'FAIL  %s\n' "$description" >>"$OUTPUT/verdict.txt"
        VERDICT_FAILURES=$((VERDICT_FAILURES + 1))
    fi
}

same() {
    [[ $1 == "$2" ]]
}

# What the updater application shows for each engine outcome; the two check
# failures share one message box, and so do the two installation failures.
shown_outcome_of() {
    case $1 in
    NoUpdates) echo noUpdate ;;
    UpdateFinished) echo updateFinished ;;
    CheckUpdateFailed | UpdateMirrorsFailed) echo checkFailed ;;
    UpdateFailed | UpdateVexaFailed) echo updateFailed ;;
    esac
}

# The remote-head front end's documented exit statuses.
exit_status_of() {
    case $1 in
    UpdateFinished) echo 0 ;;
    NoUpdates) echo 1 ;;
    CheckUpdateFailed) echo 3 ;;
    UpdateMirrorsFailed) echo 4 ;;
    UpdateFailed) echo 5 ;;
    UpdateVexaFailed) echo 6 ;;
    esac
}

log_has_message() {
    grep -Fxq $'\t\t\t'"$1" "$OUTPUT/engine.log"
}

# The wind-down's steps appear in the log in this order.
log_has_wind_down() {
    local previous=0 step line
    for step in 'UpdateManager::stopDRUV()' 'UpdateManager::startDRUV()' 'UpdateManager::stopUpdater()'; do
        line=$(grep -Fn "$step" "$OUTPUT/engine.log" | tail -n 1 | cut -d: -f1)
        [[ -n $line ]] && ((line > previous)) || return 1
        previous=$line
    done
}

installed_version() {
    dpkg-query --admindir="$STATE/head/root/var/lib/dpkg" -W -f='${Version}' "$1" 2>/dev/null
}

sandbox_dpkg_upgraded() {
    grep -q " upgrade $1:all $2 $3\$" "$STATE/head/root/var/log/dpkg.log"
}

host_knows_no_head_package() {
    ! grep -q '^Package: marlix4-' /var/lib/dpkg/status
}

uploaded_release_is_first_listed() {
    local first
    first=$(first_module_directory_on_drive) || return 1
    cmp -s "$STATE/module/root/root/OSUpgrade.zip" "$first/OSUpgrade.zip" &&
        cmp -s "$STATE/module/root/unzipUpgrade.sh" "$first/unzipUpgrade.sh"
}

release_uploaded() {
    [[ -e $STATE/module/root/root/OSUpgrade.zip || -e $STATE/module/root/unzipUpgrade.sh ]]
}

journal_is() {
    diff -u <(printf '%s' "$1") "$STATE/head/services/journal" >>"$OUTPUT/verdict.txt"
}

# $1: main, remote or declined (main head, answering NO).
judge_run() {
    local mode=$1
    : >"$OUTPUT/verdict.txt"
    local expectation=$EXPECT_MAIN package=marlix4-dh other_package=marlix4-rh
    if [[ $mode == remote ]]; then
        expectation=$EXPECT_REMOTE package=marlix4-rh other_package=marlix4-dh
    fi
    local outcome head_version module_version
    read -r outcome head_version module_version <<<"$expectation"
    if [[ $mode == declined ]]; then
        [[ $(shown_outcome_of "$outcome") == update* ]] || die "$SCENARIO offers no update to decline"
        outcome=declined head_version=$HEAD_INSTALLED module_version=$MODULE_INSTALLED
    fi

    judge_outcome "$mode" "$outcome"
    judge_head "$package" "$head_version" "$other_package"
    judge_module "$outcome" "$module_version"
    judge_services_and_drive
    judge_log "$mode"
    cat "$OUTPUT/verdict.txt" >&2
    ((VERDICT_FAILURES == 0))
}

judge_outcome() {
    local mode=$1 outcome=$2
    local got status
    status=$(cat "$OUTPUT/updater-status" 2>/dev/null || echo none)
    case $mode in
    remote)
        check "the front end exits with $(exit_status_of "$outcome") ($outcome) (got $status)" \
            same "$status" "$(exit_status_of "$outcome")"
        check "the front end prints its outcome in words" grep -q '^QuarnRemoteUpdater: ' "$OUTPUT/engine.log"
        ;;
    *)
        got=$(cat "$OUTPUT/outcome" 2>/dev/null || echo nothing)
        local shown=$outcome
        [[ $mode == main ]] && shown=$(shown_outcome_of "$outcome")
        check "the screen shows $shown (showed $got)" same "$got" "$shown"
        check "the stop of druv-updater ends the updater (exit status $status, 143 = SIGTERM)" same "$status" 143
        ;;
    esac
}

judge_head() {
    local package=$1 version=$2 other_package=$3
    check "$package $version is installed in the head's sandbox (found $(installed_version "$package"))" \
        same "$(installed_version "$package")" "$version"
    check "$other_package is left at $HEAD_INSTALLED" same "$(installed_version "$other_package")" "$HEAD_INSTALLED"
    if [[ $version != "$HEAD_INSTALLED" ]]; then
        check "the sandbox's dpkg did the upgrade of $package" sandbox_dpkg_upgraded "$package" "$HEAD_INSTALLED" "$version"
    fi
    check "the host's package database knows no head package" host_knows_no_head_package
}

judge_module() {
    local outcome=$1 version=$2
    check "the module reports $version (reports $(module_version_now))" same "$(module_version_now)" "$version"
    if [[ $version != "$MODULE_INSTALLED" ]]; then
        check "the module received a release" release_uploaded
    fi
    if [[ $version == "$MODULE_INSTALLED" && $outcome != UpdateVexaFailed ]]; then
        check "the module received nothing" eval '! release_uploaded'
    elif release_uploaded; then
        check "the module received the release listed first on the drive" uploaded_release_is_first_listed
    fi
}

judge_services_and_drive() {
    local expected
    expected=$'stop\tdruv\tdrive=mounted\nstart\tdruv\tdrive=unmounted\nstop\tdruv-updater\tdrive=unmounted\n'
    check "the services were stopped and started in order, the drive unmounted before druv started" \
        journal_is "$expected"
    check "the drive is unmounted at the end" eval '! drive_mounted_in_head'
}

judge_log() {
    local mode=$1 message
    local messages=("${EXPECT_LOG[@]}")
    [[ $mode == remote ]] && messages+=("${EXPECT_LOG_REMOTE[@]}")
    [[ $mode == main ]] && messages+=("${EXPECT_LOG_MAIN[@]}")
    [[ $mode == declined ]] && messages=()
    check "the engine log shows the package index refresh" log_has_message "Running command: apt update"
    check "the engine log shows the wind-down: stopDRUV, startDRUV, stopUpdater" log_has_wind_down
    for message in "${messages[@]}"; do
        check "the engine log holds \"$message\"" log_has_message "$message"
    done
}
