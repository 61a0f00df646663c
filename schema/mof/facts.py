"""The facts about the standard classes that ours derive from, and the stub in MOF that is made of them."""

import re
from typing import Dict, List, Tuple

from .model import MofError, Place

_CLASS = re.compile(r"^(?P<name>\w+)(?:\s*<\s*(?P<above>\w+))?(?P<association>\s+association)?$")
_METHOD = re.compile(r"^(?P<type>\w+)\s+(?P<name>\w+)\((?P<parameters>.*)\)$")
_PROPERTY = re.compile(r"^(?P<key>key\s+)?(?P<type>\w+)(?P<ref>\s+ref)?\s+(?P<name>\w+)(?P<array>\[\])?"
                       r"(?:\s*=\s*(?P<default>\d+))?$")
_PARAMETER = re.compile(
    r"^(?P<in>in\s+)?(?P<out>out\s+)?(?P<type>\w+)(?P<ref>\s+ref)?\s+(?P<name>\w+)(?P<array>\[\])?$")


class _Stub:
    def __init__(self, file: str):
        self._file = file
        self._lines: List[str] = []
        self._open = False
        self._name = ""
        self._above: Dict[str, str] = {}
        self._declared: Dict[str, List[str]] = {}

    def line(self, number: int, text: str, indented: bool) -> None:
        place = Place(self._file, number)
        if not indented:
            self._class(_match(_CLASS, text, place, "a class"))
        elif not self._open:
            raise MofError(place, "a property before the first class")
        elif "(" in text:
            self._method(_match(_METHOD, text, place, "a method"), place)
        else:
            self._property(_match(_PROPERTY, text, place, "a property"))

    def text(self) -> str:
        self._close()
        return "\n".join(self._lines) + "\n"

    def _close(self) -> None:
        if self._open:
            self._lines += ["};", ""]

    def _class(self, match) -> None:
        self._close()
        self._open = True
        self._name = match["name"]
        self._declared[self._name] = []
        if match["above"]:
            self._above[self._name] = match["above"]
        if match["association"]:
            self._lines.append("[Association]")
        self._lines.append(f"class {self._name}" + (f" : {match['above']}" if match["above"] else "") + " {")

    def _is_inherited(self, name: str) -> bool:
        above = self._above.get(self._name)
        while above is not None:
            if name in self._declared.get(above, []):
                return True
            above = self._above.get(above)
        return False

    def _property(self, match) -> None:
        marks = []
        if self._is_inherited(match["name"]):
            marks.append(f'Override("{match["name"]}")')
        if match["key"]:
            marks.append("Key")
        self._declared[self._name].append(match["name"])
        qualifiers = f"[{', '.join(marks)}] " if marks else ""
        self._lines.append(f"    {qualifiers}{match['type']}{' REF' if match['ref'] else ''} "
                           f"{match['name']}{match['array'] or ''}"
                           + (f" = {match['default']};" if match["default"] else ";"))

    def _method(self, match, place: Place) -> None:
        parameters = []
        for text in filter(None, (p.strip() for p in match["parameters"].split(","))):
            p = _match(_PARAMETER, text, place, "a parameter")
            marks = "In" if p["in"] else "In(false)"
            marks += ", Out" if p["out"] else ""
            parameters.append(f"[{marks}] {p['type']}{' REF' if p['ref'] else ''} {p['name']}{p['array'] or ''}")
        self._lines.append(f"    {match['type']} {match['name']}({', '.join(parameters)});")


def _match(pattern, text: str, place: Place, what: str):
    found = pattern.match(text)
    if found is None:
        raise MofError(place, f"'{text}' is not {what}")
    return found


def stub(text: str, file: str) -> str:
    """The stub in MOF of a facts file: a class a paragraph, `NAME`, `NAME < SUPERCLASS`, ` association` behind it; below
    it, indented, `[key] TYPE [ref] NAME[[]] [= NUMBER]` for a property and `TYPE NAME([in] [out] TYPE [ref] NAME, ...)` for a
    method; `#` starts a comment. Raises MofError."""
    made = _Stub(file)
    for number, line in enumerate(text.splitlines(), 1):
        content = line.split("#")[0].rstrip()
        if content:
            made.line(number, content.strip(), content[0].isspace())
    return made.text()


def split(text: str) -> Tuple[str, ...]:
    """The words of a list file, without comments."""
    return tuple(word for line in text.splitlines() for word in line.split("#")[0].split())
