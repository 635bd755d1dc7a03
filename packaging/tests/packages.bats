#!/usr/bin/env bats
# The packages in PACKAGES, and those of another run in AGAIN. SOURCE is the folder that they were built in.

# The order of the lists.
export LC_ALL=C
lists=$BATS_TEST_DIRNAME

setup_file() {
    export TREE=$BATS_FILE_TMPDIR/tree RPM_TREE=$BATS_FILE_TMPDIR/rpm-tree
    mkdir "$TREE" "$RPM_TREE"
    local package
    for package in "$PACKAGES"/*.deb; do
        dpkg-deb -x "$package" "$TREE"
    done
    for package in "$PACKAGES"/*.rpm; do
        rpm2archive - <"$package" | tar -xz -C "$RPM_TREE"
    done
}

triplet() { dpkg-architecture -q DEB_HOST_MULTIARCH; }

# asks ARGUMENT...: the unpacked cimhost, with nothing set but the inventory
asks() {
    env -u LD_LIBRARY_PATH -u CIMHOST_PROVIDER_DIR -u CIMHOST_REGISTRATION \
        "$TREE/usr/bin/cimhost" --inventory "$TREE/usr/share/glimmark-provider/inventories/small-server.json" "$@"
}

files_of_debian_packages() {
    local package name
    for package in "$PACKAGES"/*.deb; do
        name=$(dpkg-deb -f "$package" Package)
        dpkg-deb -c "$package" | sed "s|$(triplet)|TRIPLET|" |
            awk -v name="$name" '$1 !~ /^d/ { print name, $1, $2, substr($6, 2), $7, $8 }' | sed 's/ *$//'
    done | sort
}

files_of_rpm_packages() {
    rpm -qp --qf '[%{=NAME} %{FILEMODES:perms} %{FILEUSERNAME}/%{FILEGROUPNAME} %{FILENAMES} %{FILELINKTOS}\n]' \
        "$PACKAGES"/*.rpm | sed 's/ *$//' | sort
}

@test "the Debian packages have these files and no others" {
    diff "$lists/debian-files" <(files_of_debian_packages)
}

@test "the RPM packages have these files and no others" {
    diff "$lists/rpm-files" <(files_of_rpm_packages)
}

# The support libraries' packages among the dependencies of a package.
support_packages() {
    dpkg-deb -f "$1" Depends | tr , '\n' | sed 's/^ *//' | grep -E '^lib(tavro-[a-z]+|mvlog)1' | sort
}

# The same, from what its files load.
support_libraries_of() {
    local tree=$BATS_TEST_TMPDIR/${1##*/}
    dpkg-deb -x "$1" "$tree"
    find "$tree" -type f -name '*.so*' -exec readelf --dynamic {} + |
        sed -nE 's/.*\(NEEDED\).*\[(lib(tavro-[a-z]+|mvlog))\.so\.1\]/\11/p' | sort -u
}

@test "the Debian packages depend on what they load" {
    count=0
    for package in "$PACKAGES"/*.deb; do
        [[ $package != */libtavro-dev_* && $package != */glimmark-metrics_* ]] || continue
        diff <(support_packages "$package") <(support_libraries_of "$package")
        dpkg-deb -f "$package" Depends | grep -q 'libstdc++6 (>= '
        count=$((count + 1))
    done
    [ "$count" -eq 7 ]
    [ "$(support_packages "$PACKAGES"/libtavro-dev_*.deb | wc -l)" -eq 4 ]
}

@test "another package can stand for each support library" {
    for library in tavro-instrumentation tavro-common tavro-locale mvlog; do
        # A version here would shut out a package that provides the name.
        support_packages "$PACKAGES"/glimmark-provider_*.deb | grep -qx "lib${library}1"
        [ "$(dpkg-deb -I "$PACKAGES/lib${library}1"_*.deb shlibs)" = "lib$library 1 lib${library}1" ]
        rpm -qp --requires "$PACKAGES"/glimmark-provider-*.rpm | grep -qxF "lib$library.so.1()(64bit)"
        rpm -qp --provides "$PACKAGES/lib${library}1"-*.rpm | grep -qxF "lib$library.so.1()(64bit)"
    done
}

@test "the packages depend on what glimmark-register needs" {
    dpkg-deb -f "$PACKAGES"/glimmark-provider_*.deb Depends | tr , '\n' | grep -qx ' *python3:any'
    for needed in /usr/bin/python3 coreutils; do
        rpm -qp --requires "$PACKAGES"/glimmark-provider-*.rpm | grep -qx "$needed"
    done
}

