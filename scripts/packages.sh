# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash disable=SC2034

# The Debian packages that building, checking and measuring need, and their installation. Sourced by
# `run`, `check`, `bench/run` and `scripts/coverage`.

build_packages=(
  g++ cmake ninja-build
  libcli11-dev libexpat1-dev libfmt-dev libncurses-dev libsensors-dev libspdlog-dev libutfcpp-dev
  libjs-dygraphs libkainjow-mustache-dev nlohmann-json3-dev
  prometheus-cpp-dev tao-pegtl-dev
  libcrypt-dev libgnutls28-dev libmicrohttpd-dev libsystemd-dev zlib1g-dev
  pkg-config
)

check_packages=(
  "${build_packages[@]}"
  clang clang-format clang-tidy libclang-rt-14-dev lld
  libbenchmark-dev libgmock-dev libgtest-dev
  binutils lm-sensors locales python3-jsonschema util-linux
  icinga2 openssl sblim-wbemcli tmux
  chromium chromium-driver fonts-ipafont-gothic poppler-utils python3-selenium
  freeipmi-tools ipmitool libopenipmi-dev openipmi
  prometheus prometheus-alertmanager prometheus-node-exporter victoria-metrics
  python3-prometheus-client python3-yaml
  debootstrap dpkg-dev file iproute2 jq lintian man-db mandoc rpm rpmlint shellcheck systemd valgrind
)

bench_packages=(
  "${build_packages[@]}"
  libbenchmark-dev
  iproute2 lm-sensors util-linux
)

# Packages whose programs are needed, but not the services that their installation starts.
service_packages=(
  icinga2 prometheus prometheus-alertmanager prometheus-node-exporter victoria-metrics
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

# Prints how much a command of apt-get downloads and how much room that takes, in parentheses.
# Prints nothing where this machine has no lists of packages yet.
size_of_packages() {
  LC_ALL=C apt-get -o Debug::NoLocking=true install --assume-no --no-install-recommends "$@" \
    2>/dev/null | awk '
      /^Need to get / { download = $0; gsub(/Need to get |\/.*| of archives.*/, "", download) }
      /^After this operation/ { print " (" download " to download, " $4 " " $5 " on the disk)" }'
}

# Prints the services that the installation of packages of the list would start, one per line.
services_of() {
  local package
  [ -d /run/systemd/system ] || return 0
  for package in "$@"; do
    [[ " ${service_packages[*]} " != *" $package "* ]] || echo "$package.service"
  done
}

# Installs packages without starting their services, which stay disabled. They are masked meanwhile
# and unmasked in any case, also after Ctrl-C. `as_root`, of the caller, is put in front of commands.
install_without_services() (
  mapfile -t services < <(services_of "$@")
  if [ ${#services[@]} -gt 0 ]; then
    trap 'unmask_services "${services[@]}"' EXIT
    "${as_root[@]}" systemctl mask --quiet "${services[@]}" || exit
  fi
  "${as_root[@]}" env DEBIAN_FRONTEND=noninteractive apt-get -o DPkg::Lock::Timeout=300 \
    install --yes --no-install-recommends "$@" </dev/null
)

unmask_services() {
  local service
  "${as_root[@]}" systemctl unmask --quiet "$@"
  for service in "$@"; do
    # Where the installation failed, it may be unknown.
    "${as_root[@]}" systemctl disable --quiet "$service" || true
  done
}

# Installs the missing packages of the list, with sudo when not root. The output of apt-get is
# printed only when it fails. Where the packages cannot be installed, the command for root is
# printed. All output goes to standard error, so that it does not mix with that of the caller.
install_packages() {
  local missing as_root=() log
  mapfile -t missing < <(missing_packages "$@")
  [ ${#missing[@]} -eq 0 ] && return 0
  if [ "$(id -u)" -eq 0 ] || { command -v sudo >/dev/null && as_root=(sudo); }; then
    log=$(mktemp)
    # A machine that has just started may hold the lock while it updates itself.
    if "${as_root[@]}" apt-get update >"$log" 2>&1 &&
      echo "Installing ${#missing[@]} packages$(size_of_packages "${missing[@]}"): ${missing[*]}" >&2 &&
      install_without_services "${missing[@]}" >"$log" 2>&1; then
      rm "$log"
      return 0
    fi
    cat "$log" >&2
    rm "$log"
  fi
  cat >&2 <<END
These packages are missing$(size_of_packages "${missing[@]}"). Root can install them:
  apt-get update && apt-get install --no-install-recommends ${missing[*]}
END
  return 1
}
