#!/usr/bin/env bash
# Builds wxWidgets' Windows port and expat as static libraries for 64-bit Windows, from Debian's source packages (Debian
# has no such package ready made), and prints the folder they are in: bin/wx-config, include, lib, licences, and BUILD,
# which has the versions and flags. The result is kept, so that only the first run takes minutes and needs the network.
set -euo pipefail
export LC_ALL=C DEBIAN_FRONTEND=noninteractive

host=x86_64-w64-mingw32
install_packages=$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)/install_packages.sh
cache=${FOLDER_UPGRADE_CACHE:-${XDG_CACHE_HOME:-$HOME/.cache}/folder-upgrade}

flags=(-O2 -DNDEBUG -ffunction-sections -fdata-sections)

# The library's own error box and the dialogs that it consists of cannot be left out. The precompiled headers halve the
# time; the prefix is a placeholder, because wx-config finds its own location.
options=(
    --prefix=/wxmsw --with-msw --disable-shared --disable-debug_flag --enable-repro-build --enable-pch
    --disable-dependency-tracking --disable-tests --without-subdirs --disable-sys-libs --with-expat=sys
    --without-{libpng,libjpeg,libtiff,zlib,regex,liblzma,opengl,nanosvg}
    --disable-{accessibility,aui,debugreport,docview,graphics_ctx,help,html,joystick,mdi,mediactrl,postscript}
    --disable-{printarch,propgrid,ribbon,richtext,secretstore,sockets,sound,stc,svg,webrequest,webview,wizarddlg,xrc}
)

say() { printf 'wxWidgets for Windows, %d s: %s\n' "$SECONDS" "$*" >&3; }
die() { say "$*"; exit 1; }

cached() {
    local build
    for build in "$cache"/wxmsw-*-expat-*-"$key"/BUILD; do
        [ ! -f "$build" ] || prefix=${build%/BUILD}
    done
    [ -n "${prefix:-}" ]
}

# stage WHAT COMMAND...: runs the command, shows that it is alive meanwhile, and shows its output only if it fails.
stage() {
    say "$1"
    beat "$1" >/dev/null 9>&- &
    beat=$!
    "${@:2}" >>"$work/log" 2>&1
    kill "$beat"
    beat=
}

beat() {
    trap 'kill "$!" 2>/dev/null; exit' INT TERM
    while sleep 20 & wait "$!" && kill -0 "$$"; do say "still busy: $1"; done
}

finish() {
    local code=$?
    [ -z "${beat:-}" ] || kill "$beat" 2>/dev/null || true
    [ "$code" = 0 ] || { tail -n 30 "$work/log" >&2 && say "failed"; } || true
    rm -rf "$work"
}

# The machine's apt sources may lack source packages, and must not be changed. So the locations of Debian's own suites
# are read from apt itself, whatever format they are written in, and put into a private list, for which only Debian's
# key is accepted. The rest of the machine's apt configuration (proxies, certificates) applies.
update_sources() {
    local codename keyring=/usr/share/keyrings/debian-archive-keyring.gpg
    codename=$(sed -n 's/^VERSION_CODENAME=//p' /etc/os-release)
    mkdir -p "$work/lists/partial" "$work/archives/partial"
    apt-get -o Dir::State::Lists="$work/lists" update --print-uris |
        sed -nE "s#^'(.*)/dists/(($codename|stable)(-updates|-security)?)/main/binary-.*#deb-src [signed-by=$keyring] \1 \2 main#p" |
        sort -u >"$work/sources.list"
    [ -s "$work/sources.list" ] || die "no Debian package sources are configured"
    apt=(-q -o Dir::Etc::SourceList="$work/sources.list" -o Dir::Etc::SourceParts=/dev/null -o APT::Sandbox::User=root
        -o Dir::State::Lists="$work/lists" -o Dir::Cache="$work")
    apt-get "${apt[@]}" update
}

# The newest version may be listed before its files are on the mirror, so older ones are tried too.
fetch() {
    local version
    cd "$work"
    for version in $(apt-cache "${apt[@]}" --only-source showsrc "$1" | sed -n 's/^Version: //p' | sort -ruV); do
        if apt-get "${apt[@]}" --only-source --download-only source "$1=$version"; then
            dpkg-source -x "$1_${version#*:}.dsc" "$1"
            echo "$version" >"$1.version"
            return
        fi
        say "$1 $version cannot be downloaded"
    done
    return 1
}

