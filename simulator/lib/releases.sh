# shellcheck shell=bash
# The software the simulated instrument is updated with: small head packages
# built with dpkg-deb, and module releases (archive plus install script) as
# the module's maker ships them.

# Builds the head package $1 at version $2 into directory $4. With $3 set to
# "unmet-dependency" the package needs a runtime that no repository has.
build_head_package() {
    local name=$1 version=$2 package_kind=$3 into=$4
    local tree=$STATE/build/$name-$version
    mkdir -p "$tree/DEBIAN" "$tree/opt/marlix4/$name" "$into"
    printf '%s %s\n' "$name" "$version" >"$tree/opt/marlix4/$name/version"
    {
        printf 'Package: %s\nVersion: %s\nArchitecture: all\n' "$name" "$version"
        printf 'Maintainer: Instrument simulator <simulator@quarn.invalid>\n'
        [[ $package_kind == unmet-dependency ]] && printf 'Depends: marlix4-runtime (>= 99)\n'
        printf 'Description: Marlix IV head software (simulated)\n'
    } >"$tree/DEBIAN/control"
    dpkg-deb --root-owner-group -Zgzip --build "$tree" "$into/" >/dev/null
}

# Builds the module release $1 into directory $3: OSUpgrade.zip holds the
# module's new files, unzipUpgrade.sh (behaviour $2, see module/releases/)
# puts them in place on the module.
build_module_release() {
    local version=$1 script_kind=$2 into=$3
    local tree=$STATE/build/vexa-$version
    mkdir -p "$tree/root/App/AppExe" "$into"
    # The module writes its version file with DOS line endings.
    printf 'Vexa module software\r\nQuillowmarsh\t%s\r\n' "$version" >"$tree/root/App/AppExe/version.txt"
    printf 'vexa application %s\n' "$version" >"$tree/root/App/AppExe/vexa-app"
    (cd "$tree" && zip -q -r -X "$into/OSUpgrade.zip" root)
    install -m 0755 "$SIM_DIR/module/releases/$script_kind.sh" "$into/unzipUpgrade.sh"
}
