"""What a MOF compiler checks of class declarations, and what we ask of our own beyond that."""

from typing import Iterable, List

from .model import INTEGERS, Class, Method, MofError, Place, Property, Qualified, Schema, Type
from .qualifiers import STANDARD, fits

_SCOPE_NAMES = {"c": "a class", "a": "an association", "p": "a property", "r": "a reference", "m": "a method",
                "i": "a parameter"}


class Checker:
    """Takes classes one after the other into a schema and notes everything that is wrong with them."""

    def __init__(self) -> None:
        self.schema = Schema()
        self.errors: List[MofError] = []

    def add(self, classes: Iterable[Class], ours: bool = True) -> None:
        """`ours` asks for a description and a version everywhere, and refuses what only the standard's files may do."""
        for declared in classes:
            if self._may_be_declared(declared):
                self.schema.add(declared)
                self._check(declared, ours)

    def _wrong(self, place: Place, text: str) -> None:
        self.errors.append(MofError(place, text))

    def _may_be_declared(self, declared: Class) -> bool:
        before = self.schema.find(declared.name)
        if before is not None:
            self._wrong(declared.place, f"class {declared.name} is declared already at {before.place}")
            return False
        if declared.superclass is not None and self.schema.find(declared.superclass) is None:
            self._wrong(declared.place, f"superclass {declared.superclass} of {declared.name} is not declared")
            return False
        return True

    def _check(self, declared: Class, ours: bool) -> None:
        prefix, mark, rest = declared.name.partition("_")
        if not (prefix and mark and rest):
            self._wrong(declared.place, f"class name {declared.name} lacks a schema's prefix")
        if ours and prefix.upper() == "CIM":
            self._wrong(declared.place, f"class {declared.name} is one of the standard's")
        self._check_qualifiers(declared, "a" if declared.association else "c", declared.place, declared.name)
        self._check_association(declared)
        self._check_names(declared)
        for prop in declared.properties:
            self._check_property(declared, prop, ours)
        for method in declared.methods:
            self._check_method(declared, method)
        if not self.schema.keys(declared) and not declared.is_marked("Abstract") and ours:
            self._wrong(declared.place, f"class {declared.name} has no key")
        if ours:
            self._check_ours(declared)

    def _check_association(self, declared: Class) -> None:
        marks = [q.name.lower() for q in declared.qualifiers]
        if declared.association and marks[0] != "association":
            self._wrong(declared.place, f"Association is not the first qualifier of {declared.name}")
        above = self.schema.find(declared.superclass)
        if above is not None and above.association != declared.association:
            self._wrong(declared.place, f"{declared.name} and its superclass {above.name} are not both associations")
        line = [declared, *self.schema.ancestors(declared)]
        references = {p.name.lower() for c in line for p in c.properties if p.type.reference}
        if declared.association and len(references) < 2:
            self._wrong(declared.place, f"association {declared.name} has fewer than two references")
        if not declared.association and references:
            self._wrong(declared.place, f"class {declared.name} has references and is no association")

    def _check_names(self, declared: Class) -> None:
        seen = {}
        for feature in [*declared.properties, *declared.methods]:
            name = feature.name.lower()
            if name in seen:
                self._wrong(feature.place, f"{declared.name}.{feature.name} is declared already at {seen[name]}")
            seen.setdefault(name, feature.place)

    def _check_qualifiers(self, feature: Qualified, scope: str, place: Place, name: str) -> None:
        for qualifier in feature.qualifiers:
            known = STANDARD.get(qualifier.name.lower())
            if known is None:
                self._wrong(qualifier.place, f"unknown qualifier {qualifier.name} on {name}")
                continue
            kind, scopes = known
            if scope not in scopes:
                self._wrong(qualifier.place, f"{qualifier.name} may not stand on {_SCOPE_NAMES[scope]}, as {name} is")
            if not fits(kind, qualifier.value):
                self._wrong(qualifier.place, f"{qualifier.name} of {name} takes a {kind}")

    def _check_value_map(self, feature, name: str) -> None:
        numbers, texts = feature.qualifier("ValueMap"), feature.qualifier("Values")
        if numbers is None and texts is None:
            return
        if not isinstance(numbers, list) or not isinstance(texts, list) or len(numbers) != len(texts):
            self._wrong(feature.place, f"ValueMap and Values of {name} do not pair")
            return
        if feature.type.name in INTEGERS:
            for number in numbers:
                if not _is_range(number, feature.type):
                    self._wrong(feature.place, f"'{number}' in the ValueMap of {name} is no {feature.type.name}")
        if len(set(numbers)) != len(numbers):
            self._wrong(feature.place, f"a value stands twice in the ValueMap of {name}")

    def _check_reference(self, kind: Type, place: Place, name: str) -> None:
        if not kind.reference:
            return
        if self.schema.find(kind.name) is None:
            self._wrong(place, f"{name} refers to {kind.name}, which is not declared")

    def _check_property(self, declared: Class, prop: Property, ours: bool) -> None:
        name = f"{declared.name}.{prop.name}"
        self._check_qualifiers(prop, "r" if prop.type.reference else "p", prop.place, name)
        self._check_value_map(prop, name)
        self._check_reference(prop.type, prop.place, name)
        if prop.type.reference and prop.type.array:
            self._wrong(prop.place, f"reference {name} is an array")
        if prop.default is not None and not _is_default(prop.default, prop.type):
            self._wrong(prop.place, f"the default of {name} is no {prop.type}")
        inherited = self.schema.inherited(declared, "properties", prop.name)
        self._check_override(prop, inherited, name)
        if inherited is not None and not self._narrows(prop.type, inherited.type):
            self._wrong(prop.place, f"{name} is {prop.type}, but {inherited.type} in a superclass")
        self._check_key(declared, prop, inherited, ours)

    def _check_override(self, feature, inherited, name: str) -> None:
        override = feature.qualifier("Override")
        if inherited is None and override is not None:
            self._wrong(feature.place, f"{name} overrides what no superclass declares")
        if inherited is not None and override is None:
            self._wrong(feature.place, f"{name} is inherited and declared again without Override")
        if isinstance(override, str) and override.lower() != feature.name.lower():
            self._wrong(feature.place, f"{name} overrides {override}, which is named otherwise")

    def _narrows(self, kind: Type, inherited: Type) -> bool:
        if kind.reference and inherited.reference:
            return kind.array == inherited.array and self.schema.is_a(kind.name, inherited.name)
        return kind == inherited

    def _check_key(self, declared: Class, prop: Property, inherited, ours: bool) -> None:
        if not prop.is_marked("Key"):
            return
        name = f"{declared.name}.{prop.name}"
        if prop.type.array:
            self._wrong(prop.place, f"key {name} is an array")
        above = self.schema.find(declared.superclass)
        keys = self.schema.keys(above) if above is not None else []
        if ours and prop.name.lower() in [k.lower() for k in keys]:
            self._wrong(prop.place, f"{name} redefines an inherited key")
        elif ours and keys:
            self._wrong(prop.place, f"{name} adds a key to those of {declared.superclass}")

    def _check_method(self, declared: Class, method: Method) -> None:
        name = f"{declared.name}.{method.name}"
        self._check_qualifiers(method, "m", method.place, name)
        self._check_value_map(method, name)
        if method.type.reference or method.type.array:
            self._wrong(method.place, f"{name} returns {method.type}")
        seen = set()
        for parameter in method.parameters:
            full = f"{name}({parameter.name})"
            self._check_qualifiers(parameter, "i", parameter.place, full)
            self._check_value_map(parameter, full)
            self._check_reference(parameter.type, parameter.place, full)
            if parameter.name.lower() in seen:
                self._wrong(parameter.place, f"parameter {full} stands there twice")
            seen.add(parameter.name.lower())
            if parameter.qualifier("In") is None and parameter.qualifier("Out") is None:
                self._wrong(parameter.place, f"{full} is neither In nor Out")
        inherited = self.schema.inherited(declared, "methods", method.name)
        self._check_override(method, inherited, name)
        if inherited is not None and _signature(method) != _signature(inherited):
            self._wrong(method.place, f"{name} differs from the method that it overrides, at {inherited.place}")

    def _check_ours(self, declared: Class) -> None:
        version = declared.qualifier("Version")
        if not isinstance(version, str) or len([p for p in version.split(".") if p.isdigit()]) != 3:
            self._wrong(declared.place, f"class {declared.name} has no version of three numbers")
        for what, name in _described(declared):
            if not what.qualifier("Description"):
                self._wrong(what.place, f"{name} has no description")


