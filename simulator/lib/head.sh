# shellcheck shell=bash
# The main (or remote) head, where the updater runs: its apt and dpkg sandbox,
# its ssh access to the module, its services and its device files. Built on
# the host under $STATE/head, then put in place inside the head's namespaces.

HEAD_PACKAGES=(marlix4-dh marlix4-rh)

build_head() {
    local head=$STATE/head
    mkdir -p "$head/bin" "$head/services" "$head/ssh" "$head/fonts" "$head/old-packages"
    write_apt_sandbox "$head"
    install_fake_services "$head"
    write_device_files "$head"
    local package
    for package in "${HEAD_PACKAGES[@]}"; do
        build_head_package "$package" "$HEAD_INSTALLED" installable "$head/old-packages"
    done
}

# apt and dpkg for real, with every directory they write in the sandbox:
# state, lists, cache, configuration, log, the dpkg database and the root
# that dpkg installs into. The only source is the update drive.
write_apt_sandbox() {
    local head=$1
    local apt=$head/apt root=$head/root
    mkdir -p "$apt/etc/apt.conf.d" "$apt/etc/preferences.d" "$apt/etc/sources.list.d" "$apt/etc/trusted.gpg.d" \
        "$apt/state/lists/partial" "$apt/cache/archives/partial" \
        "$root/var/lib/dpkg/info" "$root/var/lib/dpkg/updates" "$root/var/lib/dpkg/triggers" "$root/var/log/apt"
    touch "$root/var/lib/dpkg/status"
    echo "deb [trusted=yes] file:/root/USB_MOUNT/debs ./" >"$apt/etc/sources.list"
    cat >"$apt/apt.conf" <<CONF
Dir::Etc "$apt/etc/";
Dir::Etc::main "apt.conf";
Dir::Etc::parts "apt.conf.d/";
Dir::Etc::sourcelist "sources.list";
Dir::Etc::sourceparts "sources.list.d/";
Dir::Etc::preferences "preferences";
Dir::Etc::preferencesparts "preferences.d/";
Dir::Etc::trusted "trusted.gpg";
Dir::Etc::trustedparts "trusted.gpg.d/";
Dir::State "$apt/state/";
Dir::State::lists "lists/";
Dir::State::status "$root/var/lib/dpkg/status";
Dir::Cache "$apt/cache/";
Dir::Cache::archives "archives/";
Dir::Log "$root/var/log/apt/";
DPkg::Options { "--root=$root"; "--admindir=$root/var/lib/dpkg"; "--log=$root/var/log/dpkg.log"; };
APT::Sandbox::User "root";
Acquire::Languages "none";
CONF
}

install_fake_services() {
    local head=$1
    local services=$head/services program
    for program in systemctl run-as-service; do
        sed "s|@SERVICES_DIR@|$services|" "$SIM_DIR/head/$program" >"$head/bin/$program"
        chmod 0755 "$head/bin/$program"
    done
    printf 'DRUV_STOP_SECONDS=%s\nDRUV_START_SECONDS=%s\n' "$DRUV_STOP_SECONDS" "$DRUV_START_SECONDS" >"$services/settings"
    echo active >"$services/druv.state"
    : >"$services/journal"
}

write_device_files() {
    local head=$1
    printf '[General]\nQuarnLanguage=%s\n' "$LANGUAGE" >"$head/language.ini"
    local font
    for font in /usr/share/fonts/truetype/dejavu/DejaVuSans.ttf /usr/share/fonts/truetype/dejavu/DejaVuSans-Bold.ttf; do
        [[ -f $font ]] && cp "$font" "$head/fonts/"
    done
    return 0
}

# The head reaches the module with a key of its own and knows the module's
# host key, so ssh and scp never ask anything.
write_ssh_access() {
    local head=$STATE/head module=$STATE/module
    ssh-keygen -q -t ed25519 -N '' -C head@instrument -f "$head/ssh/id_ed25519"
    printf '192.168.9.2 %s\n' "$(cut -d' ' -f1,2 "$module/ssh/ssh_host_ed25519_key.pub")" >"$head/ssh/known_hosts"
    cat >"$head/ssh/config" <<'CONF'
Host 192.168.9.2
    BatchMode yes
    StrictHostKeyChecking yes
    UserKnownHostsFile /root/.ssh/known_hosts
    GlobalKnownHostsFile /dev/null
    IdentityFile /root/.ssh/id_ed25519
    IdentitiesOnly yes
    LogLevel ERROR
CONF
    cp "$head/ssh/id_ed25519.pub" "$module/ssh/authorized_keys"
}

# Puts the head's view in place and installs the packages the head had
# before the drive was plugged in.
boot_head() {
    local expose_args=() path
    for path in "${EXPOSE[@]}"; do
        expose_args+=(--expose "$path")
    done
    [[ -n $HOST_X_SOCKET ]] && expose_args+=(--host-x-socket "$HOST_X_SOCKET")
    in_head "$SIM_DIR/head/prepare-namespace" "$STATE" "${expose_args[@]}"
    in_head ip link set lo up
    in_head ip addr add 192.168.9.1/24 dev vexa0
    in_head ip link set vexa0 up
    local root=$STATE/head/root
    in_head dpkg --root="$root" --admindir="$root/var/lib/dpkg" --log="$root/var/log/dpkg.log" \
        --install "$STATE"/head/old-packages/*.deb >>"$STATE/log/head-setup.log" 2>&1 ||
        die "installing the head's packages into the sandbox failed; see $STATE/log/head-setup.log"
}

# The environment the instrument gives the command: the fake service
# manager first on PATH, apt pointed at the sandbox, and nothing of the
# caller's display.
head_environment() {
    printf '%s\n' \
        "PATH=$STATE/head/bin:/usr/local/sbin:/usr/local/bin:/usr/sbin:/usr/bin:/sbin:/bin" \
        "APT_CONFIG=$STATE/head/apt/apt.conf" \
        "HOME=/root" \
        "USER=root" \
        "LANG=C.UTF-8" \
        "XDG_RUNTIME_DIR=/tmp/runtime-root" \
        "SIM_DIR=$SIM_DIR" \
        "SIM_OUTPUT=$OUTPUT" \
        "TERM=${TERM:-dumb}"
}
