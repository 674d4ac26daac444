# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash disable=SC2034,SC2154

# Doing things one step at a time, and telling what was done when one of them fails. Sourced by
# sensor-profile-register.

steps_done=()
# What restores the registration that was found; empty when there was none.
earlier_command=''

# The words as they can be typed, in quotation marks only where they need them.
quoted() {
  local word line=()
  for word; do
    [[ $word =~ ^[A-Za-z0-9_./=:,+-]+$ ]] || word=${word@Q}
    line+=("$word")
  done
  printf '%s' "${line[*]}"
}

# command_to ACTION [OPTION]...: the command that does it with the same object manager and folders,
# to be typed.
command_to() {
  local words=("$own_command" "$1" --object-manager "$object_manager" "${@:2}")
  [ -z "$provider_folder" ] || words+=(--provider-folder "$provider_folder")
  if [ "$object_manager" = sfcb ]; then
    [ -z "$staging_folder" ] || words+=(--staging-folder "$staging_folder")
    [ -z "$configuration" ] || words+=(--configuration "$configuration")
  fi
  quoted "${words[@]}"
}

# Something is not as it must be, and no step was taken yet.
refuse() {
  complain "$@"
  echo "Nothing was changed." >&2
  exit 1
}

# The step that failed, those before it, and the way back: to the registration that was found, or to
# none.
report_failure() {
  local undo
  complain "$1"
  if [ ${#steps_done[@]} -eq 0 ]; then
    echo "It may have done part of its work; nothing was done before it." >&2
  else
    echo "It may have done part of its work. Done before it:" >&2
    printf '  %s\n' "${steps_done[@]}" >&2
  fi
  undo=$earlier_command
  [ -n "$undo" ] || [ "$action" = remove ] || undo=$(removal_command)
  [ -z "$undo" ] || echo "To undo it: $undo" >&2
  echo "Once the cause is mended, the command can be repeated." >&2
  exit 1
}

# A signal came. A second one is not held up.
end_interrupted_step() {
  trap - INT TERM HUP
  [ -z "$running_step" ] || kill "$running_step" 2>/dev/null || true
  wait
  report_failure "interrupted: $1"
}

# Prints a command that changes something and runs it; when it fails, nothing after it is done. It
# runs beside the shell, which would put off a signal until it ends.
step() {
  local line status=0 running_step=''
  line=$(quoted "$@")
  echo "$line"
  "$is_dry_run" && return
  trap 'end_interrupted_step "$line"' INT TERM HUP
  "$@" <&0 &
  running_step=$!
  wait "$running_step" || status=$?
  trap - INT TERM HUP
  [ $status -eq 0 ] || report_failure "failed with exit code $status: $line"
  steps_done+=("$line")
}

# Of these files, those there are.
existing() {
  local each
  for each in "$@"; do
    if [ -e "$each" ]; then printf '%s\n' "$each"; fi
  done
}

# ---- Documents

# document NAME MARKED: sets `registration` to a registration document. Where the options ask for
# another than the one that is shipped, it is made in the folder that the commands run in, by a
# command that is printed as they are. MARKED are sed's addresses of the computer system's part.
document() {
  local shipped=$share/registration/$1 changes=()
  [ "$namespace" = "$shipped_namespace" ] ||
    changes+=(-e "s|$shipped_namespace|$namespace|")
  "$with_computer_system" || changes+=(-e "$2d")
  registration=$shipped
  [ ${#changes[@]} -gt 0 ] || return 0
  registration=$1
  echo "$(quoted sed "${changes[@]}" "$shipped") >$1"
  "$is_dry_run" || sed "${changes[@]}" "$shipped" >"$1" || refuse "$1 cannot be made"
}
