# Prints what bash offers in place of a line's last word: COMPLETION WORD...
source /usr/share/bash-completion/bash_completion
source "$1"
compopt() { :; } # has no line to work on here
COMP_WORDS=("${@:2}")
COMP_CWORD=$(($# - 2))
COMP_LINE=${COMP_WORDS[*]}
COMP_POINT=${#COMP_LINE}
_orlith
printf '%s\n' "${COMPREPLY[@]}"
