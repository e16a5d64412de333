# Completion of bash for tesselc.
_tesselc() {
  local word=${COMP_WORDS[COMP_CWORD]} before=${COMP_WORDS[COMP_CWORD - 1]}
  if [[ $before == -o || $before == --output ]]; then
    mapfile -t COMPREPLY < <(compgen -f -- "$word")
  elif [[ $word == -* ]]; then
    mapfile -t COMPREPLY < <(compgen -W '-o --output -h --help --version' -- "$word")
  else
    mapfile -t COMPREPLY < <(
      compgen -f -X '!*.lsp' -- "$word"
      compgen -d -- "$word"
    )
  fi
}
complete -o filenames -F _tesselc tesselc
