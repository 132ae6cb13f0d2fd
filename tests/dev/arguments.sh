# What a command of ./dev takes. Part of that script, which has `command` and `fail`.

# take ALLOWED ARGUMENT...: ends with status 2 at an argument that the command does not take. ALLOWED
# lists options. One with a value stands there as NAME=KIND, where KIND is N (a whole number from 1),
# S (a seed), the words to choose from with | between them, or what the text is.
take() {
    local allowed=$1 option candidate kind
    shift
    while [ $# -gt 0 ]; do
        option=$1 kind=unknown
        for candidate in $allowed; do
            case $candidate in
                "$option") kind=flag ;;
                "$option"=*) kind=${candidate#*=} ;;
            esac
        done
        case $kind in
            unknown) fail "$command takes $(list_options "$allowed"), not '$option'" 2 ;;
            flag) ;;
            *) take_value "$option" "$kind" "${2-}"; shift ;;
        esac
        shift
    done
}

# take_value OPTION KIND VALUE
take_value() {
    local good
    case $2 in
        N) good='^[1-9][0-9]{0,8}$' ;;
        S) good='^([0-9]{1,19}|0x[0-9a-fA-F]{1,16})$' ;;
        *\|*) good="^($2)\$" ;;
        *) good='^([^-]|-[^-])' ;;
    esac
    [[ $3 =~ $good ]] || case $2 in
        N) fail "$1 takes a whole number from 1, of at most 9 digits, not '$3'" 2 ;;
        S) fail "$1 takes a whole number, not '$3'" 2 ;;
        *) fail "$1 takes $2, not '$3'" 2 ;;
    esac
}

# "--seconds N, --keep"; or "no arguments".
list_options() {
    local options=${1// /, }
    options=${options//=/ }
    echo "${options:-no arguments}"
}
