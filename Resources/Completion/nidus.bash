# Completion of nidus for bash. To have it in every session:
#   nidus completion bash > ~/.local/share/bash-completion/completions/nidus

_nidus() {
  COMPREPLY=()
  local line
  # The line and not its words, which bash parts at characters that mean nothing to nidus.
  while IFS= read -r line; do
    if [[ -n $line ]]; then
      COMPREPLY+=("$line")
    else
      compopt -o default
    fi
  done < <("${1/#\~/$HOME}" complete --typed -- "${COMP_LINE:0:COMP_POINT}" "$2" 2>/dev/null)
}

complete -F _nidus nidus
