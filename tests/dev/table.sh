# The tables that the checks of ./dev fill: what they found, and how long they took. Part of that script,
# which has `command`, `take` and `fail`.

# The table of what the checks found: check, figure, limit and the command, with tabs between them.
summary=${DEV_SUMMARY-build/summary.tsv}
# How long each took: the command and its seconds.
times=${summary%.tsv}-times.tsv
# Where a check that runs puts its rows: check, figure, limit.
rows=''

# begin_check ALLOWED ARGUMENT...: takes the arguments, and sees to the rows of the check from here to
# the end of the command.
begin_check() {
    take "$@"
    mkdir -p build
    rows=$(mktemp build/rows.XXXXXX)
    trap 'end_check $?' EXIT
}

# end_check STATUS: puts the rows of the check into the table, in place of those of its last run.
end_check() {
    local status=$1
    if [ "$status" -eq 0 ] && [ ! -s "$rows" ]; then
        printf 'dev: %s ended without a row for the table: it checked nothing\n' "$command" >&2
        status=1
    fi
    if [ "$status" -ne 0 ] && ! grep -q "$(printf '\tnot checked')" "$rows"; then
        row "./dev $command" "failed with status $status" 'passes'
    fi
    (
        flock 9
        touch "$summary"
        awk -F '\t' -v command="$command" '$4 != command' "$summary" >"$rows.all"
        sed "s/\$/\t$command/" "$rows" >>"$rows.all"
        mv "$rows.all" "$summary"
        touch "$times"
        awk -F '\t' -v command="$command" '$1 != command' "$times" >"$rows.all"
        printf '%s\t%s\n' "$command" "$SECONDS" >>"$rows.all"
        mv "$rows.all" "$times"
    ) 9>build/summary.lock
    rm -f "$rows"
    exit "$status"
}

# row CHECK FIGURE LIMIT
row() { printf '%s\t%s\t%s\n' "$@" >>"$rows"; }

# not_checked CHECK WHY: ends a check that cannot be had here.
not_checked() {
    row "$1" "not checked: $2" '-'
    fail "$1: not checked: $2"
}

# sum_of FILE PATTERN: the sum of what the group of the pattern matches in the lines of a file. None at
# all is an error: then whatever wrote the file has another form, or has done nothing.
sum_of() {
    local found
    found=$(sed -nE "s/$2/\1/p" "$1" | tr -d ,)
    [ -n "$found" ] || fail "$1 has no line '$2', so nothing shows that something was checked"
    awk '{ n += $1 } END { printf "%d\n", n }' <<<"$found"
}

# some_of FILE PATTERN: sum_of that may not be 0.
some_of() {
    local sum
    sum=$(sum_of "$@")
    [ "$sum" -gt 0 ] || fail "$1 counts 0 in its lines '$2', so nothing was checked"
    echo "$sum"
}
