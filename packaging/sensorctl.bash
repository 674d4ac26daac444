# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash

# Completion of sensorctl's command line in bash. The completions are read from its help.

# Prints the long options in a help text.
_sensorctl_options() {
  "$@" --help 2>/dev/null | grep --only-matching --extended-regexp -e '^  .*--[a-z-]+' |
    grep --only-matching --extended-regexp -e '--[a-z-]+'
}

_sensorctl_commands() {
  "$1" --help 2>/dev/null | sed -n '/^Subcommands:/,/^$/s/^  \([a-z]\{1,\}\) .*/\1/p'
}

# _sensorctl_takes TOOL COMMAND OPTION VALUE: succeeds if the option takes a value of that name.
_sensorctl_takes() {
  [[ $3 == -* ]] && "$1" "$2" --help 2>/dev/null |
    grep --quiet --extended-regexp -e "^  ([^ ]+,)?$3(,[^ ]+)? $4\\b"
}

# Prints the chips and labels of the machine, that of a model file if the command line names one.
_sensorctl_sensors() {
  local tool=$1 model=() i
  for ((i = 1; i < ${#COMP_WORDS[@]} - 1; i++)); do
    case ${COMP_WORDS[i]} in
      --model=*) model=("${COMP_WORDS[i]}") ;;
      --model) # interactive shells split words at the sign, too
        [ "${COMP_WORDS[i + 1]}" != = ] || i=$((i + 1))
        model=(--model "${COMP_WORDS[i + 1]}")
        ;;
    esac
  done
  "$tool" list --json "${model[@]}" 2>/dev/null |
    sed -n 's/.*"chip": "\([^"\\]*\)".*"label": "\([^"\\]*\)".*/\1\n\2/p' | sort --unique
}

_sensorctl() {
  local tool=$1 word=$2 previous=$3 command=${COMP_WORDS[1]}
  COMPREPLY=()
  if [ "$previous" = --color ]; then
    mapfile -t COMPREPLY < <(compgen -W 'auto always never' -- "$word")
  elif [ "$previous" = --compatible ]; then
    mapfile -t COMPREPLY < <(compgen -W 'node_exporter' -- "$word")
  elif [ "$COMP_CWORD" -eq 1 ] && [[ $word != -* ]]; then
    mapfile -t COMPREPLY < <(compgen -W "$(_sensorctl_commands "$tool")" -- "$word")
  elif [[ $word == -* ]] && [ "$COMP_CWORD" -eq 1 ]; then
    mapfile -t COMPREPLY < <(compgen -W "$(_sensorctl_options "$tool")" -- "$word")
  elif [[ $word == -* ]]; then
    mapfile -t COMPREPLY < <(compgen -W "$(_sensorctl_options "$tool" "$command")" -- "$word")
  elif [ "$previous" = --kind ]; then
    mapfile -t COMPREPLY < <(compgen -W 'temperature voltage fan' -- "$word")
  elif [ "$command" = list ] && [[ $word == ZUMLO_* ]]; then
    mapfile -t COMPREPLY < <(compgen -W "$("$tool" list --help 2>/dev/null |
      grep --only-matching -e 'ZUMLO_[A-Za-z]*') ZUMLO_NumericSensor" -- "$word")
  elif _sensorctl_takes "$tool" "$command" "$previous" FILE; then
    mapfile -t COMPREPLY < <(compgen -f -- "$word")
  elif [ "$previous" = --user ]; then
    mapfile -t COMPREPLY < <(compgen -u -- "$word")
  elif ! _sensorctl_takes "$tool" "$command" "$previous" '[A-Z]+' &&
    "$tool" "$command" --help 2>/dev/null | grep --quiet --extended-regexp -e '^  (SELECTOR|OBJECT) '; then
    # Names are data, which `compgen -W` would expand. They are selected in any letter case.
    local name begun=${word#[\"\']}
    begun=${begun//\\/}
    while IFS= read -r name; do
      [[ ${name,,} != "${begun,,}"* ]] || COMPREPLY+=("$name")
    done < <(_sensorctl_sensors "$tool")
  fi
}

complete -o filenames -o bashdefault -F _sensorctl sensorctl
