#!/usr/bin/env bats
# glimmark-register with the small-footprint broker.

load machine

setup() {
    make_machine sfcbstage sfcbrepos systemctl
    stage=$BROKER/var/lib/sfcb/stage
    mkdir -p "$stage/regs" "$stage/mofs/root/cimv2"
    printf '[CIM_Fan]\n   provider: FanProvider\n' >"$stage/regs/fan.reg"
    export UNIT=sblim-sfcb
    sfcbrepos -f
    systemctl restart sblim-sfcb
    remember_state
}

stage_an_older_version() {
    register 0 register
    echo "# older" >>"$stage/regs/glimmark.reg"
    sfcbrepos -f
    systemctl restart sblim-sfcb
    remember_state
}

@test "registering stages, rebuilds and restarts" {
    register 0 register
    diff <(calls) - <<'END'
systemctl --quiet is-active sblim-sfcb
sfcbstage -n cimv2 -r glimmark.reg TAVRO_Glimmark.mof
sfcbrepos -f
systemctl restart sblim-sfcb
END
    grep -q '^sfcbstage -n root/cimv2 ' "$CALLS"
    [ "$(grep -c '^\[TAVRO_' "$BROKER/running")" -eq 4 ]
    [ "$(grep -c '^class TAVRO_' "$BROKER/running")" -eq 4 ]
    grep -q CIM_Fan "$BROKER/running"
}

@test "it says what it does" {
    register 0 register
    says "staging registration and classes"
    says "sfcbstage -n root/cimv2 -r "
    says "rebuilding the repository"
    says "restarting the broker"
    says "registered with SFCB"
}

@test "registering twice changes nothing" {
    register 0 register
    remember_state
    register 0 register
    says "nothing to do"
    is_as_remembered
    [ "$(calls)" = "systemctl --quiet is-active sblim-sfcb" ]
}

@test "an older version is replaced" {
    stage_an_older_version
    register 0 register
    [ "$(grep -c older "$BROKER/running")" -eq 0 ]
    [ "$(grep -c '^\[TAVRO_' "$BROKER/running")" -eq 4 ]
}

@test "in another namespace, and back" {
    register 0 --namespace root/other register
    [ "$(grep -c 'namespace: root/other' "$BROKER/running")" -eq 4 ]
    [ -e "$stage/mofs/root/other/TAVRO_Glimmark.mof" ]
    register 0 register
    [ "$(grep -c 'namespace: root/cimv2' "$BROKER/running")" -eq 4 ]
    [ "$(grep -c '^class TAVRO_' "$BROKER/running")" -eq 4 ]
}

@test "each step that fails is taken back" {
    for FAIL in "1 sfcbstage" "1 sfcbrepos" "1 systemctl restart"; do
        export FAIL
        : >"$CALLS"
        register 4 register
        says "the broker is as it was"
        is_as_remembered
    done
}

@test "each step that fails brings the older version back" {
    stage_an_older_version
    for FAIL in "1 sfcbstage" "1 sfcbrepos" "1 systemctl restart"; do
        export FAIL
        : >"$CALLS"
        register 4 register
        is_as_remembered
        grep -q older "$BROKER/running"
    done
}

@test "folders that a failed step made are removed" {
    FAIL="1 sfcbrepos" register 4 --namespace root/other register
    is_as_remembered
}

@test "what cannot be taken back is said" {
    FAIL="1+ sfcbrepos" register 5 register
    says "not all could be taken back"
}

@test "an interrupted step is taken back" {
    export INTERRUPT=sfcbstage
    register 4 register
    says interrupted
    is_as_remembered
}

@test "files that are staged elsewhere are noticed" {
    STAGE_ELSEWHERE=$BATS_TEST_TMPDIR/elsewhere register 4 register
    says "--stage-dir names another directory"
    is_as_remembered
}

@test "a staging directory that is named" {
    export STAGE=$BATS_TEST_TMPDIR/"another stage"
    mkdir "$STAGE"
    register 0 --stage-dir "$STAGE" register
    [ -e "$STAGE/regs/glimmark.reg" ]
    register 0 --stage-dir "$STAGE" status
    register 1 status
}