# The folders that the package filesystem of a distribution with RPM has.
of_the_distribution='/usr(/(bin|sbin|include|lib(/(systemd/system|sysusers\.d))?|lib64|libexec|share(/(doc|locale(/[^/]+(/LC_MESSAGES)?)?|man(/man.)?))?))?'

@test "each RPM package owns the folders that its files are in" {
    for package in "$PACKAGES"/*.rpm; do
        rpm -qlp "$package" | sort >"$BATS_TEST_TMPDIR/owned"
        grep -qx '/usr/share/doc/.*' "$BATS_TEST_TMPDIR/owned"
        folders=$(sed -n 's|/[^/]*$||p' "$BATS_TEST_TMPDIR/owned" | sort -u |
            grep -vxE "$of_the_distribution" | comm -23 - "$BATS_TEST_TMPDIR/owned")
        echo "$package: $folders"
        [ -z "$folders" ]
    done
}

@test "every package says what it is" {
    for package in "$PACKAGES"/*.deb; do
        dpkg-deb -f "$package" Description | head -n 1
        [ "$(dpkg-deb -f "$package" Maintainer)" = "Tavro <glimmark@tavro.example>" ]
    done >"$BATS_TEST_TMPDIR/descriptions"
    [ "$(sort -u "$BATS_TEST_TMPDIR/descriptions" | wc -l)" -eq 9 ]
}

@test "the provider answers from the unpacked packages" {
    [ "$(asks ein TAVRO_Glimmark | grep -c 'TAVRO_Glimmark.CreationClassName=')" -eq 13 ]
    [ "$(asks ein TAVRO_GlimmarkElementCapabilities | wc -l)" -eq 13 ]
    [ "$(asks ein TAVRO_GlimmarkSystemDevice | wc -l)" -eq 13 ]
    [ "$(asks ai 'TAVRO_GlimmarkCapabilities.InstanceID="TAVRO:GlimmarkCapabilities1"' \
        -ac TAVRO_GlimmarkElementCapabilities --format mof | grep -c '^instance of TAVRO_Glimmark$')" -eq 13 ]
}

@test "it loads the libraries of the packages and no others of the project's" {
    LD_LIBRARY_PATH='' ldd "$TREE/usr/lib/$(triplet)/cmpi/libGlimmarkProvider.so" >"$BATS_TEST_TMPDIR/loaded"
    for library in tavro-instrumentation tavro-common tavro-locale mvlog; do
        file=$(awk -v name="lib$library.so.1" '$1 == name { print $3 }' "$BATS_TEST_TMPDIR/loaded")
        [ "$(readlink -f "$file")" = "$(readlink -f "$TREE/usr/lib/$(triplet)/lib$library.so.1")" ]
    done
}

@test "the unpacked glimmark-register finds its files" {
    mkdir -p "$BATS_TEST_TMPDIR/bin" "$BATS_TEST_TMPDIR/stage"
    touch "$BATS_TEST_TMPDIR/stage/default.reg"
    for tool in sfcbstage sfcbrepos; do
        printf '#!/bin/sh\n' >"$BATS_TEST_TMPDIR/bin/$tool"
        chmod +x "$BATS_TEST_TMPDIR/bin/$tool"
    done
    PATH=$BATS_TEST_TMPDIR/bin:$PATH run "$TREE/usr/sbin/glimmark-register" --broker sfcb \
        --stage-dir "$BATS_TEST_TMPDIR/stage" --dry-run register
    [ "$status" -eq 0 ]
    [[ $output == *"classes of $TREE/usr/share/glimmark-provider/schema"* ]]
}

@test "every program that a person calls has a manual page" {
    local programs=0 file name
    for file in "$RPM_TREE"/usr/bin/* "$RPM_TREE"/usr/sbin/*; do
        name=${file##*/}
        [ -e "$RPM_TREE/usr/share/man/man1/$name.1.gz" ] || [ -e "$RPM_TREE/usr/share/man/man8/$name.8.gz" ]
        programs=$((programs + 1))
    done
    [ "$programs" -ge 2 ]
}

@test "the support libraries' packages tell the loader, and bring no script on Debian" {
    for library in tavro-instrumentation tavro-common tavro-locale mvlog; do
        [ "$(dpkg-deb -I "$PACKAGES/lib${library}1"_*.deb triggers)" = "activate-noawait ldconfig" ]
        [ "$(dpkg-deb --ctrl-tarfile "$PACKAGES/lib${library}1"_*.deb | tar -t | grep -cE 'post(inst|rm)')" -eq 0 ]
        [ "$(rpm -qp --qf '%{POSTIN}\n%{POSTUN}' "$PACKAGES/lib${library}1"-*.rpm | grep -cx /sbin/ldconfig)" -eq 2 ]
    done
}

