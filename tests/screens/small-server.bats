#!/usr/bin/env bats
# The small server on terminals of two sizes, which are those of tmux: what a person came for can be read.

setup() { cd "$BATS_TEST_TMPDIR" || exit; }

teardown() { tmux_here kill-server 2>/dev/null || true; }

tmux_here() { tmux -S "$BATS_TEST_TMPDIR/tmux" -f /dev/null "$@"; }
screen() { tmux_here capture-pane -p -t small; }

# shown COLUMNS ROWS ARGUMENT...: the screen with that command, once it has all
shown() {
    local columns=$1 rows=$2 try
    shift 2
    tmux_here new-session -d -s small -x "$columns" -y "$rows" \
        "LC_ALL=C.UTF-8 '$CIMHOST' --inventory '$INVENTORY' $*; sleep 60"
    for ((try = 0; try < 300; try++)); do
        screen | grep -q 'Temperature LED' && break
        sleep 0.1
    done
    screen
}

# Name, health and alarm state of each indicator, in a line of its own.
expected='Drive 1 Fault LED OK Off
Drive 2 Fault LED Degraded/Warning Off
Fan 1 Fault LED Degraded/Warning Alternating
Fan 2 Fault LED Degraded/Warning Alternating
Identification LED OK Steady
Memory Fault LED Degraded/Warning Steady
Power LED OK Unknown
Power Supply 1 Fault LED Degraded/Warning Alternating
Power Supply 2 Fault LED Unknown Unknown
Processor 1 Fault LED Unknown Unknown
Processor 2 Fault LED Unknown Off
System Health LED OK Off
Temperature LED Unknown Unknown'

# Of the lines under the heading, by the columns of its words; awk counts bytes.
states() {
    sed 's/…/~/g' screen | awk '/HealthState/ { name = index($0, "Name"); health = index($0, "HealthState"); alarm = index($0, "AlarmState"); next }
         / LED / { row = substr($0, name, health - name) " " substr($0, health, 17) " " substr($0, alarm, 11)
                   gsub(/ +/, " ", row); sub(/ $/, "", row); print row }'
}

# for_both_sizes CHECK ARGUMENT...: CHECK succeeds on the file screen
for_both_sizes() {
    local size check=$1
    shift
    for size in '80 24' '120 40'; do
        # shellcheck disable=SC2086 # columns and rows
        shown $size "$@" >screen
        tmux_here kill-server
        "$check" || { cat screen; return 1; }
    done
}

whole() {
    diff <(states) - <<<"$expected" && grep -q 'OK, In Service' screen && grep -q 'Degraded, Predictive' screen
}

@test "ei shows name, health, status and alarm state of all indicators" {
    for_both_sizes whole ei TAVRO_Glimmark
    grep -q 'Drive 1 Fault LE…ay-1/indicator-1' screen
}

@test "watch shows them, and how to end it" {
    for_both_sizes whole watch
    grep -q '^TAVRO_Glimmark in root/cimv2: 13 instances at ' screen
    grep -q '^q ends$' screen
}

named() {
    grep -qE '^Fan 1 Fault LED:/chassis-1/fan-1/indicator-1 +Degraded/Warning +Alternating$' screen &&
        [ "$(grep -c . screen)" -eq 15 ]
}

@test "ei with properties shows what tells the indicators apart" {
    for_both_sizes named ei TAVRO_Glimmark HealthState AlarmState
}
