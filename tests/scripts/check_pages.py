"""What the pages say is so: their commands are run, their links lead somewhere, the files that they name are there.

    check_pages.py BIN      the folder of a built cimhost

Each command line in a code block of a page is run here, or by a test of TESTED, or EXCUSED says why by none. An indented
block, or a fenced one without a language, is read as commands if it has lines that begin with "$ ", which are then the
commands and the others what they print, or if its first line begins with a program. What is printed on a page is
compared with what is printed here; "..." stands for any lines. The machine is named vm on the pages.
"""

import itertools
import pathlib
import platform
import re
import shutil
import subprocess
import sys

ROOT = pathlib.Path(__file__).resolve().parent.parent.parent
OURS = [file for file in ROOT.rglob("*") if not {"build", "out", ".git"} & set(file.relative_to(ROOT).parts)]
PAGES = sorted(file for file in OURS if file.suffix == ".md" and file.name != "CHANGELOG.md")

# Programs that a machine may lack.
PROGRAMS = set("cimconfig cimhost cimmof cimserver export glimmark-register promtool sfcbd sfcbrepos sfcbstage wbemcli".split())

# Commands, by their beginnings: the file that runs them, and what it has of them.
TESTED = {
    r"\./test\b": (".ci/run", "./test"),
    r"\S*cimhost (--inventory \S+ )?serve": ("tests/clients/check-run", "serve"),
    r"wbemcli (-nl )?(ei|ein|gi|ain|gc|ecn) ": ("tests/clients/wbemcli_test.py", "wbemcli"),
    r"kill %1": ("tests/clients/check-run", "kill"),
    r"CIMHOST=\S+ INVENTORIES=\S+ python3 tests/clients/load.py": ("tests/clients/CMakeLists.txt", "load.py"),
    r"cmake --preset rpm ": ("scripts/package", "rpm"),
    r"cpack ": ("scripts/package", "cpack"),
    r"cmake --preset release -DGLIMMARK_CMPI_INCLUDE_DIR=": ("tests/CMakeLists.txt", "CompilesWithOtherHeaders"),
    r"cmake -S . -B build && cmake --build build": ("tests/CheckInstallation.cmake", "--build ${maker}"),
    r"cmake -S host -B build/host": ("host/CMakeLists.txt", "IsConfiguredAlone"),
    r"cmake --(build --)?preset release": ("scripts/build", "--preset"),
    r"DESTDIR=\S+ cmake --install ": ("tests/CheckInstallation.cmake", "--install"),
    r"g\+\+ .*pkg-config": ("tests/CheckInstallation.cmake", "-Wl,-soname,libtavro-instrumentation.so.1"),
    r"LD_LIBRARY_PATH=(/opt/maker/lib|build) cimhost ": ("tests/CheckInstallation.cmake", "LD_LIBRARY_PATH=${maker}"),
    r"glimmark-register ": ("schema/tests/register/command-line.bats", "register"),
    r"cimconfig -s providerDir": ("schema/tests/register/surroundings.bats", "cimconfig -s providerDir"),
    r"(sfcbstage|sfcbrepos) ": ("schema/tests/register/sfcb.bats", "sfcbrepos"),
    r"cimmof ": ("schema/tests/register/pegasus.bats", "cimmof"),
    r"scripts/bench --guard": (".ci/run", "scripts/bench --guard"),
    r"scripts/build asan && scripts/run-tests asan": (".ci/run", "asan"),
    r"scripts/build libcxx && scripts/run-tests libcxx": (".ci/run", "libcxx"),
    r"scripts/check-interface": ("scripts/release", "scripts/check-interface"),
    r"scripts/check-(brokers|format|lint|packages|shell)": (".ci/run", "scripts/check-"),
    r"scripts/fuzz": (".ci/run", "scripts/fuzz"),
    r"promtool check rules": ("metrics/tests/metrics.bats", "check rules"),
    r"cimhost metrics \| promtool check metrics": ("metrics/tests/metrics.bats", "check metrics"),
    r"CIMHOST=\S+ python3 metrics/tests/fleet.py": ("metrics/CMakeLists.txt", "fleet.py"),
    r"scripts/install-hooks": ("tests/scripts/build.bats", "install-hooks"),
    r"scripts/package": ("scripts/check-packages", "scripts/package"),
    r"SFCB_PREFIX=\S+ PEGASUS_HOME=\S+ scripts/check-brokers": ("tests/brokers/check.py", "SFCB_PREFIX"),
}

# Commands that no test runs.
EXCUSED = {
    r"cmake --build build/host|build/host/bin/cimhost ": "builds a second cimhost, and asks a provider of the reader's own",
    r"\./run\b": "installs packages and builds; tests/scripts/build.bats has stand-ins for that",
    r"\.ci/run": "runs this",
    r"apt-get install|scripts/install-packages |systemctl |dpkg ": "changes the machine, as root",
    r"(MVLOG_\w+=\S+ )?(sfcbd|cimserver)\b|cimconfig ": "needs a broker",
    r"scripts/(bench|coverage|cross|endurance|mutate|valgrind)\b": "takes minutes",
    r"build/asan/bin/fuzz-NAME ": "needs a finding",
    r"\S*cimhost graph \| dot ": "needs graphviz",
    r"LD_LIBRARY_PATH=/where/\S+ cimhost ": "is a pattern; tests/CheckInstallation.cmake has libraries of a maker's",
}

# On a terminal cimhost shows tables.
AS_ON_A_TERMINAL = {"README.md": " --format table"}

# File names on pages that are not of this repository.
ELSEWHERE = {"CIM_Schema.mof", "NAME.cpp", "compile_commands.json", "default.reg", "pt.po", "pt_BR.po"}

failures = []


