#!/usr/bin/env bats
# scripts/release refuses what does not agree. Nothing is built here.

bats_require_minimum_version 1.5.0

setup() {
    project=$BATS_TEST_TMPDIR/project
    mkdir -p "$project/scripts" "$project/packaging"
    cp "$SOURCE/scripts/release" "$project/scripts/"
    printf '# Changelog\n\n## 1.2.3, 2024-02-29\n\n- It works.\n\n## 1.2.2, 2024-01-01\n' >"$project/CHANGELOG.md"
    printf 'glimmark-provider (@PROJECT_VERSION@) unstable; urgency=medium\n\n  * It works.\n\n -- A <a@b.example>  %s\n' \
        "Thu, 29 Feb 2024 12:00:00 +0000" >"$project/packaging/changelog.in"
    printf 'cmake_minimum_required(VERSION 3.20)\n\nproject(\n    Some\n    VERSION 1.2.3\n)\n' >"$project/CMakeLists.txt"
}

# refuses WHAT...: words of the message
refuses() {
    run -1 "$project/scripts/release" --check 1.2.3
    local word
    for word in "$@"; do
        [[ $output == *"$word"* ]]
    done
}

@test "all that names the version agrees" {
    run -0 "$project/scripts/release" --check 1.2.3
    [[ $output == *"agree on 1.2.3"* ]]
}

@test "a changelog of another version, or without a day" {
    sed -i 's/1\.2\.3, /1.2.4, /' "$project/CHANGELOG.md"
    refuses CHANGELOG.md "## 1.2.4, 2024-02-29"
    sed -i 's/1\.2\.4, .*/1.2.3, not yet released/' "$project/CHANGELOG.md"
    refuses CHANGELOG.md "not yet released"
}

@test "the packages' changelog of another day, or with nothing to say" {
    sed -i 's/It works/Not released yet/' "$project/packaging/changelog.in"
    refuses packaging/changelog.in "not released yet"
    sed -i 's/Not released yet/It works/; s/29 Feb/28 Feb/; s/Thu/Wed/' "$project/packaging/changelog.in"
    refuses "packaging/changelog.in is of 2024-02-28, CHANGELOG.md of 2024-02-29"
}

@test "the packages' changelog of another version" {
    sed -i 's/@PROJECT_VERSION@/1.2.2/' "$project/packaging/changelog.in"
    refuses packaging/changelog.in "expected an entry of 1.2.3"
}

@test "the build's own version" {
    sed -i 's/VERSION 1.2.3/VERSION 1.2.2/' "$project/CMakeLists.txt"
    refuses "CMakeLists.txt has version 1.2.2; expected 1.2.3"
}

@test "what is no version is refused, and --help is answered" {
    run -2 "$project/scripts/release" soon
    run -2 "$project/scripts/release"
    run -0 "$project/scripts/release" --help
    [[ $output == *"scripts/release VERSION"* ]]
}
