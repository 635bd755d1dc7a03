#!/usr/bin/env bats
# cimhost watch as a person and a pipe see it. The terminal is that of tmux.

setup() {
    cd "$BATS_TEST_TMPDIR" || exit
    export CIMT_INVENTORY=$BATS_TEST_TMPDIR/lamps LC_ALL=C.UTF-8
    lamps "lamp Fan:/fan 5 1"
}

teardown() {
    tmux_here kill-server 2>/dev/null || true
    [ -z "${watcher-}" ] || kill "$watcher" 2>/dev/null || true
}

bats_require_minimum_version 1.5.0

# What the sample provider reads; moved into place, so that nobody reads half of it.
lamps() {
    printf '%s\n' "$@" >lamps.new
    mv lamps.new lamps
}

# Tries a command until it succeeds.
eventually() {
    local try
    for ((try = 0; try < 300; try++)); do
        "$@" && return
        sleep 0.1
    done
    echo "never: $*"
    screen
    return 1
}

tmux_here() { tmux -S "$BATS_TEST_TMPDIR/tmux" -f /dev/null "$@"; }
screen() { tmux_here capture-pane -p -t watch "$@" 2>/dev/null || cat out; }
shows() { screen | grep -qF -- "$1"; }
shows_not() { ! shows "$1"; }

# A terminal with a shell in it.
terminal() {
    tmux_here new-session -d -s watch -x 100 -y 20 "env PS1='shell> ' sh"
    eventually shows 'shell>'
}

keys() { tmux_here send-keys -t watch "$@"; }

@test "shows the indicators and what changes, and gives the terminal back" {
    terminal
    keys "echo before; '$CIMHOST' watch --interval 0.1; echo status \$?; stty -a | grep -c ' echo '" Enter
    eventually shows 'CIMT_Lamp in root/cimv2: 1 instance at '
    shows_not before
    shows '  Fan   OK'
    lamps "lamp Fan:/fan 10 3"
    eventually shows '* Fan '
    shows 'Degraded/Warning'
    shows 'Fan:/fan: AlarmState from Off to Alternating'
    screen -e | grep -qF $'\e[1m\e[33m* Fan'
    tmux_here resize-window -t watch -x 30 -y 10
    eventually shows 'CIMT_Lamp in root/cimv2: 1 in…'
    eventually shows 'Deg…'
    keys q
    eventually shows 'status 0'
    shows before
    shows_not CIMT_Lamp
    eventually shows 1
}

@test "stops and goes on as other programs do" {
    terminal
    keys "set -m; '$CIMHOST' watch" Enter
    eventually shows 'CIMT_Lamp in root/cimv2: 1 instance at '
    keys C-z
    eventually shows 'shell>'
    shows_not 'CIMT_Lamp in'
    keys fg Enter
    eventually shows 'CIMT_Lamp in root/cimv2: 1 instance at '
    keys C-c
    eventually shows_not 'CIMT_Lamp in'
}

@test "uses no colours where NO_COLOR asks for none" {
    terminal
    keys "NO_COLOR=1 '$CIMHOST' watch" Enter
    eventually shows '  Fan '
    run ! grep -qF $'\e[32m' <(screen -e)
    keys C-c
}

@test "prints a line for each change where there is no terminal, and ends well at SIGTERM" {
    "$CIMHOST" watch --interval 0.1 >out 3>&- &
    watcher=$!
    eventually grep -qE '^[0-9T:+-]+ Fan:/fan is there: HealthState OK, OperationalStatus OK, In Service, AlarmState Off$' out
    lamps "lamp Fan:/fan 5 2"
    eventually grep -qE '^[0-9T:+-]+ Fan:/fan: AlarmState from Off to Steady$' out
    lamps
    eventually grep -qE '^[0-9T:+-]+ Fan:/fan is gone$' out
    [ "$(wc -l <out)" -eq 3 ]
    kill -TERM "$watcher"
    wait "$watcher"
}

@test "tells no answer from an empty one, and shows what a provider prints" {
    lamps
    terminal
    keys "'$CIMHOST' watch --interval 0.1" Enter
    eventually shows 'No instances.'
    lamps 'error no fan is answered for'
    eventually shows 'CMPI_RC_ERR_FAILED (1): no fan is answered for'
    shows 'no answer at'
    shows_not 'No instances.'
    lamps 'print the inventory is gone'
    eventually shows 'No instances.'
    eventually shows 'the inventory is gone'
    keys q
    eventually shows_not 'No instances.'
}

@test "shows what was printed before the screen, and hands the rest on where there is none" {
    lamps 'print first words'
    terminal
    keys "'$CIMHOST' watch" Enter
    eventually shows 'No instances.'
    shows 'first words'
    keys q
    eventually shows_not 'No instances.'
    lamps 'print last words' 'error none'
    keys "'$CIMHOST' watch; echo status \$?" Enter
    eventually shows 'status 1'
    shows 'last words'
    shows 'cimhost: CMPI_RC_ERR_FAILED (1): none'
}

@test "ends without a change when nobody reads it any more" {
    export CIMHOST
    # shellcheck disable=SC2016 # the shell of the pipe expands it
    timeout 20 bash -c '"$CIMHOST" watch --interval 0.1 | head -n 1' >out
    grep -q 'Fan:/fan is there' out
}

@test "ends when nobody reads it any more" {
    mkfifo pipe
    "$CIMHOST" watch --interval 0.1 >pipe 3>&- &
    watcher=$!
    exec 4<pipe
    read -r first <&4
    [[ "$first" == *'Fan:/fan is there'* ]]
    exec 4<&-
    lamps "lamp Fan:/fan 10 3"
    local status=0
    wait "$watcher" || status=$?
    [ "$status" -eq 1 ]
}

@test "a class that answers an error ends it at once" {
    run -1 "$CIMHOST" watch CIM_Fan
    [[ "$output" == *CMPI_RC_ERR_INVALID_CLASS* ]]
}
