#!/usr/bin/env python3
"""Plants small faults in a copy of the product, one at a time, and shows which of them the tests find.

    bench/plant_faults.py [NUMBER [DRAW]]

Faults are planted in the .cpp files of every module that is shipped; those in platform/windows are looked for under
Wine. A fault counts as found if a test fails twice, and is replaced by another one if it does not compile. The same
draw gives the same faults, as long as the sources are the same. A survivor is either a missing test or a fault that
changes nothing. What fuzzing and the trial of the installers would find is not counted.
"""
import os
import pathlib
import random
import re
import resource
import shutil
import signal
import subprocess
import sys
import tempfile

ROOT = pathlib.Path(__file__).resolve().parents[1]
MODULES = ("app", "call", "check", "run", "store", "migrate", "appearance", "platform")
NOT_SHIPPED, UNDER_WINE = "platform/linux/", "platform/windows/"
TIME_LIMIT = 600  # seconds for a build or a part of the tests
STRING = r'"(?:[^"\\]|\\.)*"'
NEXT = {"true": "false", "==": "!=", "&&": "||", "<": "<=", ">": ">=", "+": "-", "++": "--", "&": "|"}
NEXT.update({value: key for key, value in NEXT.items()})
# What to look for in a line of code, and what to replace it with.
RULES = (
    (r"\b(?:true|false)\b| (?:==|!=|&&|\|\||<=?|>=?|[+&|-]) |\+\+|--", lambda m: re.sub(r"\S+", lambda sign: NEXT[sign[0]], m[0])),
    (r"(?<=\bif \().+(?=\)$)|(?<=\bwhile \().+(?=\)$)", lambda m: f"!({m[0]})"),
    (r"!(?=[\w(])", lambda m: ""),
    (r"\b(?:0x[0-9A-Fa-f]+|\d+)(?=[uUlL]*\b)", lambda m: f"({m[0]} + 1)"),
    (STRING, lambda m: '"' + ("x" if m[0] == '""' else "~" + m[0][1:-1]) + '"'),
    (r"(?<=\breturn )(?!0;|nullptr;|\{\};|true;|false;).+(?=;$)", lambda m: "{}"),
    (r"^\s+(?:(?!return\b)[\w:>.*\[\]-]+(?:\(.*\)| [-+|&]?= .+)|continue|break|return);$", lambda m: ";"),
)


def run(command, **options):
    """What the command prints if it fails, else nothing. On a timeout, everything that it started is killed."""
    with tempfile.TemporaryFile("w+", errors="replace") as output:
        process = subprocess.Popen(command, stdout=output, stderr=output, start_new_session=True, **options)
        try:
            if process.wait(TIME_LIMIT) == 0:
                return ""
        except subprocess.TimeoutExpired:
            os.killpg(process.pid, signal.SIGKILL)
            process.wait()
        output.seek(0)
        return output.read() or "nothing"


def files(*places):
    return subprocess.check_output(["git", "ls-files", "-z", *places], cwd=ROOT, text=True).split("\0")[:-1]


def faults():
    """Every fault that could be planted: file, number of the line, the line, the line with the fault."""
    for name in files(*MODULES):
        if not name.endswith(".cpp") or name.startswith(NOT_SHIPPED):
            continue
        for number, line in enumerate((ROOT / name).read_text().split("\n")):
            code = re.split(r"\s*//", re.sub(STRING, lambda m: m[0].replace("/", "\0"), line))[0].replace("\0", "/")
            if code.lstrip().startswith("#"):
                continue
            strings = [match.span() for match in re.finditer(STRING, code)]
            for pattern, change in RULES:
                for match in re.finditer(pattern, code):
                    inside = any(start < match.start() < end or start < match.end() < end for start, end in strings)
                    if not inside:
                        yield name, number, line, code[:match.start()] + change(match) + code[match.end():]


