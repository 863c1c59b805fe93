# What zsh offers for each line: offers.zsh FOLDER LINE... A shell with a terminal of its own completes, and notes
# what it is given to offer.
zmodload zsh/zpty
folder=$1 offers=$(mktemp)
shift
zpty -b shell 'TERM=dumb zsh -f -i'
zpty -w shell "PS1= fpath=(${(q)folder} \$fpath); autoload -Uz compinit; compinit -u -D
compadd() {
  [[ \" \$* \" == *' -'[OAD]' '* ]] || { local -a hits; builtin compadd -A hits \"\$@\"; print -rl -- \$hits >>$offers }
  builtin compadd \"\$@\"
}
setopt NO_LIST_BEEP; print done >$offers.ready"
wait_for() { local count=0; until [[ -s $1 ]] || ((count++ > $2)); do zpty -r -t shell rest; sleep .1; done }
wait_for $offers.ready 300
for line in "$@"; do
  : >$offers
  zpty -w -n shell "$line"$'\t'
  # The last of its answers may be late.
  wait_for $offers 20
  sleep .2
  while zpty -r -t shell rest; do :; done
  zpty -w -n shell $'\x15'
  print -r -- "$line:" $(sed 's/^ *//; /^$/d' $offers | LC_ALL=C sort -u)
done
zpty -d shell
rm -f $offers $offers.ready
