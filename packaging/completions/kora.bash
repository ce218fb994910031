# Completes what is typed behind kora.
_kora() {
  local cur=${COMP_WORDS[COMP_CWORD]} before=${COMP_WORDS[COMP_CWORD-1]} line
  COMPREPLY=()
  case $before in
    --home) compopt -o filenames 2>/dev/null
      while IFS= read -r line; do COMPREPLY+=("$line"); done < <(compgen -d -- "$cur")
      return ;;
    --set) return ;;
  esac
  case $cur in
    -*) line='--home --set --help --version' ;;
    *) line='RM A N XT XS' ;;
  esac
  while IFS= read -r line; do COMPREPLY+=("$line"); done < <(compgen -W "$line" -- "$cur")
  compopt -o filenames 2>/dev/null
  while IFS= read -r line; do COMPREPLY+=("$line"); done < <(compgen -f -X '!*.cht' -- "$cur"; compgen -d -- "$cur")
}
complete -F _kora kora
