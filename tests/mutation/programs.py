"""Which test programs there are, which of them are near a source, and what they find."""
import json
import pathlib
import re
import time

ROOMS = ("provider", "cmpi", "Linux", "include", "platform")
WHOLE = r"^(load|system)\."  # tests that are no GoogleTest programs
SECONDS = 30  # that a program may take beyond ten times what it takes unchanged


class Program:
    """A GoogleTest program, or a part of its tests."""

    def __init__(self, target, path, sources, suites=()):
        self.target = target
        self.path = path
        self.sources = [pathlib.PurePath(source) for source in sources]
        self.suites = suites

    def command(self):
        chosen = ":".join(f"{suite}.*:*/{suite}.*:{suite}/*" for suite in self.suites)  # those with parameters and types
        return [self.path, "--gtest_fail_fast", *([f"--gtest_filter={chosen}"] if chosen else [])]

    def key(self):
        return self.target, tuple(self.suites)

    def is_in(self, directory):
        return any(source.parent == directory for source in self.sources)


class Programs:
    def __init__(self, workspace):
        self.workspace = workspace
        self.environments = {}
        self.seconds = {}  # by program: what it takes unchanged
        self.known = sorted(self.read_targets(), key=lambda program: program.target)
        self.targets = [program.target for program in self.known]

    def read_targets(self):
        """From what CMake says of its targets."""
        replies = self.workspace.tree / "build/.cmake/api/v1/reply"
        for file in replies.glob("target-*.json"):
            target = json.loads(file.read_text())
            sources = [source["path"] for source in target.get("sources", [])]
            if target["type"] == "EXECUTABLE" and target["paths"]["source"].startswith("tests/") and \
                    any(source.endswith("Test.cpp") for source in sources):
                yield Program(target["name"], f"build/{target['artifacts'][0]['path']}", sources)

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
        return [each for each in (nearest, same_room, *in_parts(others)) if each]

    def mirror(self, program, stem):
        """The part of a program whose files are named after a source; None when it has none."""
        named = [source for source in program.sources if re.fullmatch(stem + r"([A-Z]\w*)?Test", source.stem)]
        if not named:
            return None
        if len([source for source in program.sources if source.stem.endswith("Test")]) == len(named):
            return program
        texts = [(self.workspace.tree / source).read_text() for source in named]
        suites = sorted({suite for text in texts for suite in re.findall(r"^(?:TYPED_)?TEST(?:_F|_P)?\((\w+)", text, re.M)})
        return Program(program.target, program.path, program.sources, suites)

    def environment_of(self, program):
        """The variables that a program's tests are given, as ctest knows them since it was built."""
        if program.target not in self.environments:
            known = json.loads(self.workspace.output(["ctest", "--test-dir", "build", "--show-only=json-v1", "-R",
                                                      rf"^{program.target}\."]))
            given = [value for test in known["tests"][:1] for each in test["properties"]
                     if each["name"] == "ENVIRONMENT" for value in each["value"]]
            self.environments[program.target] = dict(value.split("=", 1) for value in given)
        return self.environments[program.target]

    def failure_of(self, program):
        """What failed in a program; None when it passed."""
        usual = self.seconds.get(program.key(), SECONDS)
        start = time.monotonic()
        status, said = self.workspace.run(program.command(), 10 * usual + SECONDS, self.environment_of(program))
        if status == 0:
            self.seconds.setdefault(program.key(), time.monotonic() - start)
            return None
        return f"{program.target}: {reason(status, said)}"

    def whole_failure(self):
        """What failed of the tests of the whole provider that are programs of other kinds."""
        status, said = self.workspace.run(["ctest", "--test-dir", "build", "-R", WHOLE, "--stop-on-failure"], 1200)
        return None if status == 0 else reason(status, said)


def in_parts(programs, size=8):
    return [programs[first:first + size] for first in range(0, len(programs), size)]


def reason(status, said):
    if status is None:
        return "no end"
    failed = re.search(r"\[  FAILED  \] (\S+)", said) or re.search(r"Test +#\d+: (\S+) .*(?:Failed|Exception|Timeout)", said)
    if failed:
        return failed.group(1).rstrip(",")
    return f"signal {-status}" if status < 0 else f"exit {status}"
