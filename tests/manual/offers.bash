# What bash offers for each line: offers.bash COMPLETION LINE...
source "$1"
shift
for line in "$@"; do
  # Words as readline cuts them.
  read -ra COMP_WORDS <<<"${line//=/ = }"
  [[ $line == *[\ =] ]] && [[ $line != *= ]] && COMP_WORDS+=('')
  COMP_CWORD=$((${#COMP_WORDS[@]} - 1)) COMPREPLY=()
  function=$(complete -p "${COMP_WORDS[0]}" | sed 's/.*-F \([^ ]*\).*/\1/')
  "$function"
  echo "$line:" $(printf '%s\n' "${COMPREPLY[@]}" | LC_ALL=C sort)
done
