"""Which mutants are tried: all of some files, those of changed lines, or some at random."""
import json
import pathlib
import random
import re
import shlex
import subprocess

import generator
from programs import ROOMS

FEW, PART = 25, 100  # mutants of a file, and of a part, that are chosen at random
TAKEN = re.compile(r"-(I|isystem|D|U|std=)(.*)")


class Choice:
    def __init__(self, root, build):
        self.root = root
        self.build = build
        self.made = {}

    def files(self):
        listed = subprocess.run(["git", "ls-files", "--cached", "--others", "--exclude-standard", *ROOMS], cwd=self.root,
                                check=True, stdout=subprocess.PIPE, text=True).stdout.splitlines()
        names = {name for name in listed if name.endswith((".cpp", ".h")) and (self.root / name).is_file()}
        return sorted(names, key=lambda name: (ROOMS.index(name.split("/")[0]), name))

    def arguments_of(self, file):
        """How a file is compiled; a header as the nearest source is, with the include directories of all."""
        commands = {pathlib.Path(each["file"]): list(taken(each["command"])) for each in
                    json.loads((self.build / "compile_commands.json").read_text())}
        nearest = max(commands, key=lambda path: (path == self.root / file, shared_parts(path, self.root / file), str(path)))
        yield from commands[nearest]
        yield from sorted({word for words in commands.values() for word in words if word.startswith(("-I", "-isystem"))})

    def mutants_of(self, file):
        if file not in self.made:
            self.made[file] = generator.mutants_of(self.root / file, list(self.arguments_of(file)), file)
        return self.made[file]

    def all_of(self, files):
        return [mutant for file in files for mutant in self.mutants_of(file)]

    def changed_since(self, revision):
        """The mutants of lines that differ from a commit, those of files that git does not know yet among them."""
        lines = self.changed_lines(revision)
        known = subprocess.run(["git", "ls-files", *ROOMS], cwd=self.root, check=True, stdout=subprocess.PIPE, text=True)
        new = set(self.files()) - set(known.stdout.splitlines())
        return [mutant for file in self.files() if file in lines or file in new for mutant in self.mutants_of(file)
                if file in new or lines[file].intersection(range(mutant.line, mutant.last_line + 1))]

    def changed_lines(self, revision):
        diff = subprocess.run(["git", "diff", "--unified=0", "--no-color", "--no-ext-diff", "--relative", revision, "--",
                               *ROOMS], cwd=self.root, check=True, stdout=subprocess.PIPE, errors="replace").stdout
        lines, file = {}, None
        for line in diff.splitlines():
            if line.startswith("+++ "):
                file = line[6:] if line.startswith("+++ b/") else None
            hunk = re.match(r"@@ -\S+ \+(\d+)(?:,(\d+))? @@", line)
            if hunk and file:
                first, count = int(hunk[1]), int(hunk[2] or 1)
                lines.setdefault(file, set()).update(range(first, first + count))
        return lines

    def at_random(self, seed, files, count=None):
        """Parts, each of a few mutants of a few files, until so many are chosen or all files were; no file comes twice, and a
        long one is the likelier to come early."""
        numbers = random.Random(seed)
        left = {file: len((self.root / file).read_bytes()) for file in files}
        part, open_count = [], count or sum(left.values())
        while left and open_count:
            file, = numbers.choices(list(left), list(left.values()))
            del left[file]
            some = self.mutants_of(file)
            part += numbers.sample(some, min(len(some), FEW, PART - len(part), open_count - len(part)))
            if len(part) in (PART, open_count):
                yield part
                part, open_count = [], open_count - len(part)
        if part:
            yield part


def taken(command):
    """Those of a command's words that say how a source is read."""
    words = shlex.split(command)
    for word, value in zip(words, words[1:]):
        found = TAKEN.fullmatch(word)
        if found:
            yield word if found[2] else word + value


def shared_parts(one, other):
    return next((count for count, (a, b) in enumerate(zip(one.parts, other.parts)) if a != b), 0)
