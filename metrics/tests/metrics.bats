#!/usr/bin/env bats
# What cimhost prints, the alert rules and the units, as the programs judge them that read them. CIMHOST, PROMTOOL and
# INVENTORIES say where these are.

bats_require_minimum_version 1.5.0

setup() {
    folder=$BATS_TEST_DIRNAME/..
    service=$folder/systemd/glimmark-metrics.service
    unset CIMHOST_PROVIDER_DIR CIMHOST_REGISTRATION CIMHOST_SCHEMA
}

# Whether promtool takes it without a word.
suits_promtool() {
    run "$PROMTOOL" check metrics
    echo "$output"
    [ "$status" -eq 0 ] && [ -z "$output" ]
}

@test "promtool has nothing to say of the metrics of the sample inventories" {
    for inventory in small-server edge-cases-readable; do
        "$CIMHOST" --inventory "$INVENTORIES/$inventory.json" metrics >"$BATS_TEST_TMPDIR/metrics"
        suits_promtool <"$BATS_TEST_TMPDIR/metrics"
    done
}

@test "promtool has nothing to say of a failure's metrics, nor of lights without a status" {
    run -1 --separate-stderr "$CIMHOST" --inventory /nowhere metrics
    [[ $output == *"collection_success 0"* ]]
    suits_promtool <<<"$output"
    echo '{"nodes": [{"kind": 36, "description": "a", "path": "/", "status": 0}]}' >"$BATS_TEST_TMPDIR/inventory"
    run -0 --separate-stderr "$CIMHOST" --inventory "$BATS_TEST_TMPDIR/inventory" metrics
    suits_promtool <<<"$output"
}

@test "promtool finds fault where there is one" {
    run ! suits_promtool <<<'lights_total 1'
}

@test "the alert rules are well formed, and fire when they should" {
    "$PROMTOOL" check rules "$folder/glimmark.rules.yml"
    "$PROMTOOL" test rules "$BATS_TEST_DIRNAME/glimmark.rules.test.yml"
}

@test "the rules name no metric that cimhost does not print" {
    "$CIMHOST" --inventory "$INVENTORIES/small-server.json" metrics | sed -n 's/^# TYPE \([^ ]*\) .*/\1/p' | sort -u \
        >"$BATS_TEST_TMPDIR/printed"
    grep -oE 'cim_alarm_device[a-z_]*' "$folder/glimmark.rules.yml" | sort -u >"$BATS_TEST_TMPDIR/named"
    [ "$(wc -l <"$BATS_TEST_TMPDIR/named")" -ge 5 ]
    [ -z "$(comm -13 "$BATS_TEST_TMPDIR/printed" "$BATS_TEST_TMPDIR/named")" ]
}

# Without what differs from one collection to the next.
as_always() { sed -E 's/^(cim_alarm_device_collection_(duration|timestamp)_seconds) .*/\1/'; }

@test "a server hands out the same" {
    "$CIMHOST" --inventory "$INVENTORIES/small-server.json" metrics | as_always >"$BATS_TEST_TMPDIR/printed"
    "$CIMHOST" --inventory "$INVENTORIES/small-server.json" serve --metrics --port 0 2>"$BATS_TEST_TMPDIR/said" 3>&- &
    server=$!
    until url=$(grep -oE 'http://[0-9.:]+' "$BATS_TEST_TMPDIR/said"); do sleep 0.05; done
    python3 -c 'import sys, urllib.request
answer = urllib.request.urlopen(sys.argv[1] + "/metrics")
assert answer.headers["Content-Type"] == "text/plain; version=0.0.4; charset=utf-8", answer.headers
print(answer.read().decode(), end="")' "$url" | as_always >"$BATS_TEST_TMPDIR/served"
    kill "$server"
    diff "$BATS_TEST_TMPDIR/printed" "$BATS_TEST_TMPDIR/served"
}

@test "systemd takes the units without a word" {
    # Where the packages are not installed, the program and its manual page are elsewhere.
    sed "s|/usr/bin/cimhost|$CIMHOST|" "$service" >"$BATS_TEST_TMPDIR/glimmark-metrics.service"
    cp "$folder/systemd/glimmark-metrics.timer" "$BATS_TEST_TMPDIR"
    run systemd-analyze verify --man=no "$BATS_TEST_TMPDIR"/glimmark-metrics.*
    echo "$output"
    [ "$status" -eq 0 ] && [ -z "$output" ]
}

@test "the service is exposed less than 0.5 of 10" {
    run systemd-analyze security --offline=true --threshold=5 "$service"
    echo "$output"
    [ "$status" -eq 0 ]
    [[ $output == *"Overall exposure level"* ]]
}

@test "the service's command writes the file" {
    command=$(sed -n 's/^ExecStart=//p' "$service")
    command=${command/#\/usr\/bin\/cimhost/$CIMHOST --inventory $INVENTORIES/small-server.json}
    command=${command/\/var\/lib\/glimmark-metrics/$BATS_TEST_TMPDIR}
    $command
    [ "$(stat -c %a "$BATS_TEST_TMPDIR/glimmark.prom")" = 644 ]
    grep -qx 'cim_alarm_devices 13' "$BATS_TEST_TMPDIR/glimmark.prom"
}

@test "the link in node exporter's folder leads to the file that the service writes" {
    for script in postinst post; do
        read -r _ _ target link <<<"$(grep 'ln -sfn' "$folder/../packaging/metrics/$script" | tr -d '"')"
        link=${link#\$DPKG_ROOT}
        [ "$link" = /var/lib/prometheus/node-exporter/glimmark.prom ]
        grep -q -- "--output $(realpath -m "${link%/*}/$target")\$" "$service"
    done
}
