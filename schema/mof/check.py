"""What a MOF compiler checks of class declarations, and what we ask of our own beyond that."""

from typing import Iterable, List, Optional, Tuple

from .model import INTEGERS, Class, Feature, MofError, Place, Schema, Type

# The standard qualifiers as DSP0004 spells them, by what they may stand on and the type of their value. c class,
# a association, p property, r reference, m method, i parameter.
_STANDARD = """
a boolean Aggregation Association
c boolean Exception
ca boolean Abstract Terminal
ca string UMLPackagePath Version
ca string[] ClassConstraint
caprmi boolean Experimental
caprmi string Description DisplayName
caprmi string[] Deprecated MappingStrings ModelCorrespondence
i boolean In Out
m string[] MethodConstraint
p string NullValue Propagated
p string[] Correlatable
pi string ArrayType
pm boolean Static
pmi boolean Counter DN EmbeddedObject Gauge IsPUnit OctetString
pmi integer MaxLen MaxValue MinLen MinValue
pmi string EmbeddedInstance PUnit Units
pmi string[] BitMap BitValues ValueMap Values
pr boolean Key Read Write
pr string[] PropertyConstraint
prm string Override
prmi boolean Required
r boolean Aggregate Weak
r integer Max Min
"""
_QUALIFIERS = {name.lower(): (scopes, kind) for scopes, kind, *names in map(str.split, _STANDARD.strip().splitlines())
               for name in names}
_SCOPES = {"c": "a class", "a": "an association", "p": "a property", "r": "a reference", "m": "a method",
           "i": "a parameter"}

# Each thing that may be wrong: whether it happened, and the words for it.
Complaint = Tuple[object, str]


class Checker:
    """Takes classes one after the other into a schema and notes everything that is wrong with them."""

    def __init__(self) -> None:
        self.schema = Schema()
        self.errors: List[MofError] = []

    def add(self, classes: Iterable[Class], ours: bool = True) -> None:
        """`ours` asks for a description and a version everywhere, and refuses what only the standard's files may do."""
        for declared in classes:
            name, superclass = declared.name, declared.superclass
            before, above = self.schema.find(name), self.schema.find(superclass)
            if before is not None:
                self._note(declared.place, [(True, f"class {name} is declared already at {before.place}")])
            elif superclass is not None and above is None:
                self._note(declared.place, [(True, f"superclass {superclass} of {name} is not declared")])
            else:
                self.schema.add(declared)
                self._check(declared, above, ours)

    def _note(self, place: Place, complaints: Iterable[Complaint]) -> None:
        self.errors += [MofError(place, text) for wrong, text in complaints if wrong]

    def _check(self, declared: Class, above: Optional[Class], ours: bool) -> None:
        self._note(declared.place, self._of_class(declared, above))
        if ours:
            self._note(declared.place, self._of_our_class(declared))
        seen = {}
        for feature, name, scope in _features(declared):
            self._check_qualifiers(feature, name, scope)
            self._note(feature.place, self._of_any(feature, name))
            self._note(feature.place, [(ours and not feature.qualifier("Description"), f"{name} has no description")])
            first = seen.setdefault(name.lower(), feature)
            if scope == "i":
                undirected = feature.qualifier("In") is None and feature.qualifier("Out") is None
                self._note(feature.place, [(first is not feature, f"parameter {name} stands there twice"),
                                           (undirected, f"{name} is neither In nor Out")])
            else:
                self._note(feature.place, [(first is not feature, f"{name} is declared already at {first.place}")])
            if scope == "m":
                self._note(feature.place, self._of_method(declared, feature, name))
            elif scope in "pr":
                self._note(feature.place, self._of_property(declared, feature, name))
                if feature.is_marked("Key"):
                    self._note(feature.place, self._of_key(above, feature, name, ours))

    def _of_class(self, declared: Class, above: Optional[Class]) -> Iterable[Complaint]:
        name, association = declared.name, declared.association
        prefix, mark, rest = name.partition("_")
        references = {p.name.lower() for c in self.schema.line(declared) for p in c.properties if p.type.reference}
        yield not (prefix and mark and rest), f"class name {name} lacks a schema's prefix"
        late = association and next(iter(declared.qualifiers)) != "association"
        yield late, f"Association is not the first qualifier of {name}"
        if above is not None:
            yield above.association != association, f"{name} and its superclass {above.name} are not both associations"
        yield association and len(references) < 2, f"association {name} has fewer than two references"
        yield not association and references, f"class {name} has references and is no association"

    def _of_our_class(self, declared: Class) -> Iterable[Complaint]:
        name, version = declared.name, declared.qualifier("Version")
        numbers = [part for part in version.split(".") if part.isdigit()] if isinstance(version, str) else []
        yield name.partition("_")[0].upper() == "CIM", f"class {name} is one of the standard's"
        yield not self.schema.keys(declared) and not declared.is_marked("Abstract"), f"class {name} has no key"
        yield len(numbers) != 3, f"class {name} has no version of three numbers"

    def _check_qualifiers(self, feature: Feature, name: str, scope: str) -> None:
        for qualifier in feature.qualifiers.values():
            scopes, kind = _QUALIFIERS.get(qualifier.name.lower(), (None, None))
            if scopes is None:
                self._note(qualifier.place, [(True, f"unknown qualifier {qualifier.name} on {name}")])
                continue
            on = f"{qualifier.name} may not stand on {_SCOPES[scope]}, as {name} is"
            fits = _is_value(qualifier.value, Type(kind.removesuffix("[]"), kind.endswith("[]")))
            takes = f"{qualifier.name} of {name} takes a {kind}"
            self._note(qualifier.place, [(scope not in scopes, on), (not fits, takes)])

    def _of_any(self, feature: Feature, name: str) -> Iterable[Complaint]:
        if feature.type is not None and feature.type.reference:
            unknown = self.schema.find(feature.type.name) is None
            yield unknown, f"{name} refers to {feature.type.name}, which is not declared"
        numbers, texts = feature.qualifier("ValueMap"), feature.qualifier("Values")
        if numbers is None and texts is None:
            return
        if not isinstance(numbers, list) or not isinstance(texts, list) or len(numbers) != len(texts):
            yield True, f"ValueMap and Values of {name} do not pair"
            return
        for number in numbers if feature.type.name in INTEGERS else ():
            yield not _is_range(number, feature.type), f"'{number}' in the ValueMap of {name} is no {feature.type.name}"
        yield len(set(numbers)) != len(numbers), f"a value stands twice in the ValueMap of {name}"

    def _of_property(self, declared: Class, prop: Feature, name: str) -> Iterable[Complaint]:
        yield prop.type.reference and prop.type.array, f"reference {name} is an array"
        wrong = prop.default is not None and not _is_value(prop.default, prop.type)
        yield wrong, f"the default of {name} is no {prop.type}"
        inherited = self.schema.inherited(declared, "properties", prop.name)
        yield from _of_override(prop, inherited, name)
        if inherited:
            above = inherited[0].type
            yield not self._narrows(prop.type, above), f"{name} is {prop.type}, but {above} in a superclass"

    def _of_method(self, declared: Class, method: Feature, name: str) -> Iterable[Complaint]:
        inherited = self.schema.inherited(declared, "methods", method.name)
        yield from _of_override(method, inherited, name)
        if inherited:
            differs = _signature(method) != _signature(inherited[0])
            yield differs, f"{name} differs from the method that it overrides, at {inherited[0].place}"

    def _narrows(self, kind: Type, above: Type) -> bool:
        if kind.reference and above.reference:
            line = self.schema.line(self.schema.find(kind.name))
            return kind.array == above.array and any(c.is_named(above.name) for c in line)
        return kind == above

    def _of_key(self, above: Optional[Class], prop: Feature, name: str, ours: bool) -> Iterable[Complaint]:
        keys = [key.lower() for key in self.schema.keys(above)] if ours else []
        again = prop.name.lower() in keys
        yield prop.type.array, f"key {name} is an array"
        yield again, f"{name} redefines an inherited key"
        yield keys and not again, f"{name} adds a key to those of {above.name if above else ''}"


