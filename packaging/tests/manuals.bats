#!/usr/bin/env bats
# The manual pages against the programs' own help. PROGRAMS is the folder with bin/ and sbin/.

manuals=$BATS_TEST_DIRNAME/../man

# Options as words, each on a line.
options_in() { grep -oE -- '(^|[^[:alnum:]-])--?[a-z][a-z-]*' | sed 's/^[^-]//' | sort -u; }

manual() { mandoc -T ascii "$manuals/$1" | col -bx; }

commands_of_cimhost() { "$PROGRAMS/bin/cimhost" --help | sed -n '/^Commands:/,/^$/s/^  \([a-z][a-z, -]*[a-z]\)\($\|  .*\)/\1/p' | tr -d ,; }

help_of_cimhost() {
    local command
    "$PROGRAMS/bin/cimhost" --help
    for command in $(commands_of_cimhost); do
        "$PROGRAMS/bin/cimhost" "$command" --help
    done
}

@test "the pages have no faults" {
    mandoc -T lint -W warning "$manuals"/*.[18]
}

@test "there is a page for every program, and no other" {
    diff <(find "$PROGRAMS/bin/cimhost" "$PROGRAMS/sbin" -type f -printf '%f\n' | sort) \
        <(find "$manuals" -type f -printf '%f\n' | sed 's/\.[18]$//' | sort)
}

@test "cimhost(1) has the options of the help" {
    help_of_cimhost | options_in >"$BATS_TEST_TMPDIR/help"
    [ "$(wc -l <"$BATS_TEST_TMPDIR/help")" -ge 15 ]
    diff "$BATS_TEST_TMPDIR/help" <(manual cimhost.1 | options_in)
}

@test "cimhost(1) has the commands of the help" {
    [ "$(commands_of_cimhost | wc -w)" -ge 15 ]
    for command in $(commands_of_cimhost); do
        manual cimhost.1 | grep -qw -- "$command" || { echo "no $command"; return 1; }
    done
}

@test "glimmark-register(8) has the options and exit statuses of the help" {
    diff <("$PROGRAMS/sbin/glimmark-register" --help | options_in) <(manual glimmark-register.8 | options_in)
    for status in 0 1 2 3 4 5; do
        manual glimmark-register.8 | sed -n '/^EXIT STATUS/,$p' | grep -q "^ *$status  "
    done
}
