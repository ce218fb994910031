#!/usr/bin/env bash
# Builds the package of Debian and the tarball, and tries both:
#   scripts/package.sh          all of it; as root the package is installed into a bare Debian too
#   scripts/package.sh --here   without the bare Debian
# The bare Debian is made by debootstrap from the mirror that this machine's apt uses, on the disk
# (under TMPDIR, else /var/tmp), and is removed at the end.
set -euo pipefail
root="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
cd "$root"
source scripts/packages.sh
out="$root/build/package/packages"
work="$(mktemp -d "${TMPDIR:-/var/tmp}/kora-package-XXXXXX")"
bare="$work/debian"
trap 'rm -rf --one-file-system "$work"' EXIT

install_missing "${kora_packages[@]}" "${package_packages[@]}"
build_preset package kora koractl koractl_pictures kora_packaging
rm -rf "$out"
quietly cpack --config build/package/CPackConfig.cmake -B "$out"
deb="$(echo "$out"/*.deb)" tarball="$(echo "$out"/*.tar.gz)"
rm -rf "$out/_CPack_Packages"
echo "Made $(basename "$deb") and $(basename "$tarball")"
dpkg-deb -f "$deb" Version Architecture Depends Installed-Size | sed 's/^/  /'

echo "lintian:"
lintian --allow-root --fail-on error --tag-display-limit 0 "$deb" | sed 's/^/  /'

# What is tried of an installed program, in a shell whose PATH finds it; with one argument, a
# folder to work in.
cat >"$work/try.sh" <<'TRY'
set -eu
cd "$1"
koractl --version
kora --version
koractl --home home demo --securities 8 --years 1
code=$(koractl --home home names | awk -F'\t' 'NR == 2 { print $3 }')
koractl --home home chart "$code" --osc MACD --out a.png
koractl --home home chart "$code" --out a.cht
koractl --home home print "$code" --out a.pdf
head -c 4 a.png | grep -q PNG
head -c 4 a.pdf | grep -q %PDF
# It stands until it is stopped, and has shown the chart without a word.
status=0
QT_QPA_PLATFORM=offscreen XDG_RUNTIME_DIR="$1" timeout 10 kora --home home a.cht >kora.log 2>&1 || status=$?
[ "$status" = 124 ] || { cat kora.log; echo "kora ended with $status"; exit 1; }
if grep -iE 'error|could not|cannot|no such' kora.log; then exit 1; fi
echo "koractl drew a chart and a page, kora stood"
TRY

echo "The tarball, in a folder of its own:"
mkdir "$work/any folder" "$work/try1"
tar -xzf "$tarball" -C "$work/any folder"
(PATH="$(echo "$work/any folder"/*/bin):$PATH" sh "$work/try.sh" "$work/try1") | sed 's/^/  /'

[[ "${1:-}" != --here ]] || exit 0
if [[ "$(id -u)" != 0 ]]; then
  echo "Only root can make a bare Debian; the package was not installed" >&2
  exit 0
fi
echo "The package, in a bare Debian:"
source /etc/os-release
mirror="$(apt-get indextargets --format '$(SITE) $(RELEASE)' 'Created-By: Packages' |
  awk -v release="$VERSION_CODENAME" '$2 == release { print $1; exit }')"
quietly debootstrap --variant=minbase "$VERSION_CODENAME" "$bare" "$mirror"
cp /etc/resolv.conf "$bare/etc/" 2>/dev/null || true
# Installs as a user would, then tries, then removes: nothing of it may stay.
in_bare() { chroot "$bare" /usr/bin/env -i PATH=/usr/sbin:/usr/bin:/sbin:/bin HOME=/tmp LC_ALL=C.UTF-8 DEBIAN_FRONTEND=noninteractive "$@"; }
cp "$deb" "$bare/tmp/kora.deb"
cp "$work/try.sh" "$bare/tmp/try.sh"
quietly in_bare apt-get -qq update
quietly in_bare apt-get -qq install -y --no-install-recommends /tmp/kora.deb
mkdir "$bare/tmp/try"
chroot "$bare" chown nobody /tmp/try
in_bare setpriv --reuid nobody --regid nogroup --clear-groups env HOME=/tmp/try \
  sh /tmp/try.sh /tmp/try | sed 's/^/  /'
quietly in_bare apt-get -qq purge -y kora-charting
left="$(find "$bare/usr" "$bare/etc" "$bare/var/lib" -iname '*kora*' -not -path '*/dpkg/*')"
[[ -z "$left" ]] || { echo "Left behind after its removal: $left" >&2; exit 1; }
echo "  removed without a trace"