def _features(declared: Class):
    """Everything in a class that may carry qualifiers, with its full name and scope."""
    yield declared, declared.name, "a" if declared.association else "c"
    for prop in declared.properties:
        yield prop, f"{declared.name}.{prop.name}", "r" if prop.type.reference else "p"
    for method in declared.methods:
        yield method, f"{declared.name}.{method.name}", "m"
        for parameter in method.parameters:
            yield parameter, f"{declared.name}.{method.name}({parameter.name})", "i"


def _of_override(feature: Feature, inherited: List[Feature], name: str) -> Iterable[Complaint]:
    override = feature.qualifier("Override")
    yield not inherited and override is not None, f"{name} overrides what no superclass declares"
    yield inherited and override is None, f"{name} is inherited and declared again without Override"
    other = isinstance(override, str) and not feature.is_named(override)
    yield other, f"{name} overrides {override}, which is named otherwise"


def _signature(method: Feature):
    return (method.type, [(p.name.lower(), p.type, p.qualifier("In") is not False, p.is_marked("Out"))
                          for p in method.parameters])


def _is_range(text: str, kind: Type) -> bool:
    """A number of the type, or an open or closed range of two."""
    low, high = INTEGERS[kind.name]
    ends = [end for end in text.split("..") if end != ""]
    return text.count("..") <= 1 and all(e.lstrip("-").isdigit() and low <= int(e) <= high for e in ends)


def _is_value(value, kind: Type) -> bool:
    if kind.array:
        return isinstance(value, list) and all(_is_value(each, Type(kind.name)) for each in value)
    if isinstance(value, bool) or kind.name == "boolean":
        return isinstance(value, bool) and kind.name == "boolean"
    if kind.name in INTEGERS:
        low, high = INTEGERS[kind.name]
        return isinstance(value, int) and low <= value <= high
    if kind.name.startswith("real"):
        return isinstance(value, (int, float))
    return isinstance(value, int if kind.name == "integer" else str)
