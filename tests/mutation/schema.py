"""All mutants of some sources built at once; each process has one of them, or none.

A comparison then reads `(vkMutant(17) ? (a <= b) : (a < b))`, and a statement `{ if (!vkMutant(18)) { step(); } }`. Which
one a process has is its limit of resident memory: Linux ignores that limit, and it reaches every child whatever becomes of
the environment. Where it is 0 the process has none and notes the mutants whose places it reaches.

What cannot be chosen while running, because the compiler has to know it, is found by what the compiler complains about.
"""
import collections
import contextlib
import re

from source import read, write
from statements import NEGATION, REMOVED
from workspace import Failure

# Mutants are built with warnings as errors, too; these are what a mistake, or a choice, brings with it.
UNWARNED = ("unused-variable unused-but-set-variable unused-but-set-parameter unused-parameter unused-function unused-value "
            "return-type conversion sign-compare type-limits tautological-compare bool-compare bool-operation "
            "int-in-bool-context parentheses implicit-fallthrough empty-body maybe-uninitialized uninitialized array-bounds "
            "stringop-overflow stringop-overread stringop-truncation restrict nonnull dangling-else misleading-indentation "
            "shift-count-overflow overflow switch format-truncation format-overflow unused-local-typedefs infinite-recursion "
            "duplicated-branches duplicated-cond logical-op narrowing extra address shadow pedantic")
PRELUDE = "#pragma once\n" + "".join(f'#pragma GCC diagnostic ignored "-W{each}"\n' for each in UNWARNED.split()) + """
#include <sys/syscall.h>
extern "C" long vkCall(long, ...) __asm__("syscall");
static long vkChosen = -1;
static unsigned char* vkReached;

__attribute__((unused, noinline, cold)) static void vkChoose() {
    unsigned long limits[2] = {0, 0};
    vkCall(SYS_prlimit64, 0, 5 /* RLIMIT_RSS */, 0, limits);
    if (limits[0] == 0) {
        int file = (int)vkCall(SYS_openat, -100, "@REACHED@", 2);
        long map = file < 0 ? -1 : vkCall(SYS_mmap, 0, @SIZE@, 3, 1, file, 0);
        if (file >= 0) vkCall(SYS_close, file);
        if (map != -1) vkReached = (unsigned char*)map;
    }
    vkChosen = limits[0] < @SIZE@ ? (long)limits[0] : 0;
}

__attribute__((unused)) static inline int vkMutant(int number) {
    if (vkChosen < 0) vkChoose();
    if (vkReached) vkReached[number] = 1;
    return vkChosen == number;
}
"""
PRELUDE_FILE = "build/mutants.h"


def instrumented(text, numbers):
    """A source in which each of the mutants, numbers by mutant, can be chosen; its lines stay where they are."""
    places = collections.defaultdict(list)
    for mutant in numbers:
        places[mutant.place].append(mutant)
    left = collections.deque(sorted(places, key=lambda place: (place[0], -place[1])))

    def rendered(start, end):
        parts = []
        while left and left[0][0] < end:
            place = left.popleft()
            parts += [text[start:place[0]], either(place, rendered(*place))]
            start = place[1]
        return "".join(parts) + text[start:end]

    def either(place, usual):
        for mutant in reversed(places[place]):
            if mutant.kind == REMOVED:
                usual = f"{{ if (!vkMutant({numbers[mutant]})) {{ {usual} }} }}"
            else:
                truth = "!!" if mutant.kind == NEGATION else ""
                usual = f"(vkMutant({numbers[mutant]}) ? {truth}({changed(text, mutant)}) : {truth}({usual}))"
        return usual

    return rendered(0, len(text))


def changed(text, mutant):
    """What stands in a mutant's place when it is chosen, on one line."""
    start, end = mutant.place
    return f"{text[start:mutant.start]}{mutant.new}{text[mutant.end:end]}".replace("\n", " ")


def can_be_chosen(text, mutant):
    return bool(mutant.place) and (mutant.kind == REMOVED or "//" not in text[slice(*mutant.place)])


class Schema:
    """In the copy, while it lasts."""

    def __init__(self, copy, mutants):
        self.copy = copy
        self.mutants = mutants
        self.texts = {file: read(copy.tree / file) for file in {mutant.file for mutant in mutants}}
        self.numbers = {mutant: number for number, mutant in enumerate(mutants, 1)
                        if can_be_chosen(self.texts[mutant.file], mutant)}
        self.size = len(mutants) + 1

    def __enter__(self):
        prelude = PRELUDE.replace("@REACHED@", str(self.copy.reached)).replace("@SIZE@", str(self.size))
        write_changed(self.copy.tree / PRELUDE_FILE, prelude)
        while True:
            self.write(self.texts)
            if not self.copy.build(["all"], "-k", "0"):
                return self
            if not self.give_up(self.copy.log.read_text(errors="replace")):
                raise Failure(f"the copy does not build with all mutants; see {self.copy.log}")

    def __exit__(self, *_):
        for file, text in self.texts.items():
            write_changed(self.copy.tree / file, text)

    def write(self, files):
        numbers = collections.defaultdict(dict)
        for mutant, number in self.numbers.items():
            numbers[mutant.file][mutant] = number
        for file in files:
            chosen = self.texts[file]
            if numbers[file]:
                chosen = self.head(file) + instrumented(chosen, numbers[file])
            write_changed(self.copy.tree / file, chosen)

    def head(self, file):
        return f'#include "{self.copy.root / PRELUDE_FILE}"\n#line 1 "{self.copy.root / file}"\n'

    @contextlib.contextmanager
    def edited(self, mutant):
        """While it lasts, the mutant stands in the copy alone: no other of its file can be chosen."""
        write(self.copy.tree / mutant.file, self.head(mutant.file) + mutant.apply(self.texts[mutant.file]))
        try:
            yield
        finally:
            self.write([mutant.file])

    def give_up(self, said):
        """Whether there were mutants on the lines that a compiler complained about; they are not to be chosen any more."""
        for complaint in (r"(\d+):\d+: error:", r"(\d+)[:,]"):
            found = re.findall(rf"{re.escape(str(self.copy.root))}/([^:\s]+):{complaint}", said)
            lines = {(file, int(line)) for file, line in found}
            wrong = [mutant for mutant in self.numbers
                     if any((mutant.file, line) in lines for line in self.lines_of(mutant))]
            for mutant in wrong:
                del self.numbers[mutant]
            if wrong:
                return True
        return False

    def lines_of(self, mutant):
        text = self.texts[mutant.file]
        first = text.count("\n", 0, mutant.place[0]) + 1
        return range(first, first + text.count("\n", *mutant.place) + 1)


def write_changed(path, text):
    if not path.is_file() or read(path) != text:
        write(path, text)
