# Shell functions of ./run and ./test. Sourced, with `root` set to the project's folder.

kora_packages=(
  cmake ninja-build g++ ccache
  qt6-base-dev qt6-svg-dev libgl1-mesa-dev
  libcli11-dev libgtest-dev libbenchmark-dev
  fonts-liberation
)
# For tests that are left out without them: those of a print queue, and the checks of what is
# installed.
test_packages=(cups printer-driver-cups-pdf desktop-file-utils appstream man-db shared-mime-info)
# For the packages of scripts/package.sh and their check.
package_packages=(dpkg-dev lintian debootstrap)
# For the fuzz targets of scripts/fuzz.sh.
fuzz_packages=(clang libclang-rt-14-dev)

# Installs what is missing of the packages named. Nothing is asked, and nothing is looked up
# where all are there.
install_missing() {
  local package missing=() as_root=()
  if ! command -v apt-get >/dev/null; then
    echo "No apt-get here; going on with what is installed (wanted: $*)" >&2
    return 0
  fi
  for package in "$@"; do
    if [[ "$(dpkg-query -W -f '${db:Status-Status}' "$package" 2>/dev/null || true)" != installed ]]; then
      missing+=("$package")
    fi
  done
  [[ ${#missing[@]} -gt 0 ]] || return 0
  if [[ "$(id -u)" != 0 ]]; then
    if ! command -v sudo >/dev/null; then
      echo "These packages are missing and only root can install them: ${missing[*]}" >&2
      return 1
    fi
    as_root=(sudo)
  fi
  echo "Installing ${missing[*]}"
  as_root+=(env DEBIAN_FRONTEND=noninteractive apt-get -qq)
  # A source that is out of reach need not be the one that is wanted: the installation decides.
  quietly "${as_root[@]}" update || echo "Going on with the lists of packages that are here" >&2
  quietly "${as_root[@]}" install -y --no-install-recommends "${missing[@]}"
}

# Runs a command without its output, which shows only when the command fails.
quietly() {
  local log status=0
  log="$(mktemp)"
  "$@" >"$log" 2>&1 </dev/null || status=$?
  if [[ $status != 0 ]]; then
    cat "$log" >&2
    echo "Failed: $*" >&2
  fi
  rm -f "$log"
  return $status
}

# Builds a preset; further words are targets.
build_preset() {
  # What was compiled in one checkout need not be compiled again in another.
  export CCACHE_BASEDIR="$root" CCACHE_NOHASHDIR=true
  local preset="$1" targets=()
  shift
  [[ $# -eq 0 ]] || targets=(--target "$@")
  echo "Building $preset"
  quietly cmake --preset "$preset"
  quietly cmake --build --preset "$preset" "${targets[@]}"
}