@test "the RPM package says of each catalogue which language it is" {
    diff <(rpm -qp --qf '[%{FILELANGS} %{FILENAMES}\n]' "$PACKAGES"/libtavro-locale1-*.rpm | grep '\.mo$' | cut -d' ' -f1) \
        <(cd "$RPM_TREE/usr/share/locale" && ls)
}

# Names in a bill of materials.
billed() { python3 -c 'import json, sys; print(*(one["name"] for one in json.load(open(sys.argv[1]))["packages"]), sep="\n")' "$1" | sort; }

@test "each package has a bill of what it loads" {
    for package in "$PACKAGES"/*.deb; do
        missing=$(dpkg-deb -f "$package" Depends | tr , '\n' | sed -nE 's/^ *([a-z0-9+.-]+).*/\1/p' | sed 's|-fmt9$||' | grep -v python3 |
            sort -u | comm -23 - <(billed "$package.spdx.json"))
        echo "$package: $missing"
        # Headers and units load nothing themselves.
        [ -z "$missing" ] || [[ $package == */libtavro-dev_* || $package == */glimmark-metrics_* ]]
    done
    for package in "$PACKAGES"/*.rpm; do
        name=$(rpm -qp --qf '%{NAME}' "$package")
        [[ $name == libtavro-devel ]] || diff <(billed "$PACKAGES/$name"_*.deb.spdx.json) <(billed "$package.spdx.json")
    done
    billed "$PACKAGES"/libtavro-instrumentation1_*.spdx.json | grep -qx nlohmann-json3-dev
}

# What the standard makes of the sums of a tree's files.
verification_code() { (cd "$1" && find . -type f -exec sha1sum {} +) | cut -c1-40 | sort | tr -d '\n' | sha1sum | cut -c1-40; }

@test "a bill lists all files of its package" {
    for package in "$PACKAGES"/*.deb "$PACKAGES"/*.rpm; do
        tree=$BATS_TEST_TMPDIR/${package##*/}
        mkdir "$tree"
        case $package in
        *.deb) dpkg-deb -x "$package" "$tree" ;;
        *) rpm2archive - <"$package" | tar -xz -C "$tree" ;;
        esac
        grep -qF '"filesAnalyzed": true' "$package.spdx.json"
        grep -qF "\"packageVerificationCodeValue\": \"$(verification_code "$tree")\"" "$package.spdx.json"
        [ "$(grep -c '"fileName": ' "$package.spdx.json")" -eq "$(find "$tree" -type f | wc -l)" ]
        [ -z "$(grep '"SPDXID": ' "$package.spdx.json" | sort | uniq -d)" ]
    done
}

# Programs and libraries in a tree.
binaries() { find "$1" -type f \( -name '*.so*' -o -path '*/bin/*' \); }

@test "no debug information, and nothing of the folder of the build" {
    [ "$(binaries "$TREE" | wc -l)" -eq 7 ]
    for file in $(binaries "$TREE"); do
        [ "$(readelf --wide --sections "$file" | grep -c '\.debug_')" -eq 0 ]
        [ "$(strings --all "$file" | grep -cF "$SOURCE")" -eq 0 ]
    done
    [ "$(grep -rlF "$SOURCE" "$TREE" | wc -l)" -eq 0 ]
}

@test "all files of the RPM packages bear the time of the sources" {
    for package in "$PACKAGES"/*.rpm; do
        [ "$(rpm -qp --qf '[%{FILEMTIMES}\n]' "$package" | sort -u)" = "$(rpm -qp --qf '%{BUILDTIME}' "$package")" ]
    done
}

@test "packages that are built twice are the same" {
    diff <(cd "$PACKAGES" && ls) <(cd "$AGAIN" && ls)
    for package in "$PACKAGES"/*; do
        cmp "$package" "$AGAIN/${package##*/}"
    done
}

# The two kinds of package come from two folders of the build. The way to the catalogues, which is another in each kind,
# is compiled into the locale library, that to the providers into cimhost.
@test "libraries that are built in two folders are the same" {
    for file in libtavro-instrumentation.so.1 libtavro-common.so.1 libmvlog.so.1 \
        cmpi/libGlimmarkProvider.so cmpi/libTavroComputerSystem.so; do
        cmp "$TREE/usr/lib/$(triplet)/$file" "$RPM_TREE/usr/lib64/$file"
    done
}
