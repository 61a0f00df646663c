"""The list of mutants that no test can notice."""
import pathlib
import re

FILE = pathlib.Path(__file__).with_name("equivalent")


class Equivalents:
    def __init__(self, text):
        self.reasons = {}  # by function, kind and change; the change may be missing, or a /regular expression/
        entry = None
        for number, line in enumerate(text.splitlines(), 1):
            if line.startswith(" ") and entry:
                self.reasons[entry] = f"{self.reasons[entry]} {line.strip()}".strip()
            elif line and not line.startswith("#"):
                function, _, rest = line.partition(": ")
                kind, _, change = rest.partition(": ")
                if not kind:
                    raise ValueError(f"{number}: not understood: {line}")
                entry = (function, kind, change)
                self.reasons[entry] = ""
            if entry and is_expression(entry[2]):
                try:
                    re.compile(entry[2][1:-1])
                except re.error as error:
                    raise ValueError(f"{number}: {entry[2]}: {error}") from error
        for entry, reason in self.reasons.items():
            if not reason:
                raise ValueError(f"no reason stands below {': '.join(filter(None, entry))}")

    def reason(self, mutant):
        """Why a mutant is equivalent; None when it is not in the list."""
        return next((reason for entry, reason in self.reasons.items() if covers(entry, mutant)), None)

    def stale(self, mutants):
        """The entries that none of the mutants is found by."""
        return [": ".join(filter(None, entry)) for entry in self.reasons if not any(covers(entry, each) for each in mutants)]


def is_expression(change):
    return len(change) > 1 and change.startswith("/") and change.endswith("/")


def covers(entry, mutant):
    function, kind, change = entry
    if (function, kind) != (mutant.function, mutant.kind):
        return False
    if is_expression(change):
        return re.search(change[1:-1], mutant.change()) is not None
    return change in ("", mutant.change())


def read():
    return Equivalents(FILE.read_text(encoding="utf-8"))
