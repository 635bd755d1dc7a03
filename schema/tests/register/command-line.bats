#!/usr/bin/env bats
# What glimmark-register takes, and what it asks for before it starts.

load machine

@test "no broker" {
    make_machine
    register 3 register
    says "there is no broker"
    # What a person can do then.
    says "cimhost serve"
    says "docs/brokers.md"
}

@test "half of a broker's tools are no broker" {
    make_machine sfcbstage cimmof
    register 3 register
    says "there is no broker"
    register 3 --broker sfcb register
    says "sfcbstage or sfcbrepos is not there"
    register 3 --broker=pegasus register
    says "cimmof, cimprovider or cimcli is not there"
}

@test "of two brokers one is named" {
    make_machine_of_sfcb
    mkdir -p "$BROKER/root/PG_InterOp" "$BROKER/root/cimv2"
    touch "$BROKER/root/PG_InterOp/class PG_ProviderModule"
    cp "$STAND_INS/"cim* "$BROKER/usr/sbin/"
    register 3 register
    says "--broker sfcb or --broker pegasus"
    register 1 --broker sfcb status
    says SFCB
    register 1 -b pegasus status
    says OpenPegasus
}

@test "not root" {
    make_machine_of_sfcb
    remember_state
    USER_ID=1000 register 3 register
    says "this needs root"
    is_as_remembered
    USER_ID=1000 register 1 status
}

@test "classes and registrations in a folder with a blank" {
    make_machine_of_sfcb
    mkdir -p "$BATS_TEST_TMPDIR/some classes"
    cp -r "$SCHEMA"/* "$BATS_TEST_TMPDIR/some classes"
    cd "$BATS_TEST_TMPDIR"
    register 0 --schema-dir "some classes" register
    grep -q "TAVRO_Glimmark.mof" "$CALLS"
    register 0 status
}

@test "missing classes or registrations" {
    make_machine_of_sfcb
    mkdir -p "$BATS_TEST_TMPDIR/none"
    register 3 --schema-dir "$BATS_TEST_TMPDIR/none" register
    says "cannot read $BATS_TEST_TMPDIR/none/TAVRO_Glimmark.mof"
}

@test "help and version" {
    make_machine
    register 0 --help
    says "usage: glimmark-register"
    register 0 --version
    [[ $output =~ ^glimmark-register\ [0-9]+\.[0-9]+\.[0-9]+$ ]]
}

wrong() {
    local message=$1
    shift
    register 2 "$@"
    says "$message"
    says "glimmark-register --help"
}

@test "wrong usage" {
    make_machine sfcbstage sfcbrepos
    wrong "a command is required"
    wrong "there is no command serve" serve
    wrong "one command is enough, found register and status" register status
    wrong "there is no option --force" --force register
    wrong "--broker takes a value" register --broker
    wrong "--namespace takes a value" --namespace= register
    wrong "there is no broker other" --broker other register
    wrong "there are no providers fans" --providers fans register
    wrong "expected a namespace such as root/cimv2, found root/|x" --namespace "root/|x" register
    wrong "expected a namespace such as root/cimv2, found /root" --interop /root register
    [ ! -s "$CALLS" ]
}
