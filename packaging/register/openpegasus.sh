# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash disable=SC2034,SC2154

# Registers in OpenPegasus. Sourced by sensor-profile-register.

# Prints the provider folders of its packages.
provider_folders() { printf '%s\n' /usr/lib64/Pegasus/providers /usr/lib/Pegasus/providers; }

interop_namespace=root/PG_InterOp
modules=(SensorProfileModule SensorProfileRegistrationModule SensorProfileComputerSystemModule)

# A provider of each module, which is registered in the namespace of the classes.
declare -A provider_of=(
  [SensorProfileModule]=SensorProfileProvider
  [SensorProfileRegistrationModule]=SensorElementConformsToProfileProvider
  [SensorProfileComputerSystemModule]=ComputerSystemProvider
)

# Prints the namespace of the classes of a registered module, or nothing where there is no cimcli or
# an earlier failure left only a part of the registration.
namespace_of() {
  local key="ProviderModuleName=\"$1\",ProviderName=\"${provider_of[$1]}\",CapabilityID=\"1\""
  # A second namespace, if there is one, is that of registered profiles.
  cimcli gp "PG_ProviderCapabilities.$key" Namespaces -n $interop_namespace 2>/dev/null |
    sed -n 's/^Namespaces = *\([^ ]*\).*/\1/p' || true
}

# Sets `registered` to those of our modules that OpenPegasus lists.
find_registered_modules() {
  local list each registered_in='' options=()
  list=$(cimprovider -l) ||
    refuse "cimprovider -l failed with exit code $?: OpenPegasus must be running"
  registered=()
  for each in "${modules[@]}"; do
    if grep --quiet --line-regexp --fixed-strings -- "$each" <<<"$list"; then
      registered+=("$each")
      registered_in=${registered_in:-$(namespace_of "$each")}
    fi
  done
  [ -n "$registered_in" ] || return 0
  [[ " ${registered[*]} " == *" ${modules[-1]} "* ]] || options+=(--without-computer-system)
  earlier_command=$(command_to register --namespace "$registered_in" "${options[@]}")
}

# Prints nothing where a registration was found, which it would remove.
removal_command() { [ ${#registered[@]} -gt 0 ] || command_to remove; }

remove_modules() {
  local each
  for each in "${registered[@]}"; do
    step cimprovider -r -m "$each"
  done
}

# Deletes our classes, in every namespace where they are left: associations first, since the classes
# that they refer to must be known. The class of computer systems may be somebody else's where our
# provider of it is not registered.
remove_classes() {
  local space spaces names each classes=(
    ZUMLO_SensorElementConformsToProfile ZUMLO_SensorElementCapabilities ZUMLO_SensorSystemDevice
    ZUMLO_SensorEnabledLogicalElementCapabilities ZUMLO_NumericSensor ZUMLO_SensorRegisteredProfile)
  if ! has_commands cimcli; then
    echo "The classes stay, since cimcli, which deletes them, is not installed. Without providers" \
      "they do nothing."
    return
  fi
  [[ " ${registered[*]} " != *" ${modules[-1]} "* ]] || classes+=(ZUMLO_ComputerSystem)
  spaces=$(cimcli ns) || report_failure "failed with exit code $?: cimcli ns"
  for space in $spaces; do
    names=$(cimcli nc -di -n "$space") ||
      report_failure "failed with exit code $?: cimcli nc -di -n $space"
    for each in "${classes[@]}"; do
      if grep --quiet --line-regexp --fixed-strings -- "$each" <<<"$names"; then
        step cimcli dc "$each" -n "$space"
      fi
    done
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
  # cimprovider removes a module from all its namespaces.
  [ -z "$namespace" ] ||
    refuse_usage "--namespace: remove takes everything from OpenPegasus," \
      "in whichever namespace it is"
  find_registered_modules
  remove_modules
  unlink_libraries
  remove_classes
}
