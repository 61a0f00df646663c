"""A C++ source as clang counts it, and the mutants found in it."""
import bisect
import dataclasses
import pathlib
import re

LONGEST = 200  # of a change, as it is printed


@dataclasses.dataclass(frozen=True, order=True)
class Mutant:
    """One small mistake: what stands between two offsets is replaced."""
    file: str
    line: int
    start: int
    end: int
    kind: str
    new: str
    old: str
    function: str
    last_line: int
    # The expression, statement or rows that a process may have either way, from start to end; none where the mistake has to
    # be there when it is compiled.
    places: tuple[tuple[int, int], ...] = dataclasses.field(default=(), compare=False)
    type: str = dataclasses.field(default="", compare=False)  # of the rows, or of the object that a declaration makes
    # What stands in its way there: changes (start, end, new) of a declaration that is computed when compiling.
    loosened: tuple[tuple[int, int, str], ...] = dataclasses.field(default=(), compare=False)

    def apply(self, text):
        return text[:self.start] + self.new + text[self.end:]

    def change(self):
        return f"{' '.join(self.old.split())} -> {' '.join(self.new.split()) or 'nothing'}"

    def __str__(self):
        change = self.change() if len(self.change()) <= LONGEST else f"{self.change()[:LONGEST]}..."
        return f"{self.file}:{self.line}: {self.function}: {self.kind}: {change}"


class Source:
    """A file's text, a character for each byte, as clang counts in bytes."""

    def __init__(self, path):
        self.name = str(path)
        self.text = read(path)
        self.line_starts = [0] + [found.end() for found in re.finditer("\n", self.text)]
        self.mutants = set()
        self.loosened = []  # what has to change so that what is being read is computed when running

    def line_of(self, offset):
        return bisect.bisect_right(self.line_starts, offset)

    def add(self, function, kind, start, end, new, *places, type=""):
        old = self.text[start:end]
        if old != new:
            self.mutants.add(Mutant(self.name, self.line_of(start), start, end, kind, new, old, function, self.line_of(end),
                                    places, type, tuple(self.loosened)))

    def holds(self, node):
        """Whether a node stands here, and not in a file that is included."""
        return node.location.file is not None and node.location.file.name == self.name

    def text_of(self, node):
        return self.text[start_of(node):end_of(node)]

    def operator_of(self, operands):
        """What stands between two operands, also of an overloaded operator, and where."""
        if len(operands) not in (2, 3):
            return None, 0
        start, end = end_of(operands[0]), start_of(operands[-1])
        between = self.text[start:end]
        return between.strip(), start + len(between) - len(between.lstrip())


def read(path):
    return pathlib.Path(path).read_bytes().decode("latin-1")


def write(path, text):
    pathlib.Path(path).write_bytes(text.encode("latin-1"))


def start_of(node):
    return node.extent.start.offset


def end_of(node):
    return node.extent.end.offset


def place_of(node):
    return start_of(node), end_of(node)


def full_name(node):
    """A declaration's name with those of its namespaces and classes."""
    names = []
    while node is not None and node.spelling != getattr(node.translation_unit, "spelling", None):
        if node.spelling:
            names.append(re.sub(r"<.*>$", "", node.spelling))
        node = node.semantic_parent
    return "::".join(reversed(names))
