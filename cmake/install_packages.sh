#!/usr/bin/env bash
# Installs those of the named Debian packages that are missing:
#
#     cmake/install_packages.sh PACKAGE...
#
# With apt-get, as root or by sudo without a password; where neither can be, it says what is missing and fails.
# When nothing is missing, nothing is asked of the network.
set -euo pipefail

if ! command -v dpkg-query >/dev/null; then
    echo "Not a Debian system; the counterparts of these packages have to be there: $*" >&2
    exit 0
fi

missing=()
for package in "$@"; do
    state=$(dpkg-query -W -f '${db:Status-Status}' "$package" 2>/dev/null) || true
    [ "$state" = installed ] || missing+=("$package")
done
[ ${#missing[@]} -gt 0 ] || exit 0

as_root=(env DEBIAN_FRONTEND=noninteractive)
if [ "$(id -u)" != 0 ]; then
    if ! sudo -n true 2>/dev/null; then
        echo "Missing packages: ${missing[*]}" >&2
        echo "Install them with: apt-get install --no-install-recommends ${missing[*]}" >&2
        exit 1
    fi
    as_root=(sudo -n "${as_root[@]}")
fi

log=$(mktemp)
trap 'rm -f "$log"' EXIT
apt() {
    "${as_root[@]}" apt-get -qy -o DPkg::Lock::Timeout=120 "$@" >>"$log" 2>&1 </dev/null
}
echo "Installing ${missing[*]}"
if ! apt update || ! apt install --no-install-recommends "${missing[@]}"; then
    cat "$log" >&2
    exit 1
fi