@test "without a staging directory nothing starts" {
    register 3 --stage-dir "$BATS_TEST_TMPDIR/none" register
    says "there is no staging directory $BATS_TEST_TMPDIR/none"
    is_as_remembered
}

@test "a class and provider that another file registers are not registered again" {
    printf '[tavro_GLIMMARK]\n   provider: GlimmarkProfileProvider\n' >"$stage/regs/maker's.reg"
    remember_state
    register 3 register
    says "regs/maker's.reg registers the same classes and providers already"
    is_as_remembered
}

@test "the same class of another provider is not in the way" {
    printf '[TAVRO_Glimmark]\n   provider: AnotherProvider\n' >"$stage/regs/another.reg"
    register 0 register
}

@test "unregistering removes, rebuilds and restarts" {
    register 0 register
    remember_state
    register 0 unregister
    diff <(calls) - <<'END'
systemctl --quiet is-active sblim-sfcb
sfcbrepos -f
systemctl restart sblim-sfcb
END
    [ "$(grep -c TAVRO "$BROKER/running")" -eq 0 ]
    grep -q CIM_Fan "$BROKER/running"
}

@test "unregistering twice changes nothing" {
    register 0 unregister
    says "nothing to do"
    is_as_remembered
}

@test "each step of unregistering that fails is taken back" {
    register 0 register
    remember_state
    for FAIL in "1 sfcbrepos" "1 systemctl restart"; do
        export FAIL
        : >"$CALLS"
        register 4 unregister
        is_as_remembered
    done
}

@test "the status tells registered, not registered, otherwise registered" {
    register 1 status
    says "not registered with SFCB"
    register 0 register
    register 0 status
    says "registered with SFCB"
    stage_an_older_version
    register 1 status
    says "otherwise than installed"
    is_as_remembered
}

@test "the service of the other name is restarted" {
    UNIT=sfcb register 0 register
    grep -qx 'systemctl restart sfcb' "$CALLS"
}

@test "a broker that does not run as a service is not restarted" {
    UNIT='' register 0 register
    says "if it runs, restart it"
    [ "$(grep -c 'systemctl restart' "$CALLS")" -eq 0 ]
    grep -q TAVRO_Glimmark "$BROKER/repository"
}

@test "a machine without systemctl" {
    rm "$BROKER/usr/sbin/systemctl"
    PATH=$(without_systemctl)
    register 0 register
    says "if it runs, restart it"
}

# The tools of the path that the program needs, in a folder of their own.
without_systemctl() {
    local bin=$BATS_TEST_TMPDIR/bin tool
    mkdir "$bin"
    for tool in bash env cat cp awk find tar sed head tac dirname basename readlink mktemp mkdir rm rmdir xargs cmp \
        sort grep; do
        ln -s "$(command -v "$tool")" "$bin/"
    done
    echo "$BROKER/usr/sbin:$bin"
}

@test "no restart, when that is asked for" {
    register 0 --no-restart register
    says "if it runs, restart it"
    [ "$(grep -c 'systemctl restart' "$CALLS")" -eq 0 ]
}

@test "a dry run shows the commands and changes nothing" {
    USER_ID=1000 register 0 --dry-run register
    says "would run:   sfcbstage -n root/cimv2 -r "
    says "would run:   sfcbrepos -f"
    says "would run:   systemctl restart sblim-sfcb"
    is_as_remembered
    [ "$(calls)" = "systemctl --quiet is-active sblim-sfcb" ]
    register 0 register
    remember_state
    USER_ID=1000 register 0 --dry-run unregister
    says "/regs/glimmark.reg"
    is_as_remembered
}

@test "the stand-in for the computer system's provider" {
    register 0 --providers computer-system register
    grep -q '^\[TAVRO_ComputerSystem\]' "$BROKER/running"
    register 1 status
    register 0 register
    register 0 --providers computer-system unregister
    [ "$(grep -c 'TAVRO_ComputerSystem\]' "$BROKER/running")" -eq 0 ]
    grep -q '^\[TAVRO_Glimmark\]' "$BROKER/running"
}
