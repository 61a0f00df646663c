"""The list of mutants that no test can notice."""
import pathlib

FILE = pathlib.Path(__file__).with_name("equivalent")


class Equivalents:
    def __init__(self, text):
        self.reasons = {}  # by function, kind and change; the change may be missing
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
        for entry, reason in self.reasons.items():
            if not reason:
                raise ValueError(f"no reason stands below {': '.join(filter(None, entry))}")

    @staticmethod
    def entries_of(mutant):
        return [(mutant.function, mutant.kind, ""), (mutant.function, mutant.kind, mutant.change())]

    def reason(self, mutant):
        """Why a mutant is equivalent; None when it is not in the list."""
        return next((self.reasons[entry] for entry in self.entries_of(mutant) if entry in self.reasons), None)

    def stale(self, mutants):
        """The entries that none of the mutants is found by."""
        used = {entry for mutant in mutants for entry in self.entries_of(mutant)}
        return [": ".join(filter(None, entry)) for entry in self.reasons if entry not in used]


def read():
    return Equivalents(FILE.read_text(encoding="utf-8"))