def passes(root, is_under_wine):
    """Whether all tests pass in this copy of the project, or the one that failed passes when it is repeated."""
    if is_under_wine:
        programs = [root / "windows" / name for name in ("FolderUpgrade.exe", "FolderUpgradeCheck.exe", "FolderUpgradeRun.exe")]
        if run([root / "tests/import_tables.sh", *programs]):
            return False
        parts = (("nobody", "*_AsOtherUser"), ("root", "-*_AsOtherUser:Sizes/*:OnlyOnWindows*"))
    else:
        if run([root / "native/tests/unit_test"]):
            return False
        parts = (("", "-Sizes/*:AtEachCall/*"), ("", "Sizes/*"), ("", "AtEachCall/*"))
    for user, tests in parts:
        output = run_tests(root, user, tests)
        failed = re.search(r"\[  FAILED  \] ([\w/.]+)", output)
        if output and run_tests(root, user, failed[1] if failed else tests):
            return False
    return True


def run_tests(root, user, tests):
    """What they print if they fail, else nothing. With a user, they run under Wine."""
    scratch = root / "scratch"
    scratch.mkdir()
    scratch.chmod(0o1777)  # another user's Wine server creates files there
    environment = {**os.environ, "TMPDIR": str(scratch), "GTEST_FAIL_FAST": "1", "GTEST_FILTER": tests}
    memory = 4 << 30  # some faults make a loop that never stops allocating
    if user:
        command = [root / "tests/under_wine.sh", *(root / "windows").glob("*-trial.zip"), user, f"--gtest_filter={tests}"]
        output = run(command, env=environment)
    else:
        output = run([root / "native/tests/scenario_test"], cwd=scratch, env=environment,
                     preexec_fn=lambda: resource.setrlimit(resource.RLIMIT_AS, (memory, memory)))
    shutil.rmtree(scratch)
    return output


def build(root, is_under_wine):
    return not run(["ninja", "-C", root / ("windows" if is_under_wine else "native")])


def plant_all(root, drawn, wanted):
    for name in files():
        (root / name).parent.mkdir(parents=True, exist_ok=True)
        shutil.copy(ROOT / name, root / name)
    root.chmod(0o755)  # some scenarios run as another user
    for folder, options in (("native", []), ("windows", [f"--toolchain={root}/cmake/windows/toolchain.cmake"])):
        subprocess.check_call(["cmake", "-S", root, "-B", root / folder, "-G", "Ninja", "-DCMAKE_BUILD_TYPE=Debug",
                               "-DCMAKE_CXX_FLAGS_DEBUG=-O0 -DNDEBUG -w", "-DCMAKE_GTEST_DISCOVER_TESTS_DISCOVERY_MODE=PRE_TEST",
                               "--no-warn-unused-cli", *options], stdout=subprocess.DEVNULL)
    for is_under_wine in (False, True):
        if not build(root, is_under_wine) or not passes(root, is_under_wine):
            sys.exit("without any fault, the build or the tests fail" + " under Wine" * is_under_wine)
    counts = {"found": 0, "SURVIVED": 0, "did not compile": 0}
    for name, number, line, changed in drawn:
        if counts["found"] + counts["SURVIVED"] == wanted:
            break
        original = (root / name).read_text()
        lines = original.split("\n")
        lines[number] = changed
        (root / name).write_text("\n".join(lines))
        is_under_wine = name.startswith(UNDER_WINE)
        outcome = "did not compile" if not build(root, is_under_wine) else "SURVIVED" if passes(root, is_under_wine) else "found"
        (root / name).write_text(original)
        counts[outcome] += 1
        print(f"{outcome} {name}:{number + 1}\n  - {line}\n  + {changed}", flush=True)
    return counts


def main():
    wanted, draw = (int(text) for text in (sys.argv[1:] + ["150", "1"][len(sys.argv) - 1:])[:2])
    drawn = sorted(faults())
    random.Random(draw).shuffle(drawn)
    with tempfile.TemporaryDirectory() as root:
        print(f"{wanted} faults, draw {draw}", flush=True)
        print(plant_all(pathlib.Path(root), drawn, wanted))


if __name__ == "__main__":
    main()
