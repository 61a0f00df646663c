"""Which test programs there are, which of them are near a source, and what they find."""
import collections
import functools
import json
import pathlib
import re
import signal
import tempfile
import threading
import time

import workspace

ROOMS = ("provider", "cmpi", "Linux", "include", "platform")
WHOLE = re.compile(r"(load|system)\.")  # tests that are no GoogleTest programs
ENDLESS = "no end"
LIKELY = 6  # single tests that are tried before whole programs
UNSTEADY = 4  # times that an unchanged program is tried, each without the single tests that failed before
SECONDS = 5  # that a program may compute beyond five times what it takes unchanged


class Program:
    """A GoogleTest program or a part of its tests: some suites, or a single test; or another test."""

    def __init__(self, target, path=None, sources=(), suites=(), test=None):
        self.target = target
        self.path = path
        self.sources = [pathlib.PurePath(source) for source in sources]
        self.suites = suites
        self.test = test

    def command(self, left_out=()):
        if not self.path:
            return ["ctest", "--test-dir", "build", "-R", f"^{re.escape(self.target)}$"]
        suites = ":".join(f"{suite}.*:*/{suite}.*:{suite}/*" for suite in self.suites)  # with parameters and types
        chosen = self.test or suites or "*"
        return [self.path, "--gtest_fail_fast", f"--gtest_filter={chosen}-{':'.join(left_out)}"]

    def key(self):
        return self.target, tuple(self.suites), self.test

    def is_in(self, directory):
        return any(source.parent == directory for source in self.sources)

    def is_of_rooms(self):
        return any(source.parts[:1] == ("tests",) and source.parts[1] in ROOMS for source in self.sources)


