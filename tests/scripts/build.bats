# What ./run and ./test are made of: building with progress, running tests and counting them, in a small project.

bats_require_minimum_version 1.5.0

setup() {
    # Of `./test NAME`, where that runs this.
    unset GTEST_FILTER
    project=$BATS_TEST_TMPDIR/project
    mkdir -p "$project/scripts"
    cp "$SOURCE/scripts/build" "$SOURCE/scripts/run-tests" "$project/scripts/"
    cp "$SOURCE/run" "$SOURCE/test" "$project/"
    cat >"$project/CMakePresets.json" <<'END'
{
    "version": 2,
    "configurePresets": [
        { "name": "release", "generator": "Ninja", "binaryDir": "${sourceDir}/build/release",
          "cacheVariables": { "CMAKE_EXPORT_COMPILE_COMMANDS": "ON" } }
    ],
    "buildPresets": [ { "name": "release", "configurePreset": "release" } ],
    "testPresets": [ { "name": "release", "configurePreset": "release", "execution": { "noTestsAction": "error" } } ]
}
END
    cat >"$project/CMakeLists.txt" <<'END'
cmake_minimum_required(VERSION 3.20)
project(small LANGUAGES NONE)
enable_testing()
foreach(step RANGE 1 20)
    add_custom_target(step${step} ALL COMMAND true)
endforeach()
foreach(half 0 1)
    add_test(NAME some-tests.${half} COMMAND sh ${PROJECT_SOURCE_DIR}/program)
endforeach()
add_test(NAME Whole.Thing COMMAND sh ${PROJECT_SOURCE_DIR}/thing)
END
    echo 'echo "[  PASSED  ] 3 tests."' >"$project/program"
    echo true >"$project/thing"
}

@test "a build in a log is some lines" {
    run -0 --separate-stderr "$project/scripts/build" release
    [ "$(grep -c '^  built [0-9]* of 20$' <<<"$output")" -ge 5 ]
    [ "${#lines[@]}" -le 12 ]
}

@test "what fails to build is shown, and fails" {
    echo 'add_custom_target(broken ALL COMMAND sh -c "echo it is broken; exit 1")' >>"$project/CMakeLists.txt"
    run -1 "$project/scripts/build" release
    [[ $output == *"it is broken"* ]]
}

@test "a tree that was moved is built anew, and it is said" {
    "$project/scripts/build" release
    touch "$project/build/release/of-before"
    mv "$project" "$project 2"
    run -0 "$project 2/scripts/build" release
    [ "${lines[0]}" = "build/release was made in $project: it is made anew." ]
    [ ! -e "$project 2/build/release/of-before" ]
}

@test "editors find how each source is compiled" {
    sed -i 's/LANGUAGES NONE/LANGUAGES CXX/' "$project/CMakeLists.txt"
    echo 'add_library(one source.cpp)' >>"$project/CMakeLists.txt"
    touch "$project/source.cpp"
    "$project/scripts/build" release
    grep -q source.cpp "$project/compile_commands.json"
}

@test "the tests of a program count one by one, all else as one" {
    "$project/scripts/build" release
    run -0 "$project/scripts/run-tests" release
    [ "${lines[-1]}" = "7 passed, 0 failed" ]
}

@test "a test that fails is counted, and fails" {
    printf '%s\n' 'echo "[  PASSED  ] 2 tests."' 'echo "[  FAILED  ] 1 test, listed below:"' 'exit 1' >"$project/program"
    "$project/scripts/build" release
    run -8 "$project/scripts/run-tests" release
    [ "${lines[-1]}" = "5 passed, 2 failed" ]
}

@test "a program that crashes counts as failed" {
    echo 'kill -SEGV $$' >"$project/program"
    "$project/scripts/build" release
    run -8 "$project/scripts/run-tests" release
    [ "${lines[-1]}" = "1 passed, 2 failed" ]
}

@test "a name chooses: programs by their filter, all else by name" {
    echo '[ "$GTEST_FILTER" = "*Thing*" ] || exit 1; echo "[  PASSED  ] 1 test."' >"$project/program"
    "$project/scripts/build" release
    run -0 "$project/scripts/run-tests" release Thing
    [ "${lines[-1]}" = "3 passed, 0 failed" ]
}

@test "the name of a program chooses all of it" {
    echo '[ -z "${GTEST_FILTER-}" ] || exit 1; echo "[  PASSED  ] 3 tests."' >"$project/program"
    "$project/scripts/build" release
    run -0 "$project/scripts/run-tests" release some-
    [ "${lines[-1]}" = "6 passed, 0 failed" ]
}

@test "a name that no test has fails" {
    echo 'echo "[  PASSED  ] 0 tests."' >"$project/program"
    "$project/scripts/build" release
    run -1 "$project/scripts/run-tests" release Nowhere
    [ "${lines[-1]}" = "No test has such a name." ]
}

@test "./run and ./test refuse what they do not know, and answer --help, from any folder" {
    cd /
    run -2 "$project/run" --fast
    [[ $output == *"--fast"*"usage: ./run"* ]]
    run -2 "$project/test" -R Trace
    [[ $output == *"-R"*"usage: ./test"* ]]
    run -2 "$project/test" one two
    run -0 "$project/run" --help
    [[ $output == "usage: ./run"* ]]
    run -0 "$project/test" --help
    [[ $output == *"./test NAME"* ]]
}

@test "./run says first how long it takes, and then what can be typed where the person stands" {
    printf '#!/bin/sh\n' >"$project/scripts/install-packages"
    printf '#!/bin/sh\nmkdir -p build/release/bin; cp /bin/echo build/release/bin/cimhost\n' \
        >"$project/scripts/build"
    chmod +x "$project/scripts/install-packages" "$project/scripts/build"
    mkdir -p "$project/platform/instrumentation/inventories"
    touch "$project/platform/instrumentation/inventories/small-server.json"
    mkdir "$BATS_TEST_TMPDIR/else where"
    cd "$BATS_TEST_TMPDIR/else where"
    run -0 "$project/run"; echo "$output"
    [[ ${lines[0]} == *"minute"*"MB"* ]]
    [[ $output == *"  ../project/build/release/bin/cimhost --inventory ../project/platform/"*" serve"* ]]
}

@test "the hook formats what is staged, and nothing beside it" {
    command -v clang-format || skip "no clang-format"
    cd "$project"
    cp -r "$SOURCE/scripts/hooks" "$SOURCE/scripts/install-hooks" scripts/
    cp "$SOURCE/.clang-format" .
    git init -q .
    git config user.email nobody@example.org
    git config user.name nobody
    scripts/install-hooks
    echo 'int  a ;' >a.cpp
    echo 'int  b ;' >b.cpp
    git add a.cpp b.cpp
    echo 'int  c ;' >>b.cpp
    git commit -qm "Add two sources"
    [ "$(git show HEAD:a.cpp)" = "int a;" ]
    [ "$(cat a.cpp)" = "int a;" ]
    [ "$(git show HEAD:b.cpp)" = "int b;" ]
    [ "$(cat b.cpp)" = $'int  b ;\nint  c ;' ]
}
