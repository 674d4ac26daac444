# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash disable=SC2034,SC2154

# Registering in OpenPegasus. Sourced by sensor-profile-register.

modules=(SensorProfileModule SensorProfileComputerSystemModule)

# Sets `registered` to those of our modules that are registered with OpenPegasus.
find_registered_modules() {
  local list each options=(--namespace NAMESPACE)
  list=$(cimprovider -l) ||
    refuse "cimprovider -l failed with exit code $?: OpenPegasus must be running"
  registered=()
  for each in "${modules[@]}"; do
    if grep --quiet --line-regexp --fixed-strings -- "$each" <<<"$list"; then
      registered+=("$each")
    fi
  done
  [ ${#registered[@]} -gt 0 ] || return 0
  [[ " ${registered[*]} " == *" ${modules[1]} "* ]] || options+=(--without-computer-system)
  earlier_command="$(command_to register "${options[@]}") (NAMESPACE being the one it was in)"
}

removal_command() { command_to remove; }

remove_modules() {
  local each
  for each in "${registered[@]}"; do
    step cimprovider -r -m "$each"
  done
}

openpegasus_register() {
  local each
  find_registered_modules
  document sensor-profile-registration.mof '/^\/\/ The computer system,/,$'
  link_libraries
  for each in "${classes[@]}"; do
    step cimmof -uc -n "$namespace" "$each"
  done
  remove_modules
  step cimmof -n root/PG_InterOp "$registration"
  unlink_former_library
}

openpegasus_remove() {
  # What is listed does not say in which namespace it is.
  [ -z "$namespace" ] ||
    refuse_usage "--namespace: remove takes everything from OpenPegasus," \
      "in whichever namespace it is"
  find_registered_modules
  remove_modules
  unlink_libraries
}
