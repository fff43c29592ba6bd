#compdef nidus
# Completion of nidus for zsh. To have it in every session, put it into a folder of $fpath:
#   nidus completion zsh > ~/.zsh/functions/_nidus

_nidus() {
  local -a typed lines
  typed=("${(@Q)words[2,CURRENT-1]}" "${(Q)PREFIX}")
  lines=("${(@f)$(_call_program names ${(q)words[1]} complete -- ${(q)typed[@]} 2>/dev/null; print x)}")
  lines[-1]=()
  if (( ${lines[(I)]} )); then _files; fi
  compadd -U -- ${(@)lines:#}
}

if [[ $zsh_eval_context[-1] == loadautofunc ]]; then
  _nidus "$@"
else
  compdef _nidus nidus
fi