def _described(declared: Class):
    yield declared, declared.name
    for prop in declared.properties:
        yield prop, f"{declared.name}.{prop.name}"
    for method in declared.methods:
        yield method, f"{declared.name}.{method.name}"
        for parameter in method.parameters:
            yield parameter, f"{declared.name}.{method.name}({parameter.name})"


def _signature(method: Method):
    def is_in(parameter) -> bool:
        return parameter.qualifier("In") is not False
    return (method.type, [(p.name.lower(), p.type, is_in(p), p.is_marked("Out")) for p in method.parameters])


def _is_range(text: str, kind: Type) -> bool:
    """A number of the type, or an open or closed range of two."""
    low, high = INTEGERS[kind.name]
    ends = [end for end in text.split("..") if end != ""]
    return text.count("..") <= 1 and all(e.lstrip("-").isdigit() and low <= int(e) <= high for e in ends)


def _is_default(value, kind: Type) -> bool:
    if kind.array:
        return isinstance(value, list) and all(_is_default(v, Type(kind.name)) for v in value)
    if kind.name in INTEGERS:
        low, high = INTEGERS[kind.name]
        return isinstance(value, int) and not isinstance(value, bool) and low <= value <= high
    if kind.name == "boolean":
        return isinstance(value, bool)
    if kind.name.startswith("real"):
        return isinstance(value, (int, float)) and not isinstance(value, bool)
    return isinstance(value, str)
