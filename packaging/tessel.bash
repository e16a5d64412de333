# Completion of bash for tessel.
_tessel() {
  local word=${COMP_WORDS[COMP_CWORD]} before=${COMP_WORDS[COMP_CWORD - 1]}
  # bash takes the sign in --profile-dir=FOLDER for a word of its own.
  if [[ $word == = ]]; then
    word=
  elif [[ $before == = ]]; then
    before=${COMP_WORDS[COMP_CWORD - 2]}
  fi
  case $before in
    --profile-dir | --layout-dir)
      mapfile -t COMPREPLY < <(compgen -d -- "$word")
      return
      ;;
    --script | --log)
      mapfile -t COMPREPLY < <(compgen -f -- "$word")
      return
      ;;
    -c | --command) return ;;
  esac
  if [[ $word == -* ]]; then
    mapfile -t COMPREPLY < <(compgen -W '--profile-dir --layout-dir --script -c --command --modrig --safe -q --quiet -v --verbose --log -h --help --version' -- "$word")
  else
    mapfile -t COMPREPLY < <(
      compgen -f -X '!*.@(zmb|omp|lsp|qbc|rpk|mcp)' -- "$word"
      compgen -d -- "$word" # also a bundle is a folder
    )
  fi
}
complete -o filenames -F _tessel tessel
