"""From MOF text to tokens."""

import re
from dataclasses import dataclass
from typing import Any, List

from .model import MofError, Place

_TOKEN = re.compile(r"""
    (?P<space>[ \t\r\n]+) | (?P<comment>//[^\n]*|/\*.*?\*/) |
    (?P<real>[+-]?[0-9]*\.[0-9]+(?:[eE][+-]?[0-9]+)?) |
    (?P<integer>[+-]?(?:0[xX][0-9a-fA-F]+|[01]+[bB]\b|[0-9]+)) |
    (?P<name>[A-Za-z_][A-Za-z0-9_]*) |
    (?P<string>"(?:[^"\\\n]|\\.)*") |
    (?P<pragma>\#[A-Za-z]*) |
    (?P<mark>[\[\]{}():;,=])
""", re.VERBOSE | re.DOTALL)

_ESCAPES = {"b": "\b", "t": "\t", "n": "\n", "f": "\f", "r": "\r", '"': '"', "'": "'", "\\": "\\"}


@dataclass
class Token:
    kind: str  # real, integer, name, string, pragma, mark, end
    value: Any
    place: Place

    def __str__(self) -> str:
        return "the file's end" if self.kind == "end" else f"'{self.value}'"


def _unescape(text: str, place: Place) -> str:
    def replace(match):
        body = match.group(1)
        if body[0] in "xX" and len(body) > 1:
            return chr(int(body[1:], 16))
        if body in _ESCAPES:
            return _ESCAPES[body]
        raise MofError(place, f"unknown escape '\\{body}' in a string")
    return re.sub(r"\\([xX][0-9a-fA-F]{1,4}|.)", replace, text)


def _integer(text: str) -> int:
    if text[-1] in "bB" and not text.lower().lstrip("+-").startswith("0x"):
        return int(text[:-1], 2)
    return int(text, 16) if "x" in text.lower() else int(text)


def tokens(text: str, file: str) -> List[Token]:
    """All tokens, an end token last. Raises MofError at the first character that belongs to none."""
    found: List[Token] = []
    position, line = 0, 1
    while position < len(text):
        place = Place(file, line)
        match = _TOKEN.match(text, position)
        if match is None:
            if text[position] == '"':
                raise MofError(place, "the string does not end on its line")
            if text.startswith("/*", position):
                raise MofError(place, "the comment does not end")
            raise MofError(place, f"unexpected character '{text[position]}'")
        kind, value = match.lastgroup, match.group()
        if kind == "string":
            found.append(Token(kind, _unescape(value[1:-1], place), place))
        elif kind == "integer":
            found.append(Token(kind, _integer(value), place))
        elif kind == "real":
            found.append(Token(kind, float(value), place))
        elif kind not in ("space", "comment"):
            found.append(Token(kind, value, place))
        line += value.count("\n")
        position = match.end()
    found.append(Token("end", "", Place(file, line)))
    return found
