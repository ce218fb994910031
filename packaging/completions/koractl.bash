# Completes what is typed behind koractl: the program itself says what fits.
_koractl() {
  local cur=${COMP_WORDS[COMP_CWORD]} line kind=
  COMPREPLY=()
  while IFS= read -r line; do
    case $line in
      $'\t'*) kind=${line#$'\t'} ;;
      *) COMPREPLY+=("${line%%$'\t'*}") ;;
    esac
  done < <("${COMP_WORDS[0]}" --complete "${COMP_WORDS[@]:1:COMP_CWORD}" 2>/dev/null)
  case $kind in
    files) compopt -o filenames 2>/dev/null
      while IFS= read -r line; do COMPREPLY+=("$line"); done < <(compgen -f -- "$cur") ;;
    folders) compopt -o filenames 2>/dev/null
      while IFS= read -r line; do COMPREPLY+=("$line"); done < <(compgen -d -- "$cur") ;;
  esac
}
complete -F _koractl koractl
