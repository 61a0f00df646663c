"""From tokens to class declarations. Everything else of MOF is refused: a compiler may ignore a pragma, and instances
and qualifier declarations do not belong into a schema that is loaded over the standard one."""

from typing import Any, List

from .lexer import Token, tokens
from .model import TYPES, Class, Method, MofError, Parameter, Property, Qualifier, Type


class _Parser:
    def __init__(self, text: str, file: str):
        self._tokens = tokens(text, file)
        self._at = 0

    def _peek(self) -> Token:
        return self._tokens[self._at]

    def _next(self) -> Token:
        token = self._peek()
        if token.kind != "end":
            self._at += 1
        return token

    def _is(self, value: str) -> bool:
        token = self._peek()
        return token.kind in ("mark", "name") and token.value.lower() == value

    def _take(self, value: str) -> bool:
        if self._is(value):
            self._next()
            return True
        return False

    def _expect(self, value: str) -> Token:
        token = self._peek()
        if not self._is(value):
            raise MofError(token.place, f"expected '{value}', found {token}")
        return self._next()

    def _name(self, what: str) -> Token:
        token = self._next()
        if token.kind != "name":
            raise MofError(token.place, f"expected {what}, found {token}")
        return token

    def classes(self) -> List[Class]:
        found = []
        while self._peek().kind != "end":
            found.append(self._class())
        return found

    def _class(self) -> Class:
        first = self._peek()
        if first.kind == "pragma":
            raise MofError(first.place, f"{first.value} is refused: compilers may ignore it")
        qualifiers = self._qualifiers()
        token = self._peek()
        if not self._take("class"):
            raise MofError(token.place, f"expected a class, found {token}")
        name = self._name("a class name")
        superclass = self._name("a superclass") if self._take(":") else None
        declared = Class(name.value, superclass.value if superclass else None, name.place, qualifiers=qualifiers)
        self._expect("{")
        while not self._take("}"):
            self._feature(declared)
        self._expect(";")
        return declared

    def _feature(self, declared: Class) -> None:
        qualifiers = self._qualifiers()
        kind = self._type()
        name = self._name("a name")
        if self._take("("):
            method = Method(name.value, kind, name.place, self._parameters(), qualifiers)
            declared.methods.append(method)
        else:
            kind = self._array(kind)
            default = self._value() if self._take("=") else None
            declared.properties.append(Property(name.value, kind, name.place, qualifiers, default))
        self._expect(";")

    def _parameters(self) -> List[Parameter]:
        found: List[Parameter] = []
        if self._take(")"):
            return found
        while True:
            qualifiers = self._qualifiers()
            kind = self._type()
            name = self._name("a parameter's name")
            found.append(Parameter(name.value, self._array(kind), name.place, qualifiers))
            if self._take(")"):
                return found
            self._expect(",")

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
        if self._peek().kind == "integer":
            self._next()
        self._expect("]")
        return Type(kind.name, True, kind.reference)

    def _qualifiers(self) -> List[Qualifier]:
        found: List[Qualifier] = []
        if not self._take("["):
            return found
        while True:
            name = self._name("a qualifier")
            value: Any = True
            if self._take("("):
                value = self._value()
                self._expect(")")
            elif self._is("{"):
                value = self._value()
            if any(q.name.lower() == name.value.lower() for q in found):
                raise MofError(name.place, f"qualifier {name.value} stands here twice")
            found.append(Qualifier(name.value, value, name.place))
            if self._take("]"):
                return found
            self._expect(",")

    def _value(self) -> Any:
        if not self._take("{"):
            return self._scalar()
        found: List[Any] = []
        if self._take("}"):
            return found
        while True:
            found.append(self._scalar())
            if self._take("}"):
                return found
            self._expect(",")

    def _scalar(self) -> Any:
        token = self._next()
        if token.kind == "string":
            text = token.value
            while self._peek().kind == "string":
                text += self._next().value
            return text
        if token.kind in ("integer", "real"):
            return token.value
        word = token.value.lower() if token.kind == "name" else ""
        if word in ("true", "false"):
            return word == "true"
        if word == "null":
            return None
        raise MofError(token.place, f"expected a value, found {token}")


def parse(text: str, file: str) -> List[Class]:
    """The classes that a MOF text declares. Raises MofError."""
    return _Parser(text, file).classes()
