# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash disable=SC2034

# The Debian packages that building, checking and measuring need, and their installation. Sourced by
# `run`, `check`, `bench/run` and `scripts/coverage`.

build_packages=(
  g++ cmake ninja-build
  libcli11-dev libexpat1-dev libfmt-dev libsensors-dev libspdlog-dev libutfcpp-dev
  nlohmann-json3-dev tao-pegtl-dev
  libcrypt-dev libgnutls28-dev libmicrohttpd-dev libsystemd-dev
  pkg-config
)

check_packages=(
  "${build_packages[@]}"
  clang clang-format clang-tidy libclang-rt-14-dev
  libbenchmark-dev libgmock-dev libgtest-dev
  binutils lm-sensors locales python3-jsonschema util-linux
  openssl sblim-wbemcli
  debootstrap dpkg-dev file iproute2 lintian man-db mandoc rpm rpmlint shellcheck systemd valgrind
)

bench_packages=(
  "${build_packages[@]}"
  libbenchmark-dev
  iproute2 lm-sensors util-linux
)

# Prints the packages of the list that are not installed, one per line.
missing_packages() {
  local package
  for package in "$@"; do
    # dpkg-query prints a line for each architecture.
    dpkg-query --show --showformat='${db:Status-Status}\n' "$package" 2>/dev/null |
      grep --quiet --line-regexp installed || echo "$package"
  done
}

# Installs the missing packages of the list, with sudo when not root. All output goes to standard
# error, so that it does not mix with the output of the caller.
install_packages() {
  local missing as_root=()
  mapfile -t missing < <(missing_packages "$@")
  [ ${#missing[@]} -eq 0 ] && return 0
  if [ "$(id -u)" -ne 0 ]; then
    if ! command -v sudo >/dev/null; then
      echo "These packages are missing, and neither root nor sudo is here to install them:" >&2
      echo "  ${missing[*]}" >&2
      return 1
    fi
    as_root=(sudo)
  fi
  echo "Installing ${missing[*]}" >&2
  # A machine that has just started may hold the lock while it updates itself.
  "${as_root[@]}" apt-get update --quiet=2 >&2 &&
    "${as_root[@]}" env DEBIAN_FRONTEND=noninteractive \
      apt-get -o DPkg::Lock::Timeout=300 install --yes --quiet=2 --no-install-recommends "${missing[@]}" >&2
}
