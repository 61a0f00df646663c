"""The facts about the standard classes that ours derive from, and the stub in MOF that is made of them."""

import re
from typing import Dict, List, Tuple

from .model import MofError, Place

_FEATURE = r"(?P<type>\w+)(?P<ref>\s+ref)?\s+(?P<name>\w+)(?P<array>\[\])?"
_FACTS = {what: re.compile(f"^{pattern}$") for what, pattern in {
    "a class": r"(?P<name>\w+)(?:\s*<\s*(?P<above>\w+))?(?P<association>\s+association)?",
    "a method": r"(?P<type>\w+)\s+(?P<name>\w+)\((?P<parameters>.*)\)",
    "a property": rf"(?P<key>key\s+)?{_FEATURE}(?:\s*=\s*(?P<default>\d+))?",
    "a parameter": rf"(?P<in>in\s+)?(?P<out>out\s+)?{_FEATURE}"}.items()}


def _read(what: str, text: str, place: Place):
    found = _FACTS[what].match(text)
    if found is None:
        raise MofError(place, f"'{text}' is not {what}")
    return found


def _feature(found) -> str:
    return f"{found['type']}{' REF' if found['ref'] else ''} {found['name']}{found['array'] or ''}"


def _method(text: str, place: Place) -> str:
    method, parameters = _read("a method", text, place), []
    for each in filter(None, map(str.strip, method["parameters"].split(","))):
        parameter = _read("a parameter", each, place)
        marks = ("In" if parameter["in"] else "In(false)") + (", Out" if parameter["out"] else "")
        parameters.append(f"[{marks}] {_feature(parameter)}")
    return f"{method['type']} {method['name']}({', '.join(parameters)});"


def _property(found, inherited: bool) -> str:
    marks = [f'Override("{found["name"]}")'] * inherited + ["Key"] * bool(found["key"])
    default = f" = {found['default']}" if found["default"] else ""
    return f"{'[' + ', '.join(marks) + '] ' if marks else ''}{_feature(found)}{default};"


def stub(text: str, file: str) -> str:
    """The stub in MOF of a facts file: a class a paragraph, `NAME`, `NAME < SUPERCLASS`, ` association` behind it;
    below it, indented, `[key] TYPE [ref] NAME[[]] [= NUMBER]` for a property and `TYPE NAME([in] [out] TYPE [ref] NAME,
    ...)` for a method; `#` starts a comment. Raises MofError."""
    lines: List[str] = []
    names: Dict[str, List[str]] = {}  # of a class's properties, with those that it inherits
    inherited: List[str] = []
    current: List[str] = []
    for number, line in enumerate(text.splitlines(), 1):
        place, content = Place(file, number), line.split("#")[0].strip()
        if content and not line[0].isspace():
            found = _read("a class", content, place)
            lines += ["};", ""] if names else []
            lines += ["[Association]"] if found["association"] else []
            lines.append(f"class {found['name']}{' : ' + found['above'] if found['above'] else ''} {{")
            inherited = names.get(found["above"], [])
            current = names[found["name"]] = list(inherited)
        elif content and not names:
            raise MofError(place, "a property before the first class")
        elif "(" in content:
            lines.append(f"    {_method(content, place)}")
        elif content:
            found = _read("a property", content, place)
            lines.append(f"    {_property(found, found['name'] in inherited)}")
            current.append(found["name"])
    return "\n".join([*lines, *(["};", ""] if names else [])]) + "\n"


def split(text: str) -> Tuple[str, ...]:
    """The words of a list file, without comments."""
    return tuple(word for line in text.splitlines() for word in line.split("#")[0].split())
