# The time that scripts/package gives to what it packs. Nothing is built here.

bats_require_minimum_version 1.5.0

setup() {
    unset SOURCE_DATE_EPOCH
    export HOME=$BATS_TEST_TMPDIR GIT_CONFIG_NOSYSTEM=1
    project=$BATS_TEST_TMPDIR/around/project
    mkdir -p "$project/scripts" "$project/packaging"
    cp "$SOURCE/scripts/package" "$project/scripts/"
    printf 'some (1.0) unstable; urgency=medium\n\n  * It works.\n\n -- A <a@b.example>  %s\n' \
        "Thu, 29 Feb 2024 12:00:00 +0000" >"$project/packaging/changelog.in"
}

commit_all() { # FOLDER
    git init -q "$1"
    git -C "$1" add -A
    git -C "$1" -c user.name=A -c user.email=a@b.example commit -q --date @1 -m "Begin"
}

# Without a word on standard error where git knows.
is_of_the_commit() {
    export GIT_COMMITTER_DATE="@1000000000 +0000"
    commit_all "$project"
    run -0 --separate-stderr "$project/scripts/package" --date
    [ "$output" = 1000000000 ]
    [ -z "$stderr" ]
}

is_of_the_changelog() {
    run -0 --separate-stderr "$project/scripts/package" --date
    [ "$output" = 1709208000 ]
    [[ $stderr == *packaging/changelog.in* ]]
}

@test "a clone: of the last commit" { is_of_the_commit; }

@test "a clone below a folder with a blank" {
    mkdir "$BATS_TEST_TMPDIR/a blank"
    mv "$project" "$BATS_TEST_TMPDIR/a blank/"
    project="$BATS_TEST_TMPDIR/a blank/project"
    is_of_the_commit
}

@test "an archive that tells no commit: of the changelog" { is_of_the_changelog; }

@test "a released archive: of the commit" {
    # Where this itself runs in a released archive, git has written the time.
    grep -qxE '\$Format:%ct\$|[0-9]+' "$SOURCE/packaging/commit-date"
    printf '$Format:%%ct$\n' >"$project/packaging/commit-date"
    cp "$SOURCE/.gitattributes" "$project/"
    export GIT_COMMITTER_DATE="@1000000000 +0000"
    commit_all "$project"
    git -C "$project" archive --prefix=released/ HEAD | tar -x -C "$BATS_TEST_TMPDIR"
    project=$BATS_TEST_TMPDIR/released
    run -0 --separate-stderr "$project/scripts/package" --date
    [ "$output" = 1000000000 ]
    [ -z "$stderr" ]
}

@test "a released archive in a repository of something else: of the changelog" {
    commit_all "$BATS_TEST_TMPDIR/around"
    is_of_the_changelog
}

@test "no git: of the changelog" {
    commit_all "$project"
    mkdir "$BATS_TEST_TMPDIR/bin"
    printf '#!/bin/sh\nexit 127\n' >"$BATS_TEST_TMPDIR/bin/git"
    chmod +x "$BATS_TEST_TMPDIR/bin/git"
    PATH=$BATS_TEST_TMPDIR/bin:$PATH is_of_the_changelog
}

@test "a clone of another user: of the changelog" {
    [ "$(id -u)" -eq 0 ] || skip "only root gives files away"
    commit_all "$project"
    chown -R 12345:12345 "$project"
    is_of_the_changelog
}

@test "the environment goes first" {
    SOURCE_DATE_EPOCH=17 run -0 "$project/scripts/package" --date
    [ "$output" = 17 ]
}

@test "the project's own changelog has a time" {
    cp "$SOURCE/packaging/changelog.in" "$project/packaging/"
    run -0 --separate-stderr "$project/scripts/package" --date
    [[ $output =~ ^[0-9]+$ ]]
}

@test "a changelog without a time is told" {
    echo "some (1.0) unstable; urgency=medium" >"$project/packaging/changelog.in"
    run -1 "$project/scripts/package" --date
    [[ $output == *"packaging/changelog.in"*"no date"* ]]
}

@test "what it does not know is refused, and --help is answered" {
    run -2 "$project/scripts/package" --fast
    [[ $output == *"--fast"* ]]
    run -0 "$project/scripts/package" --help
    [[ $output == *"scripts/package [DIRECTORY]"* ]]
}
