"""What a MOF file declares, as plain values."""

from dataclasses import dataclass, field
from typing import Any, Dict, List, NamedTuple, Optional

INTEGERS = {f"uint{bits}": (0, 2**bits - 1) for bits in (8, 16, 32, 64)}
INTEGERS.update({f"sint{bits}": (-2**(bits - 1), 2**(bits - 1) - 1) for bits in (8, 16, 32, 64)})
TYPES = set(INTEGERS) | {"boolean", "char16", "real32", "real64", "string", "datetime"}


class Place(NamedTuple):
    """Where something stands."""
    file: str
    line: int

    def __str__(self) -> str:
        return f"{self.file}:{self.line}"


class MofError(Exception):
    """One thing wrong, with its place."""

    def __init__(self, place: Place, text: str):
        super().__init__(f"{place}: {text}")


class Type(NamedTuple):
    """An intrinsic type's name in lower case, or the name of a class that is referred to."""
    name: str
    array: bool = False
    reference: bool = False

    def __str__(self) -> str:
        return self.name + (" ref" if self.reference else "") + ("[]" if self.array else "")


class Qualifier(NamedTuple):
    name: str
    value: Any  # True where none is written
    place: Place


@dataclass
class Feature:
    """A property, a parameter, or a method with its own; names, of qualifiers too, compare without regard to case."""
    name: str
    type: Optional[Type]
    place: Place
    qualifiers: Dict[str, Qualifier] = field(default_factory=dict)
    default: Any = None
    parameters: List["Feature"] = field(default_factory=list)

    def qualifier(self, name: str) -> Any:
        """The qualifier's value, or None."""
        found = self.qualifiers.get(name.lower())
        return found.value if found else None

    def is_marked(self, name: str) -> bool:
        return self.qualifier(name) is True

    def is_named(self, name: str) -> bool:
        return self.name.lower() == name.lower()


@dataclass
class Class(Feature):
    superclass: Optional[str] = None
    properties: List[Feature] = field(default_factory=list)
    methods: List[Feature] = field(default_factory=list)

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

    def line(self, declared: Optional[Class]):
        """A class and its superclasses, nearest first."""
        while declared is not None:
            yield declared
            declared = self.find(declared.superclass)

    def inherited(self, declared: Class, kind: str, name: str):
        """The declarations of a property or method (`kind` is the list's name) in the superclasses, nearest first."""
        above = self.line(self.find(declared.superclass))
        return [feature for c in above for feature in getattr(c, kind) if feature.is_named(name)]

    def is_key(self, declared: Class, prop: Feature) -> bool:
        """Whether the property is a key, by its own mark or that of a declaration that it overrides."""
        return any(each.is_marked("Key") for each in [prop, *self.inherited(declared, "properties", prop.name)])

    def keys(self, declared: Optional[Class]) -> List[str]:
        """The names of all keys, superclasses' first."""
        names: Dict[str, str] = {}
        for c in reversed(list(self.line(declared))):
            for prop in filter(lambda each: each.is_marked("Key"), c.properties):
                names.setdefault(prop.name.lower(), prop.name)
        return list(names.values())
