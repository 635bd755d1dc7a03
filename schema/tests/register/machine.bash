# A made machine with the brokers' tools as stand-ins. REGISTER is the program under test.
# shellcheck shell=bash
# shellcheck disable=SC2034 # the tests use the names set here

# make_machine TOOL...: $BROKER is the root of its files.
make_machine() {
    STAND_INS=$BATS_TEST_DIRNAME/stand-ins
    BROKER=$BATS_TEST_TMPDIR/${PLACE-"a broker's place"}
    CALLS=$BATS_TEST_TMPDIR/calls
    TMPDIR=$BATS_TEST_TMPDIR/"temporary files"
    export STAND_INS BROKER CALLS TMPDIR
    local tool
    mkdir -p "$BROKER/usr/sbin" "$TMPDIR"
    for tool in id ldd "$@"; do
        cp "$STAND_INS/$tool" "$BROKER/usr/sbin/"
    done
    PATH=$BROKER/usr/sbin:/usr/bin:/bin
    : >"$CALLS"
}

# SFCB's tools take no folder with a blank.
make_machine_of_sfcb() {
    PLACE="a_broker's_place" make_machine sfcbstage sfcbrepos systemctl
    stage=$BROKER/var/lib/sfcb/stage
    registered=$BROKER/var/lib/sfcb/registration
    config=$BROKER/etc/sfcb/sfcb.cfg
    cmpi=$BROKER/usr/lib/cmpi
    mkdir -p "$stage/regs" "$stage/mofs/root/cimv2" "$registered" "$BROKER/usr/share/sfcb/CIM" "${config%/*}" "$cmpi" \
        "$stage/mofs/root/interop"
    echo "class SFCB_Own {};" >"$stage/mofs/root/interop/10_interop.mof"
    printf '[SFCB_Own]\n   provider: OwnProvider\n' >"$stage/default.reg"
    echo "class CIM_AlarmDevice" >"$BROKER/usr/share/sfcb/CIM/CIM_Schema.mof"
    printf 'httpPort: 5988\n#providerDirs: /nowhere\nproviderDirs: /usr/lib/sfcb %s\n' "$cmpi" >"$config"
    touch "$cmpi/libGlimmarkProvider.so" "$cmpi/libTavroComputerSystem.so"
}

make_machine_of_pegasus() {
    make_machine cimmof cimprovider cimcli cimconfig
    cmpi=$BATS_TEST_TMPDIR/cmpi
    mkdir -p "$BROKER/root/cimv2" "$BROKER/root/PG_InterOp" "$BROKER/root/interop" "$cmpi"
    for class in CIM_AlarmDevice CIM_AlarmDeviceCapabilities CIM_ElementCapabilities CIM_SystemDevice CIM_ComputerSystem; do
        echo $class >"$BROKER/root/cimv2/class $class"
    done
    for class in PG_ProviderModule PG_ProviderCapabilities; do
        echo $class >"$BROKER/root/PG_InterOp/class $class"
    done
    echo "lib:$cmpi" >"$BROKER/current"
    echo lib >"$BROKER/planned"
    touch "$cmpi/libGlimmarkProvider.so" "$cmpi/libTavroComputerSystem.so"
}

# run_broker PROGRAM STANDARD_ERROR ARGUMENT...: a process in the place of the broker's. It reads what never comes.
run_broker() {
    local program=$BROKER/usr/sbin/$1 standard_error=$2
    shift 2
    [ -e "$program" ] || cp /bin/grep "$program"
    [ -e "$BATS_TEST_TMPDIR/never" ] || mkfifo "$BATS_TEST_TMPDIR/never"
    "$program" "$@" 0<>"$BATS_TEST_TMPDIR/never" >/dev/null 2>"$standard_error" 3>&- &
    broker_process=$!
    until [ "/proc/$broker_process/exe" -ef "$program" ]; do sleep 0.01; done
}

end_broker() {
    [ -z "${broker_process-}" ] || { kill "$broker_process" && { wait "$broker_process" || true; }; }
    broker_process=
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

# Those that change something: neither questions nor what is staged for comparison.
changes() { calls | grep -Ev '^(ldd|sfcb(stage|repos) -h|sfcbstage -s expected|cim(cli (gc|ei)|provider -l|config -g))' || true; }

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
says_not() { [[ $output != *"$1"* ]]; }

# mend WORD: runs the command that the line with this word ends with, after "mend: ".
mend() { bash -c "$(sed -n "/$1/s/.*mend: //p" <<<"$output")"; }
