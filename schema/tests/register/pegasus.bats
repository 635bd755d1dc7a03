#!/usr/bin/env bats
# glimmark-register with OpenPegasus.

load machine

setup() {
    make_machine cimmof cimprovider cimcli
    mkdir -p "$BROKER/root/cimv2" "$BROKER/root/PG_InterOp" "$BROKER/root/interop"
    echo CIM_AlarmDevice >"$BROKER/root/cimv2/class CIM_AlarmDevice"
    echo PG_ProviderModule >"$BROKER/root/PG_InterOp/class PG_ProviderModule"
    remember_state
}

without_cimcli() { rm "$BROKER/usr/sbin/cimcli" && remember_state; }

changes() { calls | grep -Ev '^(cimcli gc|cimprovider -l)'; }

@test "registering compiles the classes, then the registration" {
    register 0 register
    diff <(changes) - <<'END'
cimmof -n cimv2 TAVRO_Glimmark.mof
cimmof -n PG_InterOp glimmark-pegasus.mof
END
    grep -q '^cimmof -n root/cimv2 ' "$CALLS"
    grep -q '^cimmof -n root/PG_InterOp ' "$CALLS"
    [ "$(find "$BROKER/root/cimv2" -name 'class TAVRO_*' | wc -l)" -eq 4 ]
    [ "$(grep -c 'instance of PG_ProviderCapabilities' "$BROKER/root/PG_InterOp/module GlimmarkProviderModule")" -eq 4 ]
}

@test "it says what it does" {
    register 0 register
    says "compiling the classes"
    says "cimmof -n root/cimv2 "
    says "compiling the registration"
    says "cimmof -n root/PG_InterOp "
    says "registered with OpenPegasus"
}

@test "registering twice changes nothing" {
    register 0 register
    remember_state
    register 0 register
    says "nothing to do"
    is_as_remembered
    [ -z "$(changes)" ]
}

@test "the interop namespace of newer ones is found" {
    mv "$BROKER/root/PG_InterOp/class PG_ProviderModule" "$BROKER/root/interop/"
    register 0 register
    [ -e "$BROKER/root/interop/module GlimmarkProviderModule" ]
}

@test "the interop namespace that is named" {
    mv "$BROKER/root/PG_InterOp/class PG_ProviderModule" "$BROKER/root/interop/"
    without_cimcli
    register 0 --interop root/interop register
    [ -e "$BROKER/root/interop/module GlimmarkProviderModule" ]
}

@test "in another namespace" {
    mkdir "$BROKER/root/other"
    register 0 --namespace=root/other register
    [ -e "$BROKER/root/other/class TAVRO_Glimmark" ]
    [ "$(grep -c 'Namespaces = {"root/other"};' "$BROKER/root/PG_InterOp/module GlimmarkProviderModule")" -eq 4 ]
}

@test "each step that fails is taken back" {
    for FAIL in "1 cimmof -n root/cimv2" "1 cimmof -n root/PG_InterOp" "2 cimprovider -l"; do
        export FAIL
        : >"$CALLS"
        register 4 register
        says "the broker is as it was"
        is_as_remembered
    done
}

@test "classes that were there before stay" {
    echo made earlier >"$BROKER/root/cimv2/class TAVRO_GlimmarkCapabilities"
    remember_state
    FAIL="1 cimmof -n root/PG_InterOp" register 4 register
    is_as_remembered
}

@test "associations are deleted before what they associate" {
    FAIL="1 cimmof -n root/PG_InterOp" register 4 register
    diff <(calls | grep '^cimcli dc') - <<'END'
cimcli dc TAVRO_GlimmarkSystemDevice -n cimv2
cimcli dc TAVRO_GlimmarkElementCapabilities -n cimv2
cimcli dc TAVRO_GlimmarkCapabilities -n cimv2
cimcli dc TAVRO_Glimmark -n cimv2
END
}

@test "what cannot be taken back is said" {
    export FAIL="1 cimcli dc"
    rm "$BROKER/root/PG_InterOp/class PG_ProviderModule"
    register 5 register
    says "not all could be taken back"
}

@test "without cimcli it registers all the same" {
    without_cimcli
    register 0 register
    [ -e "$BROKER/root/PG_InterOp/module GlimmarkProviderModule" ]
}

@test "without cimcli a failed step removes the registration, and says that classes may stay" {
    without_cimcli
    FAIL="1 cimmof -n root/PG_InterOp" register 5 register
    says "without cimcli they cannot be deleted"
    [ ! -e "$BROKER/root/PG_InterOp/module GlimmarkProviderModule" ]
}

@test "an interrupted step is taken back" {
    export INTERRUPT=cimmof
    register 4 register
    says interrupted
    is_as_remembered
}

@test "unregistering removes the registration, then the classes" {
    remember_state
    register 0 register
    register 0 unregister
    is_as_remembered
    grep -qx 'cimprovider -r -m GlimmarkProviderModule' "$CALLS"
}

@test "unregistering twice changes nothing" {
    register 0 unregister
    says "nothing to do"
    is_as_remembered
    [ -z "$(changes)" ]
}

@test "unregistering without cimcli says that the classes stay" {
    register 0 register
    without_cimcli
    register 0 unregister
    says "the classes stay in root/cimv2"
    [ ! -e "$BROKER/root/PG_InterOp/module GlimmarkProviderModule" ]
    register 0 register
}

@test "each step of unregistering that fails is taken back" {
    register 0 register
    remember_state
    for FAIL in "1 cimprovider -r" "1 cimcli dc" "3 cimcli dc"; do
        export FAIL
        : >"$CALLS"
        register 4 unregister
        is_as_remembered
    done
}

@test "a broker that does not answer" {
    export FAIL="1 cimprovider -l"
    register 3 register
    says "does OpenPegasus run?"
    is_as_remembered
}

@test "the status tells registered and not registered" {
    register 1 status
    says "not registered with OpenPegasus"
    register 0 register
    register 0 status
    says "registered with OpenPegasus"
}

@test "a dry run shows the commands and changes nothing" {
    USER_ID=1000 register 0 --dry-run register
    says "would run:   cimmof -n root/cimv2 "
    says "would run:   cimmof -n root/PG_InterOp "
    is_as_remembered
    [ -z "$(changes)" ]
    register 0 register
    remember_state
    USER_ID=1000 register 0 --dry-run unregister
    says "would run:   cimprovider -r -m GlimmarkProviderModule"
    is_as_remembered
}

@test "the stand-in for the computer system's provider" {
    register 0 -p computer-system register
    [ -e "$BROKER/root/PG_InterOp/module TavroComputerSystemModule" ]
    [ -e "$BROKER/root/cimv2/class TAVRO_ComputerSystem" ]
    register 1 status
}
