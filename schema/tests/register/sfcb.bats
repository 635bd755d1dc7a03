#!/usr/bin/env bats
# glimmark-register with the small-footprint broker.
# shellcheck disable=SC2154 # names of the machine

load machine

setup() {
    make_machine_of_sfcb
    printf '[CIM_Fan]\n   provider: FanProvider\n' >"$stage/regs/fan.reg"
    export UNIT=sblim-sfcb
    sfcbrepos -f
    echo "made by a client" >"$registered/repository/root/interop/subscriptions"
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
    diff <(changes) - <<'END'
systemctl --quiet is-active sblim-sfcb
sfcbstage -n cimv2 -r glimmark.reg TAVRO_Glimmark.mof
sfcbrepos -f
systemctl restart sblim-sfcb
END
    grep -q '^sfcbstage -n root/cimv2 ' "$CALLS"
    [ "$(grep -c '^\[TAVRO_' "$BROKER/running")" -eq 4 ]
    [ "$(grep -c '^class TAVRO_' "$BROKER/running")" -eq 4 ]
    grep -q CIM_Fan "$BROKER/running"
    grep -q "made by a client" "$BROKER/running"
}

@test "it says what it does" {
    register 0 register
    says "staging registration and classes"
    says "sfcbstage -n root/cimv2 -r "
    says "rebuilding the repository"
    says "restarting the broker"
    says "registered with SFCB in root/cimv2"
}

