#!/usr/bin/env bash
# The 32-bit Windows tests: runs the mingw32 preset's tests (build/mingw32, already built) under
# 32-bit Wine. That needs a kernel that runs 32-bit x86 code itself, and 32-bit Wine, which comes
# from a Debian i386 chroot made here on first use: the host never gets the i386 architecture.
# Exit status: 0 the tests passed, 1 one failed, 3 32-bit programs cannot run on this machine
# (one line says why).
# Usage: test32.sh [--probe]   (--probe: only say whether they can run)
set -euo pipefail
cd "$(dirname "$0")/.."
# shellcheck source=scripts/setup.sh
source scripts/setup.sh
repo=$PWD
root=${KARVEL_CHROOT32:-/var/cache/karvel/bookworm-i386}
chroot_packages=(wine wine32 libwine xvfb xauth libosmesa6 libgl1-mesa-dri libglu1-mesa
                 cmake binutils-mingw-w64-i686)

cannot() {
  echo "32-bit Windows tests cannot run on this machine: $*"
  exit 3
}

# NOTE: an i386 emulator in binfmt_misc (qemu-user) would pass the probe below, but 32-bit Wine
# under emulation takes minutes per process start and crashes in exception handling.
probe_i386() {
  local entry
  for entry in /proc/sys/fs/binfmt_misc/*; do
    [ -f "$entry" ] || continue
    if grep -qx enabled "$entry" && grep -q '^magic 7f454c4601010100000000000000000002000300' "$entry"; then
      cannot "i386 programs would run through the emulator registered in binfmt_misc (${entry##*/})"
    fi
  done
  local dir error
  dir=$(mktemp -d)
  # shellcheck disable=SC2016 # an i386 program that exits with 0
  printf '.globl _start\n_start:\n movl $1, %%eax\n xorl %%ebx, %%ebx\n int $0x80\n' > "$dir/probe.s"
  if ! as --32 -o "$dir/probe.o" "$dir/probe.s" 2>/dev/null || ! ld -m elf_i386 -o "$dir/probe" "$dir/probe.o" 2>/dev/null; then
    rm -rf "$dir"
    cannot "no i386 assembler and linker to probe the kernel with (binutils)"
  fi
  if ! error=$("$dir/probe" 2>&1); then
    rm -rf "$dir"
    cannot "the kernel does not run i386 programs (${error##*: }; IA-32 emulation is off)"
  fi
  rm -rf "$dir"
}

# The Debian mirror that the host's apt uses for bookworm itself (not its security suite).
apt_mirror() {
  {
    local f
    for f in /etc/apt/sources.list.d/*.sources; do
      [ -f "$f" ] || continue
      awk 'BEGIN { RS = "" }
           /(^|\n)Suites:[^\n]*[ \t]bookworm([ \t\n]|$)/ && match($0, /(^|\n)URIs:[ \t]*[^ \t\n]+/) {
             uri = substr($0, RSTART, RLENGTH); sub(/.*URIs:[ \t]*/, "", uri); print uri }' "$f"
    done
    cat /etc/apt/sources.list /etc/apt/sources.list.d/*.list 2>/dev/null |
      awk '$1 == "deb" { i = 2; if ($i ~ /^\[/) { while ($i !~ /\]$/) i++; i++ }
                         if ($(i + 1) == "bookworm") print $i }'
    echo http://deb.debian.org/debian
  } | sed -n 1p  # NOTE: not head: under pipefail its early exit fails the writers with SIGPIPE
}

mounted=()
bind() {
  mkdir -p "$root$1"
  mountpoint -q "$root$1" || { mount --bind "$1" "$root$1"; mounted=("$root$1" "${mounted[@]}"); }
}
# Bind mounts make rm -rf and du cross into the host's folders: always undone before leaving.
unbind() {
  local dir
  for dir in "${mounted[@]}"; do umount "$dir" 2>/dev/null || umount -l "$dir"; done
  mounted=()
}

make_chroot() {
  [ -f "$root/.karvel-ready" ] && return 0
  echo "Creating the 32-bit chroot $root (once: a few minutes, about 1 GB)"
  karvel_require_packages debootstrap
  local mirror proxy=
  mirror=$(apt_mirror)
  eval "$(apt-config shell proxy Acquire::http::Proxy)"
  rm -rf --one-file-system "$root"
  mkdir -p "$root"
  http_proxy=$proxy debootstrap --arch=i386 --variant=minbase bookworm "$root" "$mirror" > "$root.log" 2>&1 ||
    { echo "debootstrap failed; see $root.log"; return 1; }
  # The security suite is left out: its i386 index does not match the others.
  printf 'deb %s bookworm main\ndeb %s bookworm-updates main\n' "$mirror" "$mirror" > "$root/etc/apt/sources.list"
  cp -r /etc/apt/apt.conf.d/. "$root/etc/apt/apt.conf.d/"
  [ -f /etc/apt/apt.conf ] && cp /etc/apt/apt.conf "$root/etc/apt/"
  printf 'APT::Install-Recommends "false";\nAcquire::Check-Valid-Until "false";\n' > "$root/etc/apt/apt.conf.d/90karvel"
  printf '#!/bin/sh\nexit 101\n' > "$root/usr/sbin/policy-rc.d"
  chmod +x "$root/usr/sbin/policy-rc.d"
  cp /etc/resolv.conf "$root/etc/resolv.conf" 2>/dev/null || true
  bind /proc
  bind /dev
  chroot "$root" env DEBIAN_FRONTEND=noninteractive apt-get update -qq >> "$root.log" 2>&1 || true
  chroot "$root" env DEBIAN_FRONTEND=noninteractive apt-get install -y -qq "${chroot_packages[@]}" >> "$root.log" 2>&1 ||
    { unbind; echo "installing 32-bit Wine in the chroot failed; see $root.log"; return 1; }
  unbind
  touch "$root/.karvel-ready"
}

probe_i386
[ "${1:-}" = --probe ] && { echo "32-bit programs run on this machine"; exit 0; }
[ "$(id -u)" -eq 0 ] || cannot "the 32-bit chroot needs root (debootstrap, chroot, mount)"
[ -f build/mingw32/CTestTestfile.cmake ] || { echo "build/mingw32 is not built (cmake --preset mingw32)"; exit 1; }

mkdir -p "$(dirname "$root")"
exec 9> "$root.lock"
flock 9  # one run at a time: the chroot, its mounts and the build tree's Wine prefix are shared
# Mounts left by a run that was killed.
awk -v r="$root/" 'index($2, r) == 1 { print $2 }' /proc/mounts | sort -r | while read -r dir; do umount -l "$dir"; done
trap unbind EXIT
make_chroot
# NOTE: Wine keeps its server directory in /tmp, so /tmp is shared; the build tree is seen at the
# same path so that the tests find their files.
bind /proc
bind /dev
bind /tmp
bind "$repo"
status=0
# shellcheck disable=SC2016 # expanded inside the chroot
chroot "$root" env -C "$repo" HOME=/root bash -c '
  source scripts/setup.sh
  karvel_wine_env "$PWD/build/mingw32"
  status=0
  xvfb-run -a -s "-screen 0 1280x1024x24" ctest --preset mingw32 || status=1
  wineserver -k 2>/dev/null || true
  exit $status' || status=1
exit $status
