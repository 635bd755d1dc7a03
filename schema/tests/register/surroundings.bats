#!/usr/bin/env bats
# What glimmark-register says of the library, the computer system and the log of a broker.
# shellcheck disable=SC2154 # names of the machine

load machine

teardown() { end_broker; }

@test "the library that SFCB finds" {
    make_machine_of_sfcb
    register 0 register
    says "library: $cmpi/libGlimmarkProvider.so, and the loader finds all that it needs"
    register 0 status
    says "library: $cmpi/libGlimmarkProvider.so, and the loader finds all that it needs"
}

@test "the library that OpenPegasus finds" {
    make_machine_of_pegasus
    register 0 register
    says "library: $cmpi/libGlimmarkProvider.so, and the loader finds all that it needs"
}

@test "a library that SFCB does not find" {
    make_machine_of_sfcb
    mkdir "$BATS_TEST_TMPDIR/elsewhere"
    mv "$cmpi/libGlimmarkProvider.so" "$BATS_TEST_TMPDIR/elsewhere/"
    register 0 --library-dir "$BATS_TEST_TMPDIR/elsewhere" register
    says "library: SFCB does not find libGlimmarkProvider.so in /usr/lib/sfcb $cmpi"
    mend library
    register 0 status
    says "library: $BATS_TEST_TMPDIR/elsewhere/libGlimmarkProvider.so"
}

@test "a library that OpenPegasus does not find" {
    make_machine_of_pegasus
    echo lib >"$BROKER/current"
    register 0 --library-dir "$cmpi" register
    says "library: OpenPegasus does not find libGlimmarkProvider.so in lib; mend: cimconfig -s providerDir=lib:$cmpi -c -p"
    mend library
    register 0 status
    says "library: $cmpi/libGlimmarkProvider.so"
    grep -qx "lib:$cmpi" "$BROKER/planned"
}

@test "a library that is nowhere" {
    make_machine_of_pegasus
    rm "$cmpi/libGlimmarkProvider.so"
    register 0 register
    says "library: OpenPegasus does not find libGlimmarkProvider.so in lib:$cmpi, and neither is it in "
}

@test "a configuration of SFCB's that cannot be read" {
    make_machine_of_sfcb
    rm "$config"
    register 0 register
    says "library: SFCB's providerDirs are not known"
}

@test "support libraries that the loader does not find" {
    make_machine_of_sfcb
    export MISSING="libmvlog.so.1 libtavro-common.so.1"
    register 0 register
    says "library: $cmpi/libGlimmarkProvider.so, for which the loader does not find libtavro-common.so.1 libmvlog.so.1: "
    register 0 status
    says "does not find libtavro-common.so.1 libmvlog.so.1"
}

@test "a computer system that SFCB does not serve" {
    make_machine_of_sfcb
    register 0 register
    says "computer system: there is no class TAVRO_ComputerSystem in root/cimv2; mend: glimmark-register --broker sfcb --providers computer-system register"
    register 0 --providers computer-system register
    says_not "computer system:"
    register 0 status
    says "computer system: TAVRO_ComputerSystem is served in root/cimv2"
    sed -i 's/^\[TAVRO_ComputerSystem\]/[TAVRO_Other]/' "$registered/providerRegister"
    register 0 status
    says "computer system: TAVRO_ComputerSystem has no provider in root/cimv2"
}

@test "a computer system that OpenPegasus does not serve" {
    make_machine_of_pegasus
    register 0 register
    says "computer system: there is no class TAVRO_ComputerSystem in root/cimv2; mend: glimmark-register --broker pegasus --providers computer-system register"
    register 0 --providers computer-system register
    register 0 status
    says "computer system: TAVRO_ComputerSystem is served in root/cimv2"
    sed -i 's|root/cimv2|root/other|' "$BROKER/root/PG_InterOp/module TavroComputerSystemModule"
    register 0 status
    says "computer system: TAVRO_ComputerSystem has no provider in root/cimv2"
}

@test "a computer system whose stand-in is not installed" {
    make_machine_of_sfcb
    mkdir "$BATS_TEST_TMPDIR/schema"
    cp "$SCHEMA/"*limmark* "$BATS_TEST_TMPDIR/schema/"
    register 0 --schema-dir "$BATS_TEST_TMPDIR/schema" register
    says "mend: install its maker's provider, or the package glimmark-computer-system"
}

# The log of a broker whose environment is NAME=VALUE...
log_with() {
    make_machine_of_sfcb
    (
        export "${@?}"
        run_broker sfcbd /dev/null x
        echo "$broker_process" >"$BATS_TEST_TMPDIR/process"
    )
    broker_process=$(cat "$BATS_TEST_TMPDIR/process")
    register 1 status
    kill "$broker_process"
    broker_process=
}

@test "the log is a file" {
    log_with MVLOG_FILE=/var/log/glimmark.log
    says "log: /var/log/glimmark.log"
    log_with MVLOG_OUTPUT=file:/var/log/other.log MVLOG_FILE=/var/log/glimmark.log
    says "log: /var/log/other.log"
    log_with MVLOG_OUTPUT=nonsense MVLOG_FILE=/var/log/glimmark.log
    says "log: /var/log/glimmark.log"
}

@test "the log is a daemon's" {
    log_with MVLOG_OUTPUT=journal
    says "log: journal"
    log_with MVLOG_OUTPUT=syslog:/run/log MVLOG_FILE=/var/log/glimmark.log
    says "log: syslog:/run/log"
}

@test "the log is off" {
    log_with MVLOG_LEVEL=off MVLOG_FILE=/var/log/glimmark.log
    says "log: off"
}

@test "the log is lost" {
    log_with MVLOG_LEVEL=3000
    says "log: lost: standard error of SFCB is /dev/null"
    says "MVLOG_FILE"
}

@test "the log is standard error" {
    make_machine_of_pegasus
    run_broker cimserver "$BATS_TEST_TMPDIR/standard-error" x
    register 1 status
    says "log: standard error of OpenPegasus, $BATS_TEST_TMPDIR/standard-error"
}

@test "a broker that does not run, or is another's" {
    make_machine_of_sfcb
    register 1 status
    says "log: SFCB does not run"
    echo "httpPort: 5998" >"$BATS_TEST_TMPDIR/another.cfg"
    run_broker sfcbd "$BATS_TEST_TMPDIR/standard-error" -c "$BATS_TEST_TMPDIR/another.cfg"
    register 1 status
    says "log: SFCB does not run"
    end_broker
    run_broker sfcbd "$BATS_TEST_TMPDIR/standard-error" -c "$config"
    register 1 status
    says "log: standard error of SFCB, $BATS_TEST_TMPDIR/standard-error"
}
