# shellcheck shell=bash
# The Vexa module: a file system of its own under $STATE/module/root, an
# sshd that chroots every session into it, and a power controller that
# restarts the module when its install script asks. It runs in its own
# namespaces at 192.168.9.2.

build_module() {
    local module=$STATE/module
    local root=$module/root
    install -d -m 0755 "$module" "$module/ssh" "$root"
    build_module_root "$root"
    ssh-keygen -q -t ed25519 -N '' -C vexa-module -f "$module/ssh/ssh_host_ed25519_key"
    prepare_upload_gate "$root"
    write_sshd_config "$module"
}

# The module's own "/": the host's programs appear through read-only binds
# made when the module boots; everything the updater touches (/root/ and
# /unzipUpgrade.sh) is the module's.
build_module_root() {
    local root=$1 directory
    install -d -m 0755 "$root/usr" "$root/etc" "$root/dev" "$root/root/App/AppExe" \
        "$root/run/vexa" "$root/opt/vexa" "$root/var/lib/vexa"
    install -d -m 1777 "$root/tmp"
    for directory in bin sbin lib lib32 lib64 libx32; do
        if [[ -L /$directory ]]; then
            ln -s "$(readlink "/$directory")" "$root/$directory"
        elif [[ -d /$directory ]]; then
            install -d -m 0755 "$root/$directory"
        fi
    done
    printf 'Vexa module software\r\nQuillowmarsh\t%s\r\n' "$MODULE_INSTALLED" >"$root/root/App/AppExe/version.txt"
}

# Uploads go through sftp (today's scp speaks it). A module that should turn
# uploads away gets a gate in front of its sftp server.
prepare_upload_gate() {
    local root=$1
    [[ $MODULE_REFUSED_UPLOADS == 0 ]] && return 0
    install -m 0755 "$SIM_DIR/module/sftp-gate" "$root/opt/vexa/sftp-gate"
    echo "$MODULE_REFUSED_UPLOADS" >"$root/var/lib/vexa/uploads-to-refuse"
}

write_sshd_config() {
    local module=$1
    local subsystem=internal-sftp
    [[ $MODULE_REFUSED_UPLOADS == 0 ]] || subsystem=/opt/vexa/sftp-gate
    cat >"$module/ssh/sshd_config" <<CONF
ListenAddress 192.168.9.2
Port 22
HostKey $module/ssh/ssh_host_ed25519_key
PidFile /run/sshd.pid
AuthorizedKeysFile $module/ssh/authorized_keys
PermitRootLogin prohibit-password
PubkeyAuthentication yes
PasswordAuthentication no
KbdInteractiveAuthentication no
UsePAM no
UseDNS no
PrintMotd no
PrintLastLog no
StrictModes yes
ChrootDirectory $module/root
Subsystem sftp $subsystem
CONF
}

boot_module() {
    in_module "$SIM_DIR/module/power-on" "$STATE/module" "$MODULE_LINK" "$MODULE_RESTART_SECONDS" \
        >>"$STATE/log/module-setup.log" 2>&1 ||
        die "the module did not power on; see $STATE/log/module-setup.log"
}

# What the module's version file says now: the version of its tagged line,
# or "none" when the module has no version.
module_version_now() {
    local file=$STATE/module/root/root/App/AppExe/version.txt line
    line=$(grep -a $'^Quillowmarsh\t' "$file" 2>/dev/null | tail -n 1) || true
    line=${line#Quillowmarsh$'\t'}
    line=${line%$'\r'}
    printf '%s' "${line:-none}"
}
