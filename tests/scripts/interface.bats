#!/usr/bin/env bats
# scripts/check-interface finds what breaks makers' libraries and brokers, and says which: in libraries that are small, but
# for the instrumentation library's own header.

bats_require_minimum_version 1.5.0

header=platform/instrumentation/include/Tavro/Instrumentation.h

setup_file() {
    [ "$(uname -m)" = x86_64 ] || skip "there is nothing to compare on $(uname -m)"
    local project=$BATS_FILE_TMPDIR/project part library
    mkdir -p "$project/scripts" "$project/packaging/interface" "$project/cmpi" "$project/platform/instrumentation"
    cd "$project" || exit
    cp "$SOURCE/scripts/check-interface" scripts/
    cp "$SOURCE"/packaging/interface/*.abignore packaging/interface/
    cp -r "$SOURCE/platform/instrumentation/include" platform/instrumentation/
    for part in logging/include common/include locale/include; do
        mkdir -p "platform/$part"
    done
    for library in mvlog tavro-common tavro-locale; do
        echo "namespace Tavro { int answer() { return 42; } }" >"$library.cpp"
    done
    printf 'extern "C" int Glimmark%s_Create_InstanceMI() { return 42; }\n' One Two >GlimmarkProvider.cpp
    echo libGlimmarkProvider.so >GlimmarkProvider.soname
    cat >tavro-instrumentation.cpp <<'END'
#include "Tavro/Instrumentation.h"
namespace Tavro {
struct Instrumentation::Implementation {};
Instrumentation::Instrumentation() {}
Instrumentation::~Instrumentation() {}
void Instrumentation::selectNode(NodeLexicon::NodeType) {}
Instrumentation::operator bool() const { return false; }
Instrumentation& Instrumentation::operator++() { return *this; }
std::string Instrumentation::getPathToNode() const { return {}; }
std::string Instrumentation::convertPathToString(const std::string& path) const { return path; }
std::string Instrumentation::getNodeDescription() const { return {}; }
unsigned int Instrumentation::getNodeStatus() const { return 0; }
bool Instrumentation::getProperty(NodeLexicon::Properties, unsigned int&) const { return false; }
}
END
    printf '#!/bin/sh\n' >scripts/install-packages
    cat >scripts/build <<'END'
#!/bin/sh
shift 2
mkdir -p build/release/lib
for library; do
    soname=$(cat "$library.soname" 2>/dev/null || echo "lib$library.so.1")
    g++ -std=c++17 -g -shared -fPIC -Iplatform/instrumentation/include "-Wl,-soname,$soname" "$library.cpp" \
        -o "build/release/lib/lib$library.so" || exit
done
END
    chmod +x scripts/*
    scripts/check-interface --accept
}

setup() {
    cp -r "$BATS_FILE_TMPDIR/project" "$BATS_TEST_TMPDIR/"
    cd "$BATS_TEST_TMPDIR/project" || exit
}

# breaks SENTENCE: and names nothing else
breaks() {
    run -1 scripts/check-interface
    echo "$output"
    [[ ${lines[-1]} == "$1"* ]]
    [ "$(grep -cE '^lib.* (breaks|needs|has a new)' <<<"$output")" -eq 1 ]
}

@test "what is as described passes" {
    run -0 scripts/check-interface
    [ "${lines[-1]}" = "The interfaces are as described in packaging/interface." ]
}

@test "a member function less needs a new soname" {
    sed -i '/getNodeStatus/d' $header tavro-instrumentation.cpp
    breaks "libtavro-instrumentation.so.1 needs a new soname"
    [[ $output == *"Instrumentation::getNodeStatus"* ]]
}

@test "a virtual function more needs a new soname" {
    sed -i 's/^private:/    virtual void added();\n&/' $header
    echo 'void Tavro::Instrumentation::added() {}' >>tavro-instrumentation.cpp
    breaks "libtavro-instrumentation.so.1 needs a new soname"
    [[ $output == *"Instrumentation::added"* ]]
}

@test "a member function that takes something else needs a new soname" {
    sed -i 's/selectNode(NodeLexicon::NodeType/&, int/' $header tavro-instrumentation.cpp
    breaks "libtavro-instrumentation.so.1 needs a new soname"
}

@test "a function more breaks makers' libraries" {
    echo 'namespace Tavro { int added() { return 42; } }' >>tavro-common.cpp
    breaks "libtavro-common.so.1 breaks makers' libraries"
}

@test "a new soname is told" {
    echo libtavro-locale.so.2 >tavro-locale.soname
    breaks "libtavro-locale.so.2 has a new soname, libtavro-locale.so.1 before"
}

@test "an entry point less breaks brokers" {
    sed -i /GlimmarkOne/d GlimmarkProvider.cpp
    breaks "libGlimmarkProvider.so breaks brokers"
}

@test "a change that is meant is accepted" {
    sed -i '/getNodeStatus/d' $header tavro-instrumentation.cpp
    scripts/check-interface --accept
    run -0 scripts/check-interface
}

@test "what it does not know is refused" {
    run -2 scripts/check-interface --fast
    [[ $output == *"--fast"* ]]
}
