#!/usr/bin/env bash
# Plays stroke scripts in an emulated AArch64 Java VM and compares their digests.
#
# The VM is Debian's own package, fetched from the sources that this machine's apt knows and
# unpacked into a folder: nothing is installed, and dpkg's list of architectures stays as it is.
set -euo pipefail

usage() {
    cat <<'TEXT'
usage: emulated_jdk.sh ROOT --library DIR --player JARS SCRIPT...

  ROOT           folder for the AArch64 VM, about 210 MB; fetched (46 MB) unless it is there already
  --library DIR  folder of the AArch64 libdraventaUtil.so and, if it is not in ROOT, its liblog.so
  --player JARS  class path of the player: player.jar:draventaUtil.jar:standins.jar
  SCRIPT         stroke scripts, NAME.strokes, each with its NAME.digest beside it

Status: 0 all digests are right, 1 one is not or the VM ended badly, 2 wrong usage, 77 skipped,
because there is no emulator or the packages cannot be had.
TEXT
}

say() { printf '== %s\n' "$*"; }
skip() { printf 'skipped: %s\n' "$*"; exit 77; }
wrong() { printf 'emulated_jdk.sh: %s\n' "$*" >&2; usage >&2; exit 2; }

# The VM and the libraries that it loads for a script: no sound, no fonts, no smart cards.
packages=(openjdk-17-jre-headless libc6 libgcc-s1 libstdc++6 zlib1g libjpeg62-turbo liblcms2-2)
java=usr/lib/jvm/java-17-openjdk-arm64/bin/java

root='' library='' player='' scripts=()
while [ $# -gt 0 ]; do
    case $1 in
        --help) usage; exit 0 ;;
        --library | --player)
            [ $# -ge 2 ] || wrong "$1 lacks its value"
            declare "${1#--}=$2"
            shift ;;
        -*) wrong "there is no option $1" ;;
        *) if [ -z "$root" ]; then root=$1; else scripts+=("$1"); fi ;;
    esac
    shift
done
if [ -z "$root" ] || [ -z "$library" ] || [ -z "$player" ] || [ ${#scripts[@]} -eq 0 ]; then
    wrong 'a folder, --library, --player and a script are needed'
fi
[ -e "$library/libdraventaUtil.so" ] || wrong "there is no libdraventaUtil.so in $library"

# Runs a command with its output in a file that is shown only when it fails.
quietly() {
    "$@" >"$work/log" 2>&1 || { tail -n 5 "$work/log"; return 1; }
}

# fetch: fills ROOT. Everything happens in a folder beside it, so that ROOT is there or it is not.
fetch() {
    local tool package
    for tool in apt-get dpkg-deb; do
        command -v "$tool" >/dev/null || skip "$tool is missing"
    done
    mkdir -p "$(dirname "$root")"
    root=$(realpath "$root")
    work=$(mktemp -d "$root.XXXXXX")
    trap 'rm -rf "$work"' EXIT
    mkdir -p "$work"/{state/lists,cache/archives,packages}/partial "$work/root"
    : >"$work/state/status"
    cat >"$work/apt.conf" <<CONF
APT::Architecture "arm64";
APT::Architectures { "arm64"; };
APT::Sandbox::User "";
Acquire::Languages "none";
Dir::State "$work/state";
Dir::State::status "$work/state/status";
Dir::Cache "$work/cache";
CONF
    say 'fetching the lists of packages for arm64'
    # A source without arm64 fails the update; what counts is whether the packages are found.
    APT_CONFIG=$work/apt.conf quietly apt-get update || true
    say "fetching ${packages[*]}"
    (cd "$work/packages" && APT_CONFIG=$work/apt.conf quietly apt-get download "${packages[@]}") ||
        skip 'the packages cannot be had'
    say "unpacking them into $root"
    for package in "$work"/packages/*.deb; do dpkg-deb -x "$package" "$work/root"; done
    mv -T "$work/root" "$root"
    rm -rf "$work"
}

command -v qemu-aarch64 >/dev/null || skip 'qemu-aarch64 is missing; on Debian, install qemu-user'
[ -x "$root/$java" ] || fetch

library=$(cd "$library" && pwd)
pictures=$(mktemp -d)
trap 'rm -rf "$pictures"' EXIT
status=0
for script in "${scripts[@]}"; do
    say "playing $script on AArch64"
    qemu-aarch64 -L "$root" -E LD_LIBRARY_PATH="$library" "$root/$java" \
        -Djava.awt.headless=true -Djava.library.path="$library" \
        -cp "$player" com.velt.android.orvane.lumetrix.desktop.Player \
        "$script" --out "$pictures" --expect "$(cat "${script%.strokes}.digest")" || status=1
done
exit $status