# The source package has no configure script, and making one takes more tools than compiling the three files by hand.
build_expat() {
    cd "$work/expat/expat/lib"
    touch expat_config.h
    "$host-gcc-posix" "${flags[@]}" -I. -DXML_NS -DXML_DTD -DXML_GE=1 -DXML_CONTEXT_BYTES=1024 -DBYTEORDER=1234 \
        "-ffile-prefix-map=$work=." -c xmlparse.c xmltok.c xmlrole.c
    mkdir -p "$work/dest/wxmsw/include" "$work/dest/wxmsw/lib"
    "$host-ar" crD "$work/dest/wxmsw/lib/libexpat.a" xmlparse.o xmltok.o xmlrole.o
    cp expat.h expat_external.h "$work/dest/wxmsw/include/"
}

configure_wx() {
    local all="${flags[*]} -ffile-prefix-map=$work=."
    mkdir "$work/build"
    cd "$work/build"
    ../wxwidgets3.2/configure --host="$host" --build="$(uname -m)-pc-linux-gnu" "${options[@]}" \
        CC="$host-gcc-posix" CXX="$host-g++-posix" CFLAGS="$all" CXXFLAGS="$all" \
        CPPFLAGS="-I$work/dest/wxmsw/include" LDFLAGS="-L$work/dest/wxmsw/lib"
}

make_wx() {
    make -C "$work/build" -j"$(nproc)" AROPTIONS=crD
}

# wx-config must not contain the build folder or a fixed prefix, so that the result can be moved and copied.
install_wx() {
    local config
    make -C "$work/build" install DESTDIR="$work/dest"
    cd "$work/dest/wxmsw"
    rm -r share
    config=$(echo lib/wx/config/*)
    # shellcheck disable=SC2016
    sed -i -e "s| *-L$work/dest/wxmsw/lib||" \
        -e 's|^prefix=.*|prefix=${input_option_prefix-$(cd "$(dirname "$(readlink -f "$0")")/../../.." \&\& pwd)}|' "$config"
    ln -sf "../$config" bin/wx-config
    mkdir licences # for the notices in the package
    cat "$work"/wxwidgets3.2/{debian/copyright,docs/licence.txt} >licences/wxwidgets3.2
    cp "$work/expat/debian/copyright" licences/expat
}

exec 3>&2
key=$({ printf '%s\n' "${flags[@]}" "${options[@]}"; declare -f build_expat configure_wx make_wx install_wx; } |
    sha256sum | cut -c 1-8)
if cached; then
    echo "$prefix"
    exit
fi

mkdir -p "$cache"
exec 9>"$cache/lock"
flock -n 9 || { say "another build is running, waiting for it" && flock 9; }
if cached; then
    echo "$prefix"
    exit
fi
rm -rf "$cache"/build-*
work=$(mktemp -d "$cache/build-XXXXXX")
touch "$work/log"
trap finish EXIT

stage "installing missing Debian packages" "$install_packages" mingw
stage "looking up the source packages" update_sources
stage "downloading wxWidgets" fetch wxwidgets3.2
stage "downloading expat" fetch expat
stage "building expat" build_expat
stage "configuring wxWidgets" configure_wx
stage "building wxWidgets" make_wx
stage "putting it in place" install_wx

wx=$(<"$work/wxwidgets3.2.version")
expat=$(<"$work/expat.version")
{
    printf 'wxwidgets3.2 %s\nexpat %s\n' "$wx" "$expat"
    dpkg-query -W -f '${Package} ${Version}\n' g++-mingw-w64-x86-64-posix mingw-w64-x86-64-dev
    printf '%s\n' "${flags[@]}" "${options[@]}"
} >"$work/dest/wxmsw/BUILD"
prefix=$cache/wxmsw-${wx%%[-+]*}-expat-${expat%%[-+]*}-$key
rm -rf "$prefix"
mv -T "$work/dest/wxmsw" "$prefix"
say "done"
echo "$prefix"