def fail(page, *what):
    failures.append(f"{page.relative_to(ROOT)}: " + ": ".join(what))


def blocks(page):
    """The language and the lines of each code block; None and each other line."""
    language, block, before = None, [], ""
    for line in [*page.read_text().splitlines(), "end"]:
        fence = re.fullmatch(r" *```(\w*)", line)
        if language is not None and not fence:
            block.append(line)
        elif fence and language is None:
            language = fence[1]
        elif fence:
            yield language, block
            language, block = None, []
        elif re.match("    +[^ ]", line) and (block or not before.strip()) or block and not line:
            block.append(line.strip() if line.strip().startswith("$ ") else line[4:])
        else:
            if block:
                yield "", block
            block = []
            yield None, [line]
        before = line


def is_program(word):
    return (word in PROGRAMS or word.startswith(("build/", "scripts/")) or "/" in word and (ROOT / word).is_file() or
            bool(shutil.which(word, path="/usr/bin:/bin")))


def commands(block):
    """Each command of a block, and the lines that the page says it prints; None where it says nothing."""
    lines = [re.sub(r" {2,}# .*| # .*$", "", line) for line in "\n".join(block).replace("\\\n", "").splitlines()]
    if any(line.startswith("$ ") for line in lines):
        starts = [i for i, line in enumerate(lines) if line.startswith("$ ")]
        for start, end in zip(starts, [*starts[1:], len(lines)]):
            yield lines[start][2:], list(itertools.takewhile(bool, block[start + 1:end]))
    elif is_program(re.sub(r"^(\w+=\S* )*", "", lines[0].strip()).split(" ")[0]):
        yield from ((line.strip(), None) for line in lines if line)


def of(table, command):
    return next((pattern for pattern in table if re.match(pattern, command)), None)


def as_anywhere(text):
    """What differs between machines and moments, as one word."""
    for pattern, word in [(rf"\b{re.escape(platform.node())}\b", "vm"), (r"\d{4}-\d\d-\d\dT[\d:.+]+", "TIME"),
                          (r"\[\d+:\d+\]", "PID"), ("0x[0-9a-f]+", "ADDRESS"), (r"\.cpp:\d+|\[Line: \d+\]", "LINE")]:
        text = re.sub(pattern, word, text)
    return text


def run(page, session, folder):
    """Runs commands of a page in one shell and compares what they print."""
    end = "== end of a command =="
    script = "status=0\n" + "".join(f"(exit $status); {command}\nstatus=$?; printf '\\n{end} %s\\n' $status\n"
                                    for command, _ in session)
    answer = subprocess.run(["bash", "-c", script.replace("build/release/bin/", f"{folder}/")], cwd=ROOT, text=True,
                            timeout=120, stdout=subprocess.PIPE, stderr=subprocess.STDOUT, stdin=subprocess.DEVNULL,
                            env={"PATH": f"{folder}:/usr/bin:/bin", "LANG": "C.UTF-8"})
    answers = re.split(rf"\n*{end} (\d+)\n", answer.stdout)
    for (command, said), printed, status in zip(session, answers[::2], answers[1::2]):
        if said is None:
            if status != "0":
                fail(page, command, "exit status " + status, printed)
            continue
        expected = "".join(r"(.*\n)*" if line == "..." else re.escape(as_anywhere(line)) + r"\n" for line in said)
        if not re.fullmatch(expected, as_anywhere(printed) + "\n" * bool(printed)):
            fail(page, command, "this is printed", printed)


def check_commands(folder):
    used = set()
    for page in PAGES:
        session = []
        found = [each for language, block in blocks(page) if language in ("", "sh") for each in commands(block)]
        for command, said in found:
            pattern = of(TESTED, command) or of(EXCUSED, command)
            used.add(pattern)
            if pattern is None and re.search(r"\bcimhost |^(echo|export) ", command):
                session.append((command + AS_ON_A_TERMINAL.get(page.name, ""), said))
            elif pattern is None:
                fail(page, "no test runs", command)
        run(page, session, folder)
    failures.extend(f"{pattern}: no page has such a command" for pattern in {*TESTED, *EXCUSED} - used)
    failures.extend(f"{file}: runs no {text}" for file, text in TESTED.values() if text not in (ROOT / file).read_text())


def anchors(page):
    headings = (line[0].lstrip("# ") for language, line in blocks(page) if language is None and line[0].startswith("#"))
    return {re.sub(r"[^\w -]", "", heading.lower()).replace(" ", "-") for heading in headings}


def is_there(page, name):
    return any(any(place.glob(name.rstrip("/"))) for place in (page.parent, ROOT)) or \
        any(str(file).endswith("/" + name) for file in OURS)


def check_names():
    folders = {file.name for file in ROOT.iterdir() if file.is_dir()} | {"include"}
    for page in PAGES:
        text = "\n".join(line[0] for language, line in blocks(page) if language is None)
        for target, anchor in re.findall(r"\]\((?!https?:)([^)#]*)#?([^)]*)\)", text):
            linked = page.parent / target if target else page
            if not linked.exists() or anchor and anchor not in anchors(linked):
                fail(page, "this link leads nowhere", f"{target}#{anchor}")
        for name in re.findall(r"`([\w./*-]+)`", text):
            is_source = re.search(r"\w\.(bats|cmake|cpp|h|json|md|mof|po|py|reg)$", name) and not name.startswith("/")
            is_path = "/" in name and name.split("/")[0] in folders - {"build", "out"}
            if (is_source or is_path) and name not in ELSEWHERE and not is_there(page, name):
                fail(page, "there is no file", name)


check_commands(pathlib.Path(sys.argv[1]).resolve())
check_names()
print("\n".join(failures))
sys.exit(bool(failures))
