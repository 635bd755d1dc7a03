# A made machine with the brokers' tools as stand-ins. REGISTER is the program under test.
# shellcheck shell=bash

# make_machine TOOL...: $BROKER is the root of its files.
make_machine() {
    STAND_INS=$BATS_TEST_DIRNAME/stand-ins
    BROKER=$BATS_TEST_TMPDIR/"a broker's place"
    CALLS=$BATS_TEST_TMPDIR/calls
    TMPDIR=$BATS_TEST_TMPDIR/"temporary files"
    export STAND_INS BROKER CALLS TMPDIR
    local tool
    mkdir -p "$BROKER/usr/sbin" "$TMPDIR"
    for tool in id "$@"; do
        cp "$STAND_INS/$tool" "$BROKER/usr/sbin/"
    done
    PATH=$BROKER/usr/sbin:/usr/bin:/bin
    : >"$CALLS"
}

# Names, kinds and contents of all that is on the machine.
state() { (cd "$BROKER" && find . -printf '%y %p\n' -type f -exec sha256sum {} \; | sort); }

remember_state() {
    : >"$CALLS"
    state >"$BATS_TEST_TMPDIR/before"
}

is_as_remembered() { diff "$BATS_TEST_TMPDIR/before" <(state); }

# What was asked of the broker's tools, without folders.
calls() { sed -E 's|\\ ||g; s|[^ ]*/||g' "$CALLS"; }

# register EXPECTED_STATUS ARGUMENT...
# shellcheck disable=SC2154 # run sets output and status
register() {
    local expected=$1
    shift
    run "$REGISTER" "$@"
    echo "$output"
    [ "$status" -eq "$expected" ]
    [ -z "$(ls "$TMPDIR")" ]
}

says() { [[ $output == *"$1"* ]]; }