@test "registering twice changes nothing" {
    register 0 register
    remember_state
    register 0 register
    says "nothing to do"
    is_as_remembered
    [ "$(changes)" = "systemctl --quiet is-active sblim-sfcb" ]
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

@test "another namespace than the one that is served" {
    register 0 register
    remember_state
    register 1 --namespace root/other status
    says "not registered with SFCB in root/other"
    says "root/cimv2"
    register 0 --namespace root/other unregister
    says "nothing to do"
    is_as_remembered
}

@test "each step that fails is taken back" {
    for FAIL in "1 sfcbstage -n" "1 sfcbrepos -f" "1 systemctl restart"; do
        export FAIL
        : >"$CALLS"
        register 4 register
        says "the broker is as it was"
        is_as_remembered
    done
}

@test "each step that fails brings the older version back" {
    stage_an_older_version
    for FAIL in "1 sfcbstage -n" "1 sfcbrepos -f" "1 systemctl restart"; do
        export FAIL
        : >"$CALLS"
        register 4 register
        is_as_remembered
        grep -q older "$BROKER/running"
    done
}

@test "what it takes back does not hang on the broker's tools" {
    FAIL="1+ sfcbrepos -f" register 4 register
    is_as_remembered
    [ "$(calls | grep -c '^sfcbrepos -f')" -eq 1 ]
}

@test "a repository that was not there is removed again" {
    rm -r "$registered"
    remember_state
    FAIL="1 sfcbrepos -f" register 4 register
    is_as_remembered
}

@test "folders that a failed step made are removed" {
    FAIL="1 sfcbrepos -f" register 4 --namespace root/other register
    is_as_remembered
}

@test "what cannot be taken back is said" {
    FAIL="1+ systemctl restart" register 5 register
    says "not all could be taken back"
}

@test "an interrupted step is taken back" {
    export INTERRUPT="sfcbrepos -f"
    register 4 register
    says interrupted
    is_as_remembered
}

@test "files that cannot be put back are kept" {
    stage_an_older_version
    printf '%s\n' '#!/usr/bin/env bash' '[[ "$*" != *" -- saved/"* ]] && exec /bin/cp "$@"' >"$BROKER/usr/sbin/cp"
    chmod +x "$BROKER/usr/sbin/cp"
    export FAIL="1 sfcbrepos -f"
    run "$REGISTER" register
    [ "$status" -eq 5 ]
    says "not put back: what was staged in $stage; it is saved in "
    says "not put back: the repository in $registered; it is saved in "
    saved=$(sed -n 's/.*not put back: what was staged .* saved in //p' <<<"$output")
    grep -qx "# older" "$saved/regs/glimmark.reg"
    saved=$(sed -n 's/.*not put back: the repository .* saved in //p' <<<"$output")
    grep -qx "made by a client" "$saved/repository/root/interop/subscriptions"
}

@test "one that waits for another can be interrupted" {
    exec 9<"$BROKER/usr/sbin/sfcbstage"
    flock 9
    "$REGISTER" register >"$BATS_TEST_TMPDIR/said" 2>&1 3>&- 9<&- &
    until grep -q "waiting for another glimmark-register" "$BATS_TEST_TMPDIR/said"; do sleep 0.01; done
    kill -TERM $!
    wait $! || status=$?
    [ "$status" -eq 3 ]
    is_as_remembered
}

@test "the broker's user can read what is staged" {
    umask 077
    register 0 register
    [ "$(stat -c %a "$stage/regs/glimmark.reg" "$stage/mofs/root/cimv2/TAVRO_Glimmark.mof" | sort -u)" = 644 ]
    grep -q TAVRO_Glimmark "$BROKER/running"
}

@test "files that are staged elsewhere are noticed" {
    STAGE_ELSEWHERE=$BATS_TEST_TMPDIR/elsewhere register 4 register
    says "--stage-dir names another directory"
    is_as_remembered
}

@test "a staging directory that is named is the one that is built from" {
    another=$BATS_TEST_TMPDIR/another_stage
    mkdir -p "$another/regs"
    cp "$stage/default.reg" "$another/"
    register 0 --stage-dir "$another" register
    [ -e "$another/regs/glimmark.reg" ]
    [ ! -e "$stage/regs/glimmark.reg" ]
    [ "$(grep -c '^\[TAVRO_' "$BROKER/running")" -eq 4 ]
    register 0 --stage-dir "$another" status
    register 0 --stage-dir "$another" unregister
    [ "$(grep -c '^\[TAVRO_' "$BROKER/running")" -eq 0 ]
}

@test "directories that are elsewhere behind links" {
    mv "$stage" "$registered" "$BATS_TEST_TMPDIR/"
    ln -s "$BATS_TEST_TMPDIR/stage" "$stage"
    ln -s "$BATS_TEST_TMPDIR/registration" "$registered"
    cp -r "$BATS_TEST_TMPDIR/stage" "$BATS_TEST_TMPDIR/registration" "$BROKER/"
    FAIL="1 sfcbrepos -f" register 4 register
    diff -r "$BROKER/stage" "$BATS_TEST_TMPDIR/stage"
    diff -r "$BROKER/registration" "$BATS_TEST_TMPDIR/registration"
    register 0 register
    register 0 status
}

@test "a link to a directory of the staging directory" {
    mv "$stage/mofs/root" "$BROKER/root"
    ln -s "$BROKER/root" "$stage/mofs/root"
    ln -s ../root "$BROKER/root/itself"
    remember_state
    FAIL="1 sfcbrepos -f" register 4 register
    is_as_remembered
    register 0 register
    register 0 unregister
    [ -z "$(find "$BROKER/root" -name TAVRO_Glimmark.mof)" ]
}

@test "staged and not built is not registered" {
    cp "$SCHEMA/glimmark.reg" "$stage/regs/"
    sfcbstage -n root/cimv2 "$SCHEMA/TAVRO_Glimmark.mof"
    register 1 status
    says "otherwise than installed"
    register 0 register
    [ "$(grep -c '^\[TAVRO_' "$BROKER/running")" -eq 4 ]
}

@test "built and no longer staged can be unregistered" {
    register 0 register
    rm "$stage/regs/glimmark.reg" "$stage/mofs/root/cimv2/TAVRO_Glimmark.mof"
    register 1 status
    register 0 unregister
    [ "$(grep -c TAVRO "$BROKER/running")" -eq 0 ]
}

@test "the repository that the broker's configuration names" {
    another=$BROKER/another_registration
    echo "registrationDir:  $another" >>"$config"
    register 0 register
    [ "$(grep -c '^\[TAVRO_' "$another/providerRegister")" -eq 4 ]
    register 0 status
    echo "registrationDir: $registered" >>"$config"
    register 1 status
}

@test "a broker that is installed apart" {
    apart=$BATS_TEST_TMPDIR/apart
    mkdir -p "$apart/bin" "$apart/var/lib/sfcb" "$apart/etc/sfcb" "$apart/share/sfcb"
    cp "$BROKER/usr/sbin/"{sfcbstage,sfcbrepos,ldd} "$apart/bin/"
    cp -r "$stage" "$apart/var/lib/sfcb/"
    cp -r "$BROKER/usr/share/sfcb/CIM" "$apart/share/sfcb/"
    echo "providerDirs: $cmpi" >"$apart/etc/sfcb/sfcb.cfg"
    rm -r "$stage" "$BROKER/usr/share/sfcb" "$config"
    remember_state
    register 0 --prefix "$apart" register
    is_as_remembered
    [ -e "$apart/var/lib/sfcb/stage/regs/glimmark.reg" ]
    [ "$(grep -c '^\[TAVRO_' "$apart/var/lib/sfcb/registration/providerRegister")" -eq 4 ]
    register 0 --prefix "$apart" status
    says "library: $cmpi/libGlimmarkProvider.so"
    register 3 --prefix "$BATS_TEST_TMPDIR/none" status
    says "there is no broker below $BATS_TEST_TMPDIR/none"
}

@test "without a staging directory nothing starts" {
    register 3 --stage-dir "$BATS_TEST_TMPDIR/none" register
    says "there is no staging directory $BATS_TEST_TMPDIR/none"
    mkdir "$BATS_TEST_TMPDIR/empty"
    register 3 --stage-dir "$BATS_TEST_TMPDIR/empty" register
    says "$BATS_TEST_TMPDIR/empty is no staging directory of SFCB"
    mkdir "$BATS_TEST_TMPDIR/a blank"
    register 3 --stage-dir "$BATS_TEST_TMPDIR/a blank" register
    says "SFCB's tools take no folder with a blank"
    is_as_remembered
}

@test "without the DMTF schema nothing starts" {
    rm "$BROKER/usr/share/sfcb/CIM/CIM_Schema.mof"
    remember_state
    register 3 register
    says "the DMTF schema is missing: there is no $BROKER/usr/share/sfcb/CIM/CIM_Schema.mof"
    is_as_remembered
    [ "$(changes)" = "systemctl --quiet is-active sblim-sfcb" ]
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
    diff <(changes) - <<'END'
systemctl --quiet is-active sblim-sfcb
sfcbrepos -f
systemctl restart sblim-sfcb
END
    [ "$(grep -c TAVRO "$BROKER/running")" -eq 0 ]
    grep -q CIM_Fan "$BROKER/running"
    grep -q "made by a client" "$BROKER/running"
}

@test "unregistering twice changes nothing" {
    register 0 unregister
    says "nothing to do"
    is_as_remembered
}

@test "each step of unregistering that fails is taken back" {
    register 0 register
    remember_state
    for FAIL in "1 sfcbrepos -f" "1 systemctl restart"; do
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
    says "SFCB takes this up when it starts"
    [ "$(grep -c 'systemctl restart' "$CALLS")" -eq 0 ]
    grep -q TAVRO_Glimmark "$registered/providerRegister"
}

@test "a machine on which systemd does not run" {
    NO_SYSTEMD=yes register 0 register
    says "SFCB takes this up when it starts"
    says_not "booted with systemd"
    says_not "Failed to connect"
}

teardown() { end_broker; }

@test "the process that is to be restarted is named" {
    run_broker sfcbd /dev/null x
    UNIT='' register 0 register
    says "restart SFCB, process $broker_process: it takes this up when it starts"
}

@test "a machine without systemctl" {
    rm "$BROKER/usr/sbin/systemctl"
    PATH=$(without_systemctl)
    register 0 register
    says "SFCB takes this up when it starts"
}

# The tools of the path that the program needs, in a folder of their own.
without_systemctl() {
    local bin=$BATS_TEST_TMPDIR/bin tool
    mkdir "$bin"
    for tool in bash env cat cp mv awk find tar sed head tac tail tr dirname basename readlink mktemp mkdir rm rmdir xargs \
        cmp diff sort grep getopt; do
        ln -s "$(command -v "$tool")" "$bin/"
    done
    echo "$BROKER/usr/sbin:$bin"
}

@test "no restart, when that is asked for" {
    register 0 --no-restart register
    says "restart SFCB, the service sblim-sfcb: it takes this up when it starts"
    [ "$(grep -c 'systemctl restart' "$CALLS")" -eq 0 ]
}

@test "a dry run shows the commands and changes nothing" {
    USER_ID=1000 register 0 --dry-run register
    says "would run:   sfcbstage -n root/cimv2 -r "
    says "would run:   sfcbrepos -f"
    says "would run:   systemctl restart sblim-sfcb"
    is_as_remembered
    [ "$(changes)" = "systemctl --quiet is-active sblim-sfcb" ]
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
