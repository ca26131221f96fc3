# zsh_offers.zsh DIRECTORY LINE: prints what zsh offers at the end of LINE with the completions in DIRECTORY,
# one word a line. zsh completes at a prompt only: one is run on a terminal of its own, where compadd, which
# every completion ends in, notes the words that match.
zmodload zsh/zpty
directory=$1
setup=$directory/setup.zsh
cat > $setup <<'SETUP'
PS1=
fpath=($directory $fpath)
autoload -U compinit
compinit -u -d $directory/dump
bindkey '^I' complete-word
compadd() {
    # With these a caller asks what would match, and offers nothing yet.
    if [[ " ${@[1,(i)(-|--)]} " != *' -'(O|A|D)' '* ]]; then
        local -a offered
        builtin compadd -O offered "$@"
        (( $#offered == 0 )) || print -rl -- $offered >> $directory/offers
    fi
    builtin compadd "$@"
}
comppostfuncs=(exit)
SETUP
zpty shell zsh -f -i
zpty -w shell "directory=${(q)directory}; cd \$directory; source ${(q)setup}"
zpty -w -n shell "$2"$'\t'
while zpty -r shell ignored; do :; done
[[ ! -e $directory/offers ]] || { cat $directory/offers; rm $directory/offers }
