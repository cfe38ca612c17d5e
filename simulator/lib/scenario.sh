# shellcheck shell=bash
# Scenarios: scenarios/defaults holds every setting; a scenario file changes
# a few of them and states what each front end must end with.

scenario_file() {
    printf '%s/scenarios/%s.scenario' "$SIM_DIR" "$1"
}

list_scenarios() {
    local file
    for file in "$SIM_DIR"/scenarios/*.scenario; do
        basename "$file" .scenario
    done
}

print_scenarios() {
    local name
    for name in $(list_scenarios); do
        (
            load_scenario "$name"
            printf '  %-34s %s\n' "$name" "$SUMMARY"
        )
    done
}

load_scenario() {
    local file
    file=$(scenario_file "$1")
    [[ -f $file ]] || die "unknown scenario '$1'; known: $(list_scenarios | tr '\n' ' ')"
    # shellcheck source=/dev/null
    source "$SIM_DIR/scenarios/defaults"
    # shellcheck source=/dev/null
    source "$file"
    SCENARIO=$1
    check_scenario
}

# A mistyped setting would silently simulate something else: refuse it.
check_scenario() {
    one_of HEAD_PACKAGE installable unmet-dependency
    one_of DRIVE_INDEX readable garbled
    one_of MODULE_INSTALL_SCRIPT installs breaks-module
    one_of MODULE_LINK up down
    [[ $MODULE_RESTART_SECONDS =~ ^([0-9]+|never)$ ]] || die "$SCENARIO: MODULE_RESTART_SECONDS is '$MODULE_RESTART_SECONDS'"
    [[ $MODULE_REFUSED_UPLOADS =~ ^([0-9]+|all)$ ]] || die "$SCENARIO: MODULE_REFUSED_UPLOADS is '$MODULE_REFUSED_UPLOADS'"
    [[ $LANGUAGE =~ ^[A-Za-z_]+$ ]] || die "$SCENARIO: LANGUAGE is '$LANGUAGE'"
    local expectation
    local form='^(NoUpdates|UpdateFinished|CheckUpdateFailed|UpdateMirrorsFailed|UpdateFailed|UpdateVexaFailed) [^ ]+ [^ ]+$'
    for expectation in "$EXPECT_MAIN" "$EXPECT_REMOTE"; do
        [[ $expectation =~ $form ]] ||
            die "$SCENARIO: expectation '$expectation' is not 'Outcome headVersion moduleVersion'"
    done
}

one_of() {
    local name=$1 value=${!1}
    shift
    local allowed
    for allowed in "$@"; do
        [[ $value == "$allowed" ]] && return 0
    done
    die "$SCENARIO: $name is '$value'; allowed: $*"
}
