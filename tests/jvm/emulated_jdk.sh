#!/usr/bin/env bash
# Plays stroke scripts in an emulated AArch64 Java VM and compares their digests.
#
# The VM is Debian's own package, unpacked into a folder.
set -euo pipefail

usage() {
    cat <<'TEXT'
usage: emulated_jdk.sh ROOT --library DIR --player JARS SCRIPT...

  ROOT           folder for the AArch64 VM, about 210 MB; fetched (46 MB) unless it is there already
  --library DIR  folder of the AArch64 libdraventaUtil.so and, if it is not in ROOT, its liblog.so
  --player JARS  class path of the player: player.jar:draventaUtil.jar:standins.jar
  SCRIPT         stroke scripts, NAME.strokes, each with its NAME.digest beside it

The last line says how many digests are right. Status: 0 all are, 1 one is not or the VM ended
badly, 2 wrong usage, 77 skipped, because there is no emulator or the packages cannot be had.
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

command -v qemu-aarch64 >/dev/null || skip 'qemu-aarch64 is missing; on Debian, install qemu-user'
fetch=$(dirname "$0")/../helpers/fetch_packages.sh
[ -x "$root/$java" ] || "$fetch" "$root" "${packages[@]/%/:arm64}" ||
    skip 'the packages cannot be had'

library=$(cd "$library" && pwd)
pictures=$(mktemp -d)
trap 'rm -rf "$pictures"' EXIT
right=0
for script in "${scripts[@]}"; do
    say "playing $script on AArch64"
    qemu-aarch64 -L "$root" -E LD_LIBRARY_PATH="$library" "$root/$java" \
        -Djava.awt.headless=true -Djava.library.path="$library" \
        -cp "$player" com.velt.android.orvane.lumetrix.desktop.Player \
        "$script" --out "$pictures" --expect "$(cat "${script%.strokes}.digest")" &&
        right=$((right + 1))
done
echo "$right of ${#scripts[@]} digests are right"
[ $right -eq ${#scripts[@]} ]
