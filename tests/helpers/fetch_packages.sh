#!/usr/bin/env bash
# Unpacks Debian packages of other processors into a folder.
#
# They are fetched from the sources that this machine's apt knows. Nothing is installed, and dpkg's
# list of architectures stays as it is.
set -euo pipefail

usage() {
    cat <<'TEXT'
usage: fetch_packages.sh ROOT PACKAGE:ARCHITECTURE...

  ROOT  folder to unpack into; it must not exist, and does not exist afterwards if this fails
TEXT
}

say() { printf '== %s\n' "$*"; }
fail() { printf 'fetch_packages.sh: %s\n' "$*" >&2; exit 1; }

# Runs a command with its output in a file that is shown only when it fails.
quietly() {
    "$@" >"$work/log" 2>&1 || { tail -n 5 "$work/log"; return 1; }
}

if [ $# -lt 2 ] || [ -e "$1" ]; then usage >&2; exit 2; fi
for tool in apt-get dpkg-deb; do
    command -v "$tool" >/dev/null || fail "$tool is missing"
done
root=$1
shift
architectures=()
for package in "$@"; do
    case $package in
        *:?*) [[ " ${architectures[*]-} " == *" ${package##*:} "* ]] ||
            architectures+=("${package##*:}") ;;
        *) usage >&2; exit 2 ;;
    esac
done

# Everything happens in a folder beside ROOT, so that ROOT is there as a whole or it is not.
mkdir -p "$(dirname "$root")"
root=$(realpath "$root")
work=$(mktemp -d "$root.XXXXXX")
trap 'rm -rf "$work"' EXIT
mkdir -p "$work"/{state/lists,cache/archives,packages}/partial "$work/root"
: >"$work/state/status"
cat >"$work/apt.conf" <<CONF
APT::Architecture "${architectures[0]}";
APT::Architectures { $(printf '"%s"; ' "${architectures[@]}")};
APT::Sandbox::User "";
Acquire::Languages "none";
Dir::State "$work/state";
Dir::State::status "$work/state/status";
Dir::Cache "$work/cache";
CONF
say "fetching the lists of packages for ${architectures[*]}"
# A source without these fails the update; what counts is whether the packages are found.
APT_CONFIG=$work/apt.conf quietly apt-get update || true
say "fetching $*"
(cd "$work/packages" && APT_CONFIG=$work/apt.conf quietly apt-get download "$@") ||
    fail 'the packages cannot be had'
say "unpacking them into $root"
for package in "$work"/packages/*.deb; do dpkg-deb -x "$package" "$work/root"; done
mv -T "$work/root" "$root"
