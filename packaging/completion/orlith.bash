# Completion of orlith for bash, by the functions of bash-completion.

_orlith()
{
    local cur prev words cword split
    _init_completion -s || return

    local tables='@(3dl|blut|cms|csp|cub|cube|itx|vf|vfz|gz)'
    local images='@(exr|tif|tiff|dpx|cin|png|jpg|jpeg|hdr|tga|sgi|bmp|ppm)'
    local reading='--from --strict --read-format-3dl --read-output-bitdepth --normalize-output'
    local colours='--mode --extrapolate'
    local codes='--bitdepth --output-bitdepth --clamp-output --no-clamp-output --format-3dl'
    local writing="$codes --scale --offset --lut1d --style1d"
    local image='--part --layer'
    local written='--no-verify --quiet'

    # The options of each command, and the extensions of the files that it takes.
    local -A options=(
        [pattern]='--size --type --quiet'
        [generate]="--file-type --lut1d --style1d $codes --knob --force $image $written"
        [apply]="--lut --type --frames --threads --unpremultiply --quiet $reading $colours $image"
        [bake]="--lut --size --image-type --force --to $reading $colours $writing $written"
        [convert]="--to --size $reading $writing $written"
        [info]="--json --values $reading"
        [eval]="$reading $colours"
        [diff]="--json --tolerance $reading $colours"
        [view]="--output --image $image $reading $colours"
        [run]='--press'
        [panel]='--knob'
    )
    local -A files=(
        [pattern]=$images
        [generate]="@($images|$tables)"
        [apply]=$images
        [bake]=$tables
        [convert]=$tables
        [info]=$tables
        [eval]=$tables
        [diff]=$tables
        [view]=$tables
        [run]=tcl
    )

    local command=${words[1]} offered= word
    if [[ $command == bake ]]; then
        for ((word = 2; word < cword; word++)); do
            [[ ${words[word]} == -- ]] && _command_offset $((word + 1)) && return
        done
    fi
    case $prev in
        --lut) _filedir "$tables" && return ;;
        --image) _filedir "$images" && return ;;
        --output) _filedir html && return ;;
        --image-type) offered='exr tif dpx png' ;;
        --from) offered='3dl blut cms csp cub cube itx vf vfz gz' ;;
        --to) offered='3dl blut cms csp cub cube vf' ;;
        --file-type) offered='.3dl .blut .cms .csp .cub .cube .vf' ;;
        --type) offered='uint8 uint10 uint12 uint16 half float' ;;
        --mode) offered='step staggered trilinear tetrahedral cubic' ;;
        --style1d) offered='linear logarithmic' ;;
        --bitdepth) offered='4 8 10 12 16' ;;
        --output-bitdepth) offered='input 4 8 10 12 16' ;;
        --read-output-bitdepth) offered='detect input 8 10 12 16' ;;
        --format-3dl) offered='flame lustre scratch' ;;
        --read-format-3dl) offered='auto flame lustre scratch' ;;
        --size | --lut1d | --scale | --offset | --tolerance | --threads | --part) return ;;
        --layer | --frames | --knob | --press) return ;;
        *)
            $split && return
            if ((cword == 1)); then
                offered="${!options[*]} -h --help --version"
            elif [[ $cur == -* ]]; then
                offered="${options[$command]} -h --help"
            elif [[ ${files[$command]} ]]; then
                _filedir "${files[$command]}"
                return
            fi
            ;;
    esac
    COMPREPLY=($(compgen -W "$offered" -- "$cur"))
} &&
    complete -F _orlith orlith
