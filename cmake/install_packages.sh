#!/usr/bin/env bash
# Installs the Debian packages that a purpose needs and that are missing:
#
#     cmake/install_packages.sh GROUP...
#
# The groups are the names in packages(), below. It runs apt-get as root, or with sudo if that needs no password.
# Otherwise it says what is missing and fails. If nothing is missing, it does not use the network. Without dpkg it only
# names the packages.
set -euo pipefail

packages() {
    case $1 in
        build) echo g++ cmake ninja-build libwxgtk3.2-dev libexpat1-dev ;;
        sample) echo attr python3 ;;
        test) echo libgtest-dev ;;
        fuzz) echo clang libclang-rt-dev ;;
        checks) echo clang-format clang-tidy cppcheck shellcheck pyflakes3 ;;
        coverage) echo gcovr ;;
        bench) echo libbenchmark-dev python3 python3-lxml ;;
        mingw) echo g++-mingw-w64-x86-64-posix dpkg-dev make ;;
        windows) echo googletest wine64 zip wixl msitools nsis osslsigncode openssl python3 ;;
        *) echo "No such group of packages: $1" >&2; return 2 ;;
    esac
}

wanted=()
for group in "$@"; do
    names=$(packages "$group")
    read -ra names <<<"$names"
    wanted+=("${names[@]}")
done

if ! command -v dpkg-query >/dev/null; then
    echo "Not a Debian system. Install the counterparts of these packages: ${wanted[*]}" >&2
    exit 0
fi

missing=()
for package in "${wanted[@]}"; do
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
    "${as_root[@]}" apt-get -qy -o DPkg::Lock::Timeout=600 "$@" >>"$log" 2>&1 </dev/null
}
echo "Installing ${missing[*]}"
if ! apt update || ! apt install --no-install-recommends "${missing[@]}"; then
    cat "$log" >&2
    exit 1
fi
