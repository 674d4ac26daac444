# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash disable=SC2034,SC2154

# Registers in sfcb. Its staging folder has registration files in regs and classes in
# mofs/NAMESPACE, from which sfcbrepos builds the repository in the registration folder. The
# configuration names the registration folder; the staging folder is beside it. Sourced by
# sensor-profile-register.

registration_name=sensor-profile.reg
interop_namespace=root/interop
# The files with classes: of the sensors' namespace, of that of registered profiles, and all.
sensor_files=(sensor-profile.mof sensor-profile-conformance.mof)
interop_files=(sensor-profile-conformance.mof sensor-profile-registered-profile.mof)
class_names=(sensor-profile-computer-system.mof sensor-profile.mof "${interop_files[@]}")
# Whether a removal found anything.
was_registered=false

# ---- The folders

# Prints the name of the configuration: the one that was given, or that of the installation which
# sfcbrepos belongs to.
configuration_file() {
  local prefix
  prefix=$(dirname "$(dirname "$(command -v sfcbrepos)")")
  [ "$prefix" != /usr ] || prefix=''
  printf '%s' "${configuration:-$prefix/etc/sfcb/sfcb.cfg}"
}

# Prints the value of a setting, or nothing where it is not configured.
configured() {
  local file
  file=$(configuration_file)
  [ ! -r "$file" ] || sed -n "s/^[[:blank:]]*$1:[[:blank:]]*\([^[:blank:]].*\)/\1/p" "$file" | tail -n 1
}

# Prints the provider folders, the preferred one first: that of our libraries, or the last, since
# the first ones have the libraries of sfcb itself.
provider_folders() {
  local each folders
  if ! read -ra folders < <(configured providerDirs); then
    printf '%s\n' /usr/lib64/cmpi /usr/lib/cmpi
    return
  fi
  for each in "${folders[@]}"; do
    if is_same_folder "$each" "$library_folder"; then echo "$each"; fi
  done
  printf '%s\n' "${folders[@]}" | tac
}

# Sets `stage` to the staging folder and `repository_options` to the options that name the
# registration folder.
find_stage() {
  local folder
  stage=/var/lib/sfcb/stage
  repository_options=()
  if read -r folder < <(configured registrationDir); then
    stage=$(dirname "$folder")/stage
    repository_options=(-r "$folder")
  fi
  stage=${staging_folder:-$stage}
  [ -d "$stage" ] ||
    refuse "$stage is no folder: --staging-folder or --configuration says where sfcb keeps what" \
      "is staged"
  refuse_unreadable_stage
}

# Files in a folder that cannot be read would be taken for not staged.
refuse_unreadable_stage() {
  local folder
  folder=$(find "$stage" -type d \( ! -readable -o ! -executable \) -print -quit 2>/dev/null) ||
    true
  [ -z "$folder" ] || refuse "$folder cannot be read"
}

# ---- Staged files

# Sets `registered_in` to the namespace in our staged registration file, or to nothing where there is
# no such file.
find_registration() {
  local file=$stage/regs/$registration_name options=()
  registered_in=''
  [ -e "$file" ] || return 0
  registered_in=$(sed -n '/^ *namespace: */{s///;p;q}' "$file")
  grep --quiet '^\[ZUMLO_ComputerSystem\]' "$file" || options+=(--without-computer-system)
  earlier_command=$(command_to register --namespace "$registered_in" "${options[@]}")
}

# Prints the namespaces in which our classes are staged.
staged_namespaces() {
  [ -d "$stage/mofs" ] || return 0
  local names
  printf -v names '|%s' "${class_names[@]}"
  find "$stage/mofs" -regextype egrep -regex ".*/(${names:1})" -printf '%P\n' |
    sed 's|/[^/]*$||' | sort --unique
}

# Prints the files of our classes that are staged in the given namespace, or in all.
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

# Prints the staged files that the new registration does not have: those of other namespaces, and the
# class of a computer system that is not registered.
outdated_classes() {
  comm -23 <(staged_classes | sort) \
    <(printf '%s\n' "${sensor_files[@]/#/$stage/mofs/$namespace/}" \
      "${interop_files[@]/#/$stage/mofs/$interop_namespace/}" | sort)
}

# Prints the staged files that a removal deletes.
staged_files() {
  staged_classes ${namespace:+"$namespace"}
  "$keeps_registration" && return
  [ -z "$namespace" ] || staged_classes $interop_namespace
  existing "$stage/regs/$registration_name"
}

# ---- Changes

# A failure of sfcbrepos leaves sfcb without classes. Therefore each change is attempted in a copy
# first: the functions here run their commands through the given one, `attempt` or `step`.

build_repository() { "$1" sfcbrepos -s "$stage" "${repository_options[@]}" -f; }

stage_providers() {
  local outdated
  "$1" sfcbstage -s "$stage" -n "$namespace" -r "$registration" "${sensor_files[@]/#/$share/}"
  "$1" sfcbstage -s "$stage" -n $interop_namespace -r "$registration" \
    "${interop_files[@]/#/$share/}"
  mapfile -t outdated < <(outdated_classes)
  [ ${#outdated[@]} -eq 0 ] || "$1" rm "${outdated[@]}"
  build_repository "$1"
}

unstage_providers() {
  local staged
  mapfile -t staged < <(staged_files)
  [ ${#staged[@]} -eq 0 ] || "$1" rm "${staged[@]}"
  # Where nothing is staged, an earlier removal may have failed in this step.
  build_repository "$1"
}

attempt() {
  local status=0
  "$@" >log 2>&1 || status=$?
  [ $status -eq 0 ] && return
  sed "s|$stage/|$original/|g" log >&2
  refuse "tried in a copy of $original, $1 failed with exit code $status"
}

# Runs the function in copies of the staging folder and of the registration folder, from which
# sfcbrepos takes over instances. Links are not copied, but what they refer to.
try_in_copy() {
  local original=$stage repository=${repository_options[1]-}
  local stage=$work/stage repository_options=(-r "$work/registration")
  "$is_dry_run" && return
  attempt cp -rL "$original" "$stage"
  [ ! -d "$repository" ] || attempt cp -rL "$repository" "$work/registration"
  "$1" attempt
}

sfcb_register() {
  ! "$with_computer_system" || sensor_files=("${class_names[0]}" "${sensor_files[@]}")
  find_stage
  find_registration
  document $registration_name '/^\[ZUMLO_ComputerSystem\]$/,/^#$/'
  try_in_copy stage_providers
  link_libraries
  stage_providers step
  unlink_former_library
}

sfcb_remove() {
  local keeps_registration=false
  find_stage
  find_registration
  if [ -n "$registered_in" ] && [ "${namespace:-$registered_in}" != "$registered_in" ]; then
    keeps_registration=true
    echo "The registration stays: it is for $registered_in."
    [ -n "$(staged_files)" ] || return 0
  fi
  if [ -n "$(staged_files)" ] || has_links; then was_registered=true; fi
  try_in_copy unstage_providers
  unstage_providers step
  "$keeps_registration" || unlink_libraries
}

removal_command() { command_to remove --namespace "$namespace"; }
