# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash disable=SC2154

# Links the provider libraries into the folder in which the object manager looks for them. Sourced
# by sensor-profile-register.

# Sets `used_folder` to the folder that was named, to the first existing one of those that the object
# manager may have, or to that of the libraries.
choose_provider_folder() {
  local folder
  is_folder_known=true
  used_folder=$provider_folder
  while [ -z "$used_folder" ] && read -r folder; do
    [ ! -d "$folder" ] || used_folder=$folder
  done < <(provider_folders)
  [ -z "$used_folder" ] || return 0
  used_folder=$library_folder
  is_folder_known=false
}

is_same_folder() { [ "$(readlink -f "$1")" = "$(readlink -f "$2")" ]; }

is_our_link() { [ -L "$1" ] && [ "$(readlink "$1")" = "$library_folder/${1##*/}" ]; }

# Until 0.2 the library of the computer system had this name. An upgrade of the Debian package links
# it to the present one.
former_library=libComputerSystemProvider.so

has_former_link() {
  local link=$used_folder/$former_library
  is_our_link "$link" || { [ -L "$link" ] && [ "$link" -ef "$library_folder/${libraries[1]}" ]; }
}

unlink_former_library() {
  if has_former_link; then step rm "$used_folder/$former_library"; fi
}

# Returns whether the file exists and was not linked by this command.
is_foreign() { { [ -e "$1" ] || [ -L "$1" ]; } && ! is_our_link "$1"; }

link_libraries() {
  local each
  is_same_folder "$used_folder" "$library_folder" && return
  for each in "${libraries[@]}"; do
    if is_foreign "$used_folder/$each"; then
      refuse "$used_folder/$each is somebody else's; it must be put out of the way first"
    fi
  done
  for each in "${libraries[@]}"; do
    is_our_link "$used_folder/$each" || step ln -s "$library_folder/$each" "$used_folder/$each"
  done
}

has_links() {
  local each
  for each in "${libraries[@]}"; do
    if is_our_link "$used_folder/$each"; then return; fi
  done
  has_former_link
}

unlink_libraries() {
  local each
  for each in "${libraries[@]}"; do
    if is_our_link "$used_folder/$each"; then step rm "$used_folder/$each"; fi
  done
  unlink_former_library
}

remind_of_folder() {
  if ! "$is_folder_known"; then
    echo "The object manager must look for provider libraries in $library_folder," \
      "or --provider-folder must say where it looks."
  fi
}
