#!/usr/bin/env python3
"""Plants small faults in copies of the product, one at a time, and shows which of them the tests find.

    tests/plant_faults.py [NUMBER [SEED [WORKERS]]]

A fault that does not compile is drawn again. The list of faults depends on the seed alone, as long as
the sources are the same. The share found is printed last; the faults that survive are what to read.
"""
import concurrent.futures
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
import threading

ROOT = pathlib.Path(__file__).resolve().parents[1]
MODULES = ("app", "check", "run", "store", "migrate", "appearance", "platform")
TIME_LIMIT = 120  # seconds for all tests of one fault
STRING = r'"(?:[^"\\]|\\.)*"'
NEXT = {"true": "false", "==": "!=", "&&": "||", "<": "<=", ">": ">=", "+": "-", "++": "--", "&": "|"}
NEXT.update({value: key for key, value in NEXT.items()})
# What is looked for in a line of code, and what it becomes.
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
    """Whether the command succeeds; everything that it started is gone afterwards."""
    process = subprocess.Popen(command, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL, start_new_session=True, **options)
    try:
        return process.wait(TIME_LIMIT) == 0
    except subprocess.TimeoutExpired:
        os.killpg(process.pid, signal.SIGKILL)
        process.wait()
        return False


def files(*places):
    return subprocess.check_output(["git", "ls-files", "-z", *places], cwd=ROOT, text=True).split("\0")[:-1]


def faults():
    """Every fault that could be planted: file, number of the line, the line, the line with the fault."""
    for name in files(*MODULES):
        if not name.endswith(".cpp") or name.startswith("platform/windows/"):
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


class Copy:
    """A copy of the sources with its own build."""

    def __init__(self, parent):
        self.root = pathlib.Path(tempfile.mkdtemp(dir=parent))
        self.root.chmod(0o755)  # some scenarios run as another user
        for name in files():
            (self.root / name).parent.mkdir(parents=True, exist_ok=True)
            shutil.copy(ROOT / name, self.root / name)
        self.build = self.root / "build"
        self.scratch = self.root / "scratch"
        subprocess.check_call(["cmake", "-S", self.root, "-B", self.build, "-G", "Ninja", "-DCMAKE_BUILD_TYPE=Debug",
                               "-DCMAKE_CXX_FLAGS_DEBUG=-O0 -DNDEBUG -w",
                               "-DCMAKE_GTEST_DISCOVER_TESTS_DISCOVERY_MODE=PRE_TEST"], stdout=subprocess.DEVNULL)
        subprocess.check_call(["ninja", "-C", self.build], stdout=subprocess.DEVNULL)
        if not self.passes():
            sys.exit("without any fault the tests fail")

    def passes(self):
        self.scratch.mkdir(mode=0o755)
        limit = 4 << 30  # some faults make a loop that never stops allocating
        passed = all(run([self.build / "tests" / test, "--gtest_fail_fast"], cwd=self.scratch,
                         env={**os.environ, "TMPDIR": str(self.scratch)},
                         preexec_fn=lambda: resource.setrlimit(resource.RLIMIT_AS, (limit, limit)))
                     for test in ("scenario_test", "unit_test"))
        shutil.rmtree(self.scratch)
        return passed

    def survives(self, fault):
        """True, False, or None when the fault does not compile."""
        name, number, _, changed = fault
        original = (self.root / name).read_text()
        lines = original.split("\n")
        lines[number] = changed
        (self.root / name).write_text("\n".join(lines))
        try:
            return self.passes() if run(["ninja", "-C", self.build]) else None
        finally:
            (self.root / name).write_text(original)


def main():
    wanted, seed, workers = (int(text) for text in (sys.argv[1:] + ["150", "1", "1"][len(sys.argv) - 1:])[:3])
    drawn = sorted(faults())
    random.Random(seed).shuffle(drawn)
    results, lock, local = [], threading.Lock(), threading.local()

    def judge(fault):
        if sum(survived is not None for survived in results) >= wanted:
            return
        if not hasattr(local, "copy"):
            local.copy = Copy(parent)
        survived = local.copy.survives(fault)
        with lock:
            results.append(survived)
            if survived is not None:
                name, number, line, changed = fault
                print("SURVIVED" if survived else "found", f"{name}:{number + 1}", f"\n  - {line}\n  + {changed}", flush=True)

    with tempfile.TemporaryDirectory() as parent, concurrent.futures.ThreadPoolExecutor(workers) as pool:
        os.chmod(parent, 0o755)
        list(pool.map(judge, drawn))
    found, survived = results.count(False), results.count(True)
    print(f"seed {seed}: {found} of {found + survived} found, {results.count(None)} did not compile")


if __name__ == "__main__":
    main()
