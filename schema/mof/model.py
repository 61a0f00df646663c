"""What a MOF file declares, as plain values."""

from dataclasses import dataclass, field
from typing import Any, Dict, List, Optional

INTEGERS = {
    "uint8": (0, 2**8 - 1), "uint16": (0, 2**16 - 1), "uint32": (0, 2**32 - 1), "uint64": (0, 2**64 - 1),
    "sint8": (-2**7, 2**7 - 1), "sint16": (-2**15, 2**15 - 1), "sint32": (-2**31, 2**31 - 1),
    "sint64": (-2**63, 2**63 - 1),
}
TYPES = set(INTEGERS) | {"boolean", "char16", "real32", "real64", "string", "datetime"}


@dataclass(frozen=True)
class Place:
    """Where something stands."""
    file: str
    line: int

    def __str__(self) -> str:
        return f"{self.file}:{self.line}"


class MofError(Exception):
    """One thing wrong, with its place."""

    def __init__(self, place: Place, text: str):
        super().__init__(f"{place}: {text}")
        self.place = place
        self.text = text


@dataclass(frozen=True)
class Type:
    """An intrinsic type's name in lower case, or the name of a class that is referred to."""
    name: str
    array: bool = False
    reference: bool = False

    def __str__(self) -> str:
        return self.name + (" ref" if self.reference else "") + ("[]" if self.array else "")


@dataclass
class Qualifier:
    name: str
    value: Any  # True where none is written
    place: Place


class Qualified:
    """What may carry qualifiers; their names compare without regard to case."""
    qualifiers: List[Qualifier]

    def qualifier(self, name: str) -> Any:
        """The qualifier's value, or None."""
        for qualifier in self.qualifiers:
            if qualifier.name.lower() == name.lower():
                return qualifier.value
        return None

    def is_marked(self, name: str) -> bool:
        return self.qualifier(name) is True


@dataclass
class Property(Qualified):
    name: str
    type: Type
    place: Place
    qualifiers: List[Qualifier] = field(default_factory=list)
    default: Any = None


@dataclass
class Parameter(Qualified):
    name: str
    type: Type
    place: Place
    qualifiers: List[Qualifier] = field(default_factory=list)


@dataclass
class Method(Qualified):
    name: str
    type: Type
    place: Place
    parameters: List[Parameter] = field(default_factory=list)
    qualifiers: List[Qualifier] = field(default_factory=list)


@dataclass
class Class(Qualified):
    name: str
    superclass: Optional[str]
    place: Place
    properties: List[Property] = field(default_factory=list)
    methods: List[Method] = field(default_factory=list)
    qualifiers: List[Qualifier] = field(default_factory=list)

    @property
    def association(self) -> bool:
        return self.is_marked("Association")


class Schema:
    """Classes in the order of their declaration, by name without regard to case."""

    def __init__(self) -> None:
        self._classes: Dict[str, Class] = {}

    def __iter__(self):
        return iter(self._classes.values())

    def add(self, declared: Class) -> None:
        self._classes[declared.name.lower()] = declared

    def find(self, name: Optional[str]) -> Optional[Class]:
        return self._classes.get(name.lower()) if name else None

    def ancestors(self, declared: Class):
        """The superclasses, nearest first."""
        above = self.find(declared.superclass)
        while above is not None:
            yield above
            above = self.find(above.superclass)

    def is_a(self, name: str, ancestor: str) -> bool:
        declared = self.find(name)
        if declared is None:
            return False
        return any(c.name.lower() == ancestor.lower() for c in [declared, *self.ancestors(declared)])

    def inherited(self, declared: Class, kind: str, name: str):
        """The nearest superclass's property or method (`kind` is the list's name) of that name, or None."""
        for above in self.ancestors(declared):
            for feature in getattr(above, kind):
                if feature.name.lower() == name.lower():
                    return feature
        return None

    def is_key(self, declared: Class, prop: Property) -> bool:
        """Whether the property is a key, by its own mark or that of a declaration that it overrides."""
        name = prop.name.lower()
        return prop.is_marked("Key") or any(
            other.is_marked("Key")
            for above in self.ancestors(declared) for other in above.properties if other.name.lower() == name)

    def keys(self, declared: Class) -> List[str]:
        """The names of all keys, superclasses' first."""
        names: List[str] = []
        for c in [*reversed(list(self.ancestors(declared))), declared]:
            names += [p.name for p in c.properties
                      if p.is_marked("Key") and p.name.lower() not in [n.lower() for n in names]]
        return names
