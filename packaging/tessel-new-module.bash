# Completion of bash for tessel-new-module.
_tessel_new_module() {
  local word=${COMP_WORDS[COMP_CWORD]}
  if [[ $word == -* ]]; then
    mapfile -t COMPREPLY < <(compgen -W '-h --help --version' -- "$word")
  elif ((COMP_CWORD == 2)); then
    mapfile -t COMPREPLY < <(compgen -W 'bundle zmb omp lsp' -- "$word")
  fi
}
complete -F _tessel_new_module tessel-new-module
