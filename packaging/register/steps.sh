# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash disable=SC2034,SC2154

# Runs the commands that change something and reports which were done when one fails. Sourced by
# sensor-profile-register.

steps_done=()
# The command that restores the registration which was found; empty when there was none.
earlier_command=''

# Prints the words as a shell reads them, quoted only where necessary.
quoted() {
  local word line=()
  for word; do
    [[ $word =~ ^[A-Za-z0-9_./=:,+-]+$ ]] || word=${word@Q}
    line+=("$word")
  done
  printf '%s' "${line[*]}"
}

# command_to ACTION [OPTION]...: prints the command for the action with the same object manager and
# folders.
command_to() {
  local words=("$own_command" "$1" --object-manager "$object_manager" "${@:2}")
  [ -z "$provider_folder" ] || words+=(--provider-folder "$provider_folder")
  if [ "$object_manager" = sfcb ]; then
    [ -z "$staging_folder" ] || words+=(--staging-folder "$staging_folder")
    [ -z "$configuration" ] || words+=(--configuration "$configuration")
  fi
  quoted "${words[@]}"
}

# Exits with a message before the first step.
refuse() {
  complain "$@"
  echo "Nothing was changed." >&2
  exit 1
}

# Exits with a message that names the step that failed, those before it, and the command that undoes
# them: it restores the registration which was found, or removes the new one.
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

# Ends the running step after a signal. A second signal has its default effect.
end_interrupted_step() {
  trap - INT TERM HUP
  [ -z "$running_step" ] || kill "$running_step" 2>/dev/null || true
  wait
  report_failure "interrupted: $1"
}

# Prints a command and runs it; exits when it fails. The command runs in the background, since the
# shell defers a trap until a command in the foreground ends.
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

# Prints those of the given files that exist.
existing() {
  local each
  for each in "$@"; do
    if [ -e "$each" ]; then printf '%s\n' "$each"; fi
  done
}

# document NAME ADDRESSES: sets `registration` to the registration document. One that the options
# change is made in the current folder, by a command that is printed as steps are. ADDRESSES are
# those of the computer system's part for sed.
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