class Programs:
    def __init__(self, copy, size, quick=False):
        self.copy = copy
        self.size = size
        self.quick = quick  # only those that mirror the rooms' sources: the others take a minute for each survivor
        self.known = sorted(self.read_targets(), key=lambda program: program.target)
        if not self.known:
            raise workspace.Failure("the copy has no test programs")
        self.environments = {}
        self.locks = collections.defaultdict(threading.Lock)
        self.seconds = {}  # by program: what it takes unchanged
        self.left_out = collections.defaultdict(list)  # by target: the tests that fail unchanged
        self.reached = {}  # by program: the places of mutants, one byte for each number
        self.noticing = collections.defaultdict(dict)  # by file, those that noticed a mutant of it: single tests

    def read_targets(self):
        """From what CMake says of its targets."""
        replies = self.copy.tree / "build/.cmake/api/v1/reply"
        for file in replies.glob("target-*.json"):
            target = json.loads(file.read_text())
            sources = [source["path"] for source in target.get("sources", [])]
            if target["type"] == "EXECUTABLE" and target["paths"]["source"].startswith("tests/") and \
                    any(source.endswith("Test.cpp") for source in sources):
                yield Program(target["name"], f"build/{target['artifacts'][0]['path']}", sources)

    @functools.cache
    def rounds(self, file):
        """The programs that may notice that a file was mutated: the tests that mirror it, its room's, all others."""
        file = pathlib.PurePath(file)
        room = pathlib.PurePath("tests") / file.parent
        mirrored = [part for part in map(lambda program: self.mirror(program, file.stem), self.known) if part]
        nearest = [part for part in mirrored if part.is_in(room)] or mirrored
        whole = {part.target for part in nearest if not part.suites}
        same_room = [program for program in self.known if program.is_in(room) and program.target not in whole]
        seen = whole | {program.target for program in same_room}
        others = [program for program in self.known if program.target not in seen]
        others.sort(key=lambda program: not program.is_in(pathlib.PurePath("tests/provider")))  # they look at all of it
        if self.quick:
            others = [program for program in others if program.is_of_rooms()]
        return [each for each in (nearest, same_room, *in_parts(others)) if each]

    def likely(self, file):
        """The tests that noticed the last mutants of a file: often those of the next, too."""
        return list(self.noticing[file].values())[:-LIKELY - 1:-1]

    def note(self, file, program, failure):
        """What noticed a mutant of a file."""
        test = failure.partition(": ")[2]
        if program.path and "." in test:
            single = Program(program.target, program.path, program.sources, test=test)
            self.noticing[file].pop(single.key(), None)
            self.noticing[file][single.key()] = single

    def mirror(self, program, stem):
        """The part of a program whose files are named after a source; None when it has none."""
        named = [source for source in program.sources if re.fullmatch(stem + r"([A-Z]\w*)?Test", source.stem)]
        if not named:
            return None
        if len([source for source in program.sources if source.stem.endswith("Test")]) == len(named):
            return program
        texts = [(self.copy.tree / source).read_text() for source in named]
        suites = sorted({suite for text in texts for suite in re.findall(r"^(?:TYPED_)?TEST(?:_F|_P)?\((\w+)", text, re.M)})
        return Program(program.target, program.path, program.sources, suites)

    def read_tests(self):
        """What ctest knows once all is built: the variables that programs are given, and tests of other kinds."""
        listed = json.loads(self.copy.output(["ctest", "--test-dir", "build", "--show-only=json-v1"]))["tests"]
        for test in listed:
            given = [value for each in test["properties"] if each["name"] == "ENVIRONMENT" for value in each["value"]]
            self.environments[test["name"].split(".")[0]] = dict(value.split("=", 1) for value in given)
        self.known += [Program(test["name"]) for test in listed if WHOLE.match(test["name"])]

    def quickest(self, programs):
        """Quick ones first, and before them those of which nothing is known yet."""
        return sorted(programs, key=lambda program: self.seconds.get(program.key(), 0))

    def reaches(self, program, number):
        """Whether a program gets to a mutant's place; it is run unchanged before its first use, and has to pass."""
        with self.locks[program.key()]:
            if program.key() not in self.reached:
                self.try_unchanged(program)
        return self.reached[program.key()][number]

    def try_unchanged(self, program):
        with tempfile.NamedTemporaryFile() as reached:
            reached.truncate(self.size)
            for _ in range(UNSTEADY):
                start = time.monotonic()
                failed = self.run(program, reached=reached.name)
                self.seconds[program.key()] = time.monotonic() - start
                if failed is None:
                    self.reached[program.key()] = reached.read()
                    return
                if program.path and "." in failed:
                    print(f"left out, for it fails unchanged: {program.target}: {failed}", flush=True)
                    self.left_out[program.target].append(failed)
        if program.path:
            raise workspace.Failure(f"the unchanged copy fails: {program.target}: {failed}")
        print(f"left out, for it fails unchanged: {program.target}", flush=True)  # some need more than a sandbox has
        self.reached[program.key()] = bytes(self.size)

    def failure_of(self, program, mutant=None):
        """What failed in a program twice, run as a mutant or not; None when it passed."""
        failed = self.run(program, mutant)
        if failed not in (None, ENDLESS):
            failed = self.run(program, mutant)
        return failed and f"{program.target}: {failed}"

    def run(self, program, mutant=None, reached=None):
        seconds = SECONDS + 5 * self.seconds.get(program.key(), 60)
        status, said = self.copy.run(program.command(self.left_out[program.target]), int(seconds),
                                     self.environments.get(program.target), mutant, reached)
        return None if status == 0 else reason(status, said)


def in_parts(programs, size=8):
    return [programs[first:first + size] for first in range(0, len(programs), size)]


def reason(status, said):
    if status in (None, *(128 + number for number in (signal.SIGKILL, signal.SIGXCPU))):
        return ENDLESS
    failed = re.search(r"\[  FAILED  \] (\S+)", said) or re.search(r"Test +#\d+: (\S+) .*(?:Failed|Exception|Timeout)", said)
    if failed:
        return failed.group(1).rstrip(",")
    return f"signal {-status}" if status < 0 else f"exit {status}"
