# Sourced by the scripts: installs the Debian packages that are missing, with sudo when not root.
# Usage: karvel_require_packages PACKAGE...
karvel_require_packages() {
  local missing=()
  local pkg
  for pkg in "$@"; do
    dpkg-query -W -f='${Status}' "$pkg" 2>/dev/null | grep -q 'install ok installed' || missing+=("$pkg")
  done
  [ ${#missing[@]} -eq 0 ] && return 0
  echo "Installing missing packages: ${missing[*]}"
  local sudo=()
  [ "$(id -u)" -eq 0 ] || sudo=(sudo)
  # NOTE: only 64-bit Wine is installable here (the i386 archive does not resolve), so never
  # add the i386 architecture.
  # NOTE: an unrelated broken index makes `apt-get update` fail for good; what matters is
  # whether the packages install.
  "${sudo[@]}" env DEBIAN_FRONTEND=noninteractive apt-get -o DPkg::Lock::Timeout=600 update -qq ||
    echo "apt-get update failed; installing from the package lists there are"
  "${sudo[@]}" env DEBIAN_FRONTEND=noninteractive apt-get -o DPkg::Lock::Timeout=600 install -y -qq "${missing[@]}" >/dev/null
}

# The Microsoft-ABI check (scripts/check-msabi.sh) needs clang-cl, libc++ and Wine's headers; the
# fuzz targets (scripts/fuzz.sh) clang and its libFuzzer runtime.
KARVEL_BUILD_PACKAGES=(cmake make g++ binutils mingw-w64 binutils-mingw-w64-x86-64 binutils-mingw-w64-i686
                       wine wine64 xvfb xauth libosmesa6 googletest
                       libbenchmark-dev nlohmann-json3-dev libstb-dev doxygen libglu1-mesa-dev
                       clang-14 libc++-14-dev libwine-dev libclang-rt-14-dev)

# Creates the throwaway Wine prefix of a build tree once, so that tests do not race to make it.
karvel_wine_env() {
  export WINEPREFIX="$1/wineprefix" WINEDEBUG=-all WINEDLLOVERRIDES="mscoree,mshtml="
  if [ ! -f "$WINEPREFIX/system.reg" ]; then
    echo "Creating Wine prefix $WINEPREFIX"
    wineboot -i >/dev/null 2>&1 || true
    wineserver -w || true
  fi
}

karvel_jobs() { nproc 2>/dev/null || echo 2; }
