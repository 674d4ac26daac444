# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash disable=SC2034,SC2154

# Registering in sfcb. It keeps what is staged below one folder: registration files in regs,
# classes in mofs/NAMESPACE. Sourced by sensor-profile-register.

registration_name=sensor-profile.reg
class_names=(sensor-profile-computer-system.mof sensor-profile.mof)
# What a removal found.
was_registered=false

# Finds our files in `stage`, and sets `registered_in` to the namespace that the registration file
# names; empty when there is none.
look_at_stage() {
  local file options=()
  stage=${staging_folder:-/var/lib/sfcb/stage}
  staging=()
  [ -z "$staging_folder" ] || staging=(-s "$staging_folder")
  file=$stage/regs/$registration_name
  registered_in=''
  refuse_unreadable_stage
  [ -e "$file" ] || return 0
  registered_in=$(sed -n '/^ *namespace: */{s///;p;q}' "$file")
  grep --quiet '^\[ZUMLO_ComputerSystem\]' "$file" || options+=(--without-computer-system)
  earlier_command=$(command_to register --namespace "$registered_in" "${options[@]}")
}

# What lies in a folder that cannot be looked into would pass for not being staged.
refuse_unreadable_stage() {
  local folder
  [ -d "$stage" ] || return 0
  folder=$(find "$stage" -type d \( ! -readable -o ! -executable \) -print -quit 2>/dev/null) ||
    true
  [ -z "$folder" ] || refuse "$folder cannot be read"
}

removal_command() { command_to remove --namespace "$namespace"; }

# The namespaces that have classes of ours staged.
staged_namespaces() {
  [ -d "$stage/mofs" ] || return 0
  find "$stage/mofs" \( -name "${class_names[0]}" -o -name "${class_names[1]}" \) \
    -printf '%P\n' | sed 's|/[^/]*$||' | sort --unique
}

# Classes staged in this namespace, or all.
staged_classes() {
  local each
  if [ $# -gt 0 ]; then
    existing "${class_names[@]/#/$stage/mofs/$1/}"
  else
    for each in $(staged_namespaces); do
      staged_classes "$each"
    done
  fi
}

# Those that the registration leaves behind: of other namespaces, and the computer system's.
outdated_classes() {
  local each
  for each in $(staged_namespaces); do
    [ "$each" = "$namespace" ] || staged_classes "$each"
  done
  "$with_computer_system" || existing "$stage/mofs/$namespace/${class_names[0]}"
}

sfcb_register() {
  local each outdated
  look_at_stage
  document $registration_name '/^\[ZUMLO_ComputerSystem\]$/,/^#$/'
  link_libraries
  for each in "${classes[@]}"; do
    step sfcbstage "${staging[@]}" -n "$namespace" -r "$registration" "$each"
  done
  mapfile -t outdated < <(outdated_classes)
  [ ${#outdated[@]} -eq 0 ] || step rm "${outdated[@]}"
  step sfcbrepos "${staging[@]}" -f
  unlink_former_library
}

# With a namespace, that one; else all.
sfcb_remove() {
  local staged
  look_at_stage
  [ -d "$stage" ] ||
    refuse "$stage is no folder: --staging-folder says where sfcb keeps what is staged"
  mapfile -t staged < <(staged_classes ${namespace:+"$namespace"})
  if [ -n "$registered_in" ] && [ -n "$namespace" ] && [ "$namespace" != "$registered_in" ]; then
    echo "The registration stays: it is for $registered_in."
    [ ${#staged[@]} -gt 0 ] || return 0
    was_registered=true
    step rm "${staged[@]}"
    step sfcbrepos "${staging[@]}" -f
    return
  fi
  [ -z "$registered_in" ] || staged+=("$stage/regs/$registration_name")
  if [ ${#staged[@]} -gt 0 ] || has_links; then was_registered=true; fi
  [ ${#staged[@]} -eq 0 ] || step rm "${staged[@]}"
  # Even if nothing was staged: an earlier attempt may have failed here.
  step sfcbrepos "${staging[@]}" -f
  unlink_libraries
}
