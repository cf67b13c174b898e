# Sourced by `demo` and `test`: brings Debian packages onto the machine.

# install_missing PACKAGE...: installs those that are missing, as root or through sudo. Asks for nothing.
install_missing() {
    local missing=() package
    for package in "$@"; do
        # dpkg knows removed packages, too: only "installed" will do.
        [[ $(dpkg-query -W -f '${db:Status-Status}' "$package" 2>/dev/null) == installed ]] || missing+=("$package")
    done
    ((${#missing[@]})) || return 0
    echo "Installing ${missing[*]}"
    local as_root=()
    ((EUID == 0)) || as_root=(sudo)
    "${as_root[@]}" apt-get update -q
    "${as_root[@]}" env DEBIAN_FRONTEND=noninteractive apt-get install -q -y --no-install-recommends "${missing[@]}"
}
