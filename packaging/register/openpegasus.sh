# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash disable=SC2034,SC2154

# Registers in OpenPegasus. Sourced by sensor-profile-register.

# Prints the provider folders of its packages.
provider_folders() { printf '%s\n' /usr/lib64/Pegasus/providers /usr/lib/Pegasus/providers; }

interop_namespace=root/PG_InterOp
modules=(SensorProfileModule SensorProfileRegistrationModule SensorProfileComputerSystemModule)

# Sets `registered` to those of our modules that OpenPegasus lists.
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
  [[ " ${registered[*]} " == *" ${modules[-1]} "* ]] || options+=(--without-computer-system)
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
  # -uc alone replaces a class of the same major version only.
  local each sensors=(-uc -aV) system=(-uc -aV)
  # An association refers to ZUMLO_ComputerSystem. Without -uc the class is added where it is missing
  # and left as it is where somebody else defined it; -w suppresses the warning that it is there.
  "$with_computer_system" || system=(-w)
  find_registered_modules
  document sensor-profile-registration.mof '/^\/\/ The computer system,/,$'
  link_libraries
  step cimmof "${system[@]}" -n "$namespace" "$share/sensor-profile-computer-system.mof"
  # One file at a time: of several, cimmof reports only whether the last one compiled.
  for each in sensor-profile.mof sensor-profile-conformance.mof; do
    step cimmof "${sensors[@]}" -n "$namespace" "$share/$each"
  done
  for each in sensor-profile-conformance.mof sensor-profile-registered-profile.mof; do
    step cimmof "${sensors[@]}" -n $interop_namespace "$share/$each"
  done
  remove_modules
  step cimmof -n $interop_namespace "$registration"
  unlink_former_library
}

openpegasus_remove() {
  # OpenPegasus lists modules without their namespaces.
  [ -z "$namespace" ] ||
    refuse_usage "--namespace: remove takes everything from OpenPegasus," \
      "in whichever namespace it is"
  find_registered_modules
  remove_modules
  unlink_libraries
}
