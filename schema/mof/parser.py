"""From MOF text to class declarations. Everything else of MOF is refused: a compiler may ignore a pragma, and instances
and qualifier declarations do not belong into a schema that is loaded over the standard one."""

import re
from typing import Any, Callable, Dict, List, NamedTuple

from .model import TYPES, Class, Feature, MofError, Place, Qualifier, Type

_TOKEN = re.compile(r"""
    (?P<space>[ \t\r\n]+) | (?P<comment>//[^\n]*|/\*.*?\*/) |
    (?P<real>[+-]?[0-9]*\.[0-9]+(?:[eE][+-]?[0-9]+)?) |
    (?P<integer>[+-]?(?:0[xX][0-9a-fA-F]+|[0-9]+)) |
    (?P<name>[A-Za-z_][A-Za-z0-9_]*) |
    (?P<string>"(?:[^"\\\n]|\\.)*") |
    (?P<pragma>\#[A-Za-z]*) |
    (?P<mark>[\[\]{}():;,=]) |
    (?P<wrong>/\*|.)
""", re.VERBOSE | re.DOTALL)
_WRONG = {'"': "the string does not end on its line", "/*": "the comment does not end"}
_ESCAPES = {"b": "\b", "t": "\t", "n": "\n", "f": "\f", "r": "\r", '"': '"', "'": "'", "\\": "\\"}
_WORDS = {"true": True, "false": False, "null": None}


class _Token(NamedTuple):
    kind: str  # real, integer, name, string, pragma, mark, end
    value: Any
    place: Place

    def __str__(self) -> str:
        return "the file's end" if self.kind == "end" else f"'{self.value}'"


def _unescape(text: str, place: Place) -> str:
    def replace(match):
        if match[1] in _ESCAPES:
            return _ESCAPES[match[1]]
        raise MofError(place, f"unknown escape '{match[0]}' in a string")
    return re.sub(r"\\(.)", replace, text[1:-1])


_READ: Dict[str, Callable[[str, Place], Any]] = {
    "string": _unescape, "real": lambda text, _: float(text),
    "integer": lambda text, _: int(text, 16 if "x" in text.lower() else 10)}


def _tokens(text: str, file: str) -> List[_Token]:
    """All tokens, an end token last. Raises MofError at the first character that belongs to none."""
    found, line = [], 1
    for match in _TOKEN.finditer(text):
        kind, value, place = match.lastgroup, match[0], Place(file, line)
        line += value.count("\n")
        if kind == "wrong":
            raise MofError(place, _WRONG.get(value, f"unexpected character '{value}'"))
        if kind not in ("space", "comment"):
            found.append(_Token(kind, _READ[kind](value, place) if kind in _READ else value, place))
    return [*found, _Token("end", "", Place(file, line))]


class _Parser:
    def __init__(self, tokens: List[_Token]):
        self._tokens = tokens

    def _next(self) -> _Token:
        return self._tokens[0] if self._tokens[0].kind == "end" else self._tokens.pop(0)

    def _is(self, value: str) -> bool:
        token = self._tokens[0]
        return token.kind in ("mark", "name") and token.value.lower() == value

    def _take(self, value: str) -> bool:
        return self._is(value) and bool(self._next())

    def _expect(self, value: str, what: str = "") -> None:
        if not self._take(value):
            raise MofError(self._tokens[0].place, f"expected {what or repr(value)}, found {self._tokens[0]}")

    def _name(self, what: str) -> _Token:
        token = self._next()
        if token.kind != "name":
            raise MofError(token.place, f"expected {what}, found {token}")
        return token

    def _list(self, item: Callable[[], Any], end: str, least: int = 0) -> List[Any]:
        """Items between commas up to the end."""
        found: List[Any] = []
        while len(found) < least or not self._take(end):
            if found:
                self._expect(",")
            found.append(item())
        return found

    def classes(self) -> List[Class]:
        found = []
        while self._tokens[0].kind != "end":
            found.append(self._class())
        return found

    def _class(self) -> Class:
        first = self._tokens[0]
        if first.kind == "pragma":
            raise MofError(first.place, f"{first.value} is refused: compilers may ignore it")
        qualifiers = self._qualifiers()
        self._expect("class", "a class")
        name = self._name("a class name")
        superclass = self._name("a superclass").value if self._take(":") else None
        declared = Class(name.value, None, name.place, qualifiers, superclass=superclass)
        self._expect("{")
        while not self._take("}"):
            feature = self._feature("a name")
            if self._take("("):
                feature.parameters = self._list(self._parameter, ")")
                declared.methods.append(feature)
            else:
                feature.type = self._array(feature.type)
                feature.default = self._value() if self._take("=") else None
                declared.properties.append(feature)
            self._expect(";")
        self._expect(";")
        return declared

    def _feature(self, what: str) -> Feature:
        qualifiers, kind, name = self._qualifiers(), self._type(), self._name(what)
        return Feature(name.value, kind, name.place, qualifiers)

    def _parameter(self) -> Feature:
        found = self._feature("a parameter's name")
        found.type = self._array(found.type)
        return found

    def _type(self) -> Type:
        name = self._name("a type")
        if self._take("ref"):
            return Type(name.value, reference=True)
        if name.value.lower() not in TYPES:
            raise MofError(name.place, f"'{name.value}' is no type")
        return Type(name.value.lower())

    def _array(self, kind: Type) -> Type:
        if not self._take("["):
            return kind
        if self._tokens[0].kind == "integer":
            self._next()
        self._expect("]")
        return kind._replace(array=True)

    def _qualifiers(self) -> Dict[str, Qualifier]:
        found: Dict[str, Qualifier] = {}
        for each in self._list(self._qualifier, "]", least=1) if self._take("[") else ():
            if found.setdefault(each.name.lower(), each) is not each:
                raise MofError(each.place, f"qualifier {each.name} stands here twice")
        return found

    def _qualifier(self) -> Qualifier:
        name, value = self._name("a qualifier"), True
        if self._take("("):
            value = self._value()
            self._expect(")")
        elif self._is("{"):
            value = self._value()
        return Qualifier(name.value, value, name.place)

    def _value(self) -> Any:
        return self._list(self._scalar, "}") if self._take("{") else self._scalar()

    def _scalar(self) -> Any:
        token = self._next()
        if token.kind == "string":
            text = token.value
            while self._tokens[0].kind == "string":
                text += self._next().value
            return text
        if token.kind in ("integer", "real"):
            return token.value
        if token.kind == "name" and token.value.lower() in _WORDS:
            return _WORDS[token.value.lower()]
        raise MofError(token.place, f"expected a value, found {token}")


def parse(text: str, file: str) -> List[Class]:
    """The classes that a MOF text declares. Raises MofError."""
    return _Parser(_tokens(text, file)).classes()
