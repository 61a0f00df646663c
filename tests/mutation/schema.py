"""All mutants of some sources built at once; each process has one of them, or none.

A comparison then reads `(vkMutant(17) ? (a <= b) : (a < b))`, and a statement `{ if (!vkMutant(18)) { step(); } }`. What
says constexpr does without it where it can, so that its mutants can be chosen, too. Which one a process has is its limit
of resident memory: Linux ignores that limit, and it reaches every child whatever becomes of the environment. Where it is 0
the process has none and notes the mutants whose places it reaches.

What cannot be chosen while running, because the compiler has to know it, is found by what the compiler complains about.
"""
import collections
import contextlib
import re

from source import read, write
from statements import GUARD, NEGATION, REMOVED, SWAPPED
from workspace import Failure

# Mutants are built with warnings as errors, too; these are what a mistake, or a choice, brings with it.
UNWARNED = ("unused-variable unused-but-set-variable unused-but-set-parameter unused-parameter unused-function unused-value "
            "return-type conversion sign-compare type-limits tautological-compare bool-compare bool-operation "
            "int-in-bool-context parentheses implicit-fallthrough empty-body maybe-uninitialized uninitialized array-bounds "
            "stringop-overflow stringop-overread stringop-truncation restrict nonnull dangling-else misleading-indentation "
            "shift-count-overflow overflow switch format-truncation format-overflow unused-local-typedefs infinite-recursion "
            "duplicated-branches duplicated-cond logical-op narrowing extra address shadow pedantic")
PRELUDE = "#pragma once\n" + "".join(f'#pragma GCC diagnostic ignored "-W{each}"\n' for each in UNWARNED.split()) + """
#include <new>

#include <sys/syscall.h>
extern "C" long vkCall(long, ...) __asm__("syscall");
static long vkChosen = -1;
static unsigned char* vkReached;

__attribute__((unused, noinline, cold)) static void vkChoose() {
    unsigned long limits[2] = {0, 0};
    vkCall(SYS_prlimit64, 0, 5 /* RLIMIT_RSS */, 0, limits);
    if (limits[0] == 0) {
        int file = (int)vkCall(SYS_openat, -100, "@REACHED@", 2);
        // At one address for all sources, so that libraries that are loaded again do not leave a map each time.
        long map = file < 0 ? -1 : vkCall(SYS_mmap, 1L << 45, @SIZE@, 3, 1 | 0x10 /* MAP_FIXED */, file, 0);
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

template <class Type>
using vkRow = Type;

/// An object that is there unless a mutant removed its declaration.
template <class Type>
class vkUnless {
public:
    template <class... Values>
    explicit vkUnless(bool isRemoved, Values&&... values) : isThere(!isRemoved) {
        if (isThere) ::new (&object) Type(static_cast<Values&&>(values)...);
    }
    ~vkUnless() noexcept(noexcept(object.~Type())) {
        if (isThere) object.~Type();
    }

private:
    const bool isThere;
    union {
        Type object;
    };
};
"""
PRELUDE_FILE = "build/mutants.h"


def instrumented(text, numbers):
    """A source in which each of the mutants, numbers by mutant, can be chosen; its lines stay where they are."""
    places, loosened = collections.defaultdict(list), {}
    for mutant in numbers:
        for place in mutant.places:
            places[place].append(mutant)
        loosened |= {(start, end): new for start, end, new in mutant.loosened}
    left = collections.deque(sorted({*places, *loosened}, key=lambda place: (place[0], -place[1])))

    def rendered(start, end):
        parts = []
        while left and left[0][0] < end:
            place = left.popleft()
            parts += [text[start:place[0]], loosened[place] if place in loosened else either(place, rendered(*place))]
            start = place[1]
        return "".join(parts) + text[start:end]

    def either(place, usual):
        for mutant in reversed(places[place]):
            usual = either_way(text, mutant, f"vkMutant({numbers[mutant]})", place, usual)
        return usual

    return rendered(0, len(text))


def either_way(text, mutant, chosen, place, usual):
    """What usually stands in a place, or what a mutant has there."""
    if mutant.kind == REMOVED and mutant.type:
        return unless(chosen, usual)
    if mutant.kind == REMOVED:
        return f"{{ if (!{chosen}) {{ {usual} }} }}"
    if mutant.kind == SWAPPED:
        other, = (text[slice(*other)] for other in mutant.places if other != place)
        return f"({chosen} ? {row(mutant.type, on_one_line(other))} : {row(mutant.type, usual)})"
    truth = "!!" if mutant.kind == NEGATION else ""
    return f"({chosen} ? {truth}({changed(text, mutant)}) : {truth}({usual}))"


def unless(chosen, declaration):
    guard = GUARD.fullmatch(declaration)
    values = (guard["values"] or guard["braced"] or "").strip()
    return f"vkUnless<{guard['type']}> {guard['name']}({chosen}{values and ', '}{values});"


def row(row_type, text):
    return f"vkRow<{row_type}>{text if text.startswith('{') else f'{{{text}}}'}"


def changed(text, mutant):
    """What stands in a mutant's place when it is chosen, on one line."""
    (start, end), = mutant.places
    return on_one_line(f"{text[start:mutant.start]}{mutant.new}{text[mutant.end:end]}")


def on_one_line(text):
    return text.replace("\n", " ")


def can_be_chosen(text, mutant):
    return bool(mutant.places) and (mutant.kind == REMOVED or not any("//" in text[slice(*place)] for place in mutant.places))


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
        """Whether there were mutants on the lines that a compiler complained about; they are not to be chosen any more. First
        those whose declarations have lost what another place may need; at last all of a function, of whose end it speaks."""
        anywhere, errors = self.lines_in(said, r"[:,]"), self.lines_in(said, r":\d+: error:")
        wrong = self.on_lines(anywhere, lambda mutant: [place[:2] for place in mutant.loosened]) or \
            self.on_lines(errors, lambda mutant: mutant.places) or self.on_lines(anywhere, lambda mutant: mutant.places) or \
            self.of_functions_before(errors)
        for mutant in wrong:
            del self.numbers[mutant]
        return bool(wrong)

    def lines_in(self, said, behind):
        found = re.findall(rf"{re.escape(str(self.copy.root))}/([^:\s]+):(\d+){behind}", said)
        return {(file, int(line)) for file, line in found}

    def on_lines(self, lines, places_of):
        return [mutant for mutant in self.numbers
                if any((mutant.file, line) in lines for place in places_of(mutant) for line in self.lines_of(mutant.file, place))]

    def of_functions_before(self, lines):
        last = [max((mutant for mutant in self.numbers if mutant.file == file and mutant.line <= line), default=None)
                for file, line in lines]
        functions = {(mutant.file, mutant.function) for mutant in last if mutant}
        return [mutant for mutant in self.numbers if (mutant.file, mutant.function) in functions]

    def lines_of(self, file, place):
        first = self.texts[file].count("\n", 0, place[0]) + 1
        return range(first, first + self.texts[file].count("\n", *place) + 1)


def write_changed(path, text):
    if not path.is_file() or read(path) != text:
        write(path, text)
