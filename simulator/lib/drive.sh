# shellcheck shell=bash
# The prepared USB drive: a flat Debian repository with both head packages
# in debs/, and one directory per module version in debs/VEXA/armhf/.

compose_drive() {
    local drive=$STATE/drive
    local repository=$drive/debs
    mkdir -p "$repository"
    build_head_package marlix4-dh "$HEAD_ON_DRIVE" "$HEAD_PACKAGE" "$repository"
    build_head_package marlix4-rh "$HEAD_ON_DRIVE" "$HEAD_PACKAGE" "$repository"
    write_package_index "$repository"

    local version
    for version in $MODULE_ON_DRIVE; do
        build_module_release "$version" "$MODULE_INSTALL_SCRIPT" "$repository/VEXA/armhf/$version"
    done
}

write_package_index() {
    local repository=$1
    if [[ $DRIVE_INDEX == garbled ]]; then
        printf 'this drive was written by a tool that crashed half-way\n' >"$repository/Packages"
        return
    fi
    (cd "$repository" && dpkg-scanpackages . 2>/dev/null | gzip -9n >Packages.gz)
}

# The directory whose files the updater must upload: the first one that ls
# lists, as the updater's own listing of the drive does.
first_module_directory_on_drive() {
    local first
    first=$(ls "$STATE/drive/debs/VEXA/armhf/" 2>/dev/null | head -n 1)
    [[ -n $first ]] && printf '%s' "$STATE/drive/debs/VEXA/armhf/$first"
}
