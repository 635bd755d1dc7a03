#!/usr/bin/env bats
# glimmark-register with OpenPegasus.

load machine

setup() {
    make_machine_of_pegasus
    remember_state
}

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
    says "registered with OpenPegasus in root/cimv2"
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
    mv "$BROKER/root/PG_InterOp/"* "$BROKER/root/interop/"
    register 0 register
    [ -e "$BROKER/root/interop/module GlimmarkProviderModule" ]
}

@test "the interop namespace that is named" {
    mv "$BROKER/root/PG_InterOp/"* "$BROKER/root/interop/"
    register 0 --interop root/interop register
    [ -e "$BROKER/root/interop/module GlimmarkProviderModule" ]
}

make_another_namespace() {
    cp -r "$BROKER/root/cimv2" "$BROKER/root/other"
    remember_state
}

@test "in another namespace" {
    make_another_namespace
    register 0 --namespace=root/other register
    [ -e "$BROKER/root/other/class TAVRO_Glimmark" ]
    [ "$(grep -c 'Namespaces = {"root/other"};' "$BROKER/root/PG_InterOp/module GlimmarkProviderModule")" -eq 4 ]
    register 0 --namespace=root/other status
    register 0 --namespace=root/OTHER status
}

@test "another namespace than the one that is served" {
    make_another_namespace
    register 0 register
    remember_state
    register 1 --namespace root/other status
    says "not registered with OpenPegasus in root/other"
    says "root/cimv2"
    register 0 --namespace root/other unregister
    says "nothing to do"
    register 3 --namespace root/other register
    says "glimmark-register --namespace root/cimv2 unregister"
    is_as_remembered
    [ -z "$(changes)" ]
}

@test "a registration that serves another namespace too is left alone" {
    register 0 register
    sed -i 's|{"root/cimv2"}|{"root/cimv2", "root/other"}|' "$BROKER/root/PG_InterOp/module GlimmarkProviderModule"
    remember_state
    register 1 status
    says "otherwise than installed"
    register 3 unregister
    says "root/other"
    is_as_remembered
}

@test "a namespace that is not there is not made" {
    register 3 --namespace root/none register
    says "there is no namespace root/none"
    is_as_remembered
    [ -z "$(changes)" ]
}

@test "without the DMTF schema nothing starts" {
    rm "$BROKER/root/cimv2/class CIM_ElementCapabilities"
    remember_state
    register 3 register
    says "the DMTF schema in root/cimv2 is missing or too old: there is no class CIM_ElementCapabilities"
    is_as_remembered
    [ -z "$(changes)" ]
}

@test "a namespace that keeps no registrations is not made" {
    for interop in root/interop root/none; do
        register 3 --interop $interop register
        says "$interop keeps no registrations"
        is_as_remembered
    done
    [ -z "$(changes)" ]
    register 0 register
    register 3 --interop root/none status
    says "root/none keeps no registrations"
}

@test "each step that fails is taken back" {
    for FAIL in "1 cimmof -n root/cimv2" "1 cimmof -n root/PG_InterOp" "3 cimprovider -l"; do
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
    FAIL=$'1 cimmof -n root/PG_InterOp\n1 cimcli dc' register 5 register
    says "there since: class TAVRO_GlimmarkSystemDevice in root/cimv2"
    says "not all could be taken back"
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

@test "a class that is put back otherwise than it was is told" {
    register 0 register
    echo older >"$BROKER/root/cimv2/class TAVRO_GlimmarkSystemDevice"
    FAIL="2 cimcli dc" register 5 unregister
    says "changed since: class TAVRO_GlimmarkSystemDevice in root/cimv2"
}

@test "an incomplete registration is told, and can be unregistered" {
    cp "$BROKER/root/cimv2/class CIM_AlarmDevice" "$BATS_TEST_TMPDIR/"
    register 0 register
    module="$BROKER/root/PG_InterOp/module GlimmarkProviderModule"
    head -n 45 "$module" >"$BATS_TEST_TMPDIR/half"
    cp "$BATS_TEST_TMPDIR/half" "$module"
    register 1 status
    says "otherwise than installed"
    register 3 register
    says "glimmark-register unregister"
    register 0 unregister
    is_as_remembered
}

@test "a registration without its classes is told" {
    register 0 register
    rm "$BROKER/root/cimv2/class TAVRO_Glimmark"
    register 1 status
    says "otherwise than installed"
}

@test "a broker that does not answer" {
    DOWN=yes register 3 register
    says "does OpenPegasus run?"
    is_as_remembered
}

@test "a broker that ends in between" {
    register 0 register
    : >"$CALLS"
    FAIL="1 cimcli ei" register 3 status
    says "does OpenPegasus run?"
}

@test "a broker that is installed apart" {
    apart=$BATS_TEST_TMPDIR/apart
    mkdir -p "$apart/bin"
    mv "$BROKER/usr/sbin/"cim* "$apart/bin/"
    register 3 status
    register 0 --prefix "$apart" register
    register 0 --prefix "$apart" status
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
