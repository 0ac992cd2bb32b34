# Prints what zsh is told about the commands, or about one and its arguments: COMPLETION [COMMAND]
words=($2)
stage=${2:+arguments}
_arguments() { told=("$@"); state=${stage:-command} }
_describe() { told=(${(P)2}) }
source $1
print -rl -- $told
