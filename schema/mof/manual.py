"""The classes as a section of a manual page, in roff."""

from typing import List

from .model import Class, Feature, Schema


def _escaped(text: str) -> str:
    text = text.replace("\\", "\\e").replace("-", "\\-")
    return "\n".join("\\&" + line if line[:1] in (".", "'") else line for line in text.split("\n"))


def _values(feature) -> str:
    numbers, texts = feature.qualifier("ValueMap"), feature.qualifier("Values")
    if not numbers or numbers == texts:
        return ""
    return " Values: " + ", ".join(f"{n} {t}" for n, t in zip(numbers, texts)) + "."


def _property(schema: Schema, declared: Class, prop: Feature) -> List[str]:
    marks = ["key"] if schema.is_key(declared, prop) else []
    marks += ["writable"] if prop.is_marked("Write") else []
    marks = f" ({', '.join(marks)})" if marks else ""
    return [".TP", f"\\fB{prop.name}\\fR, {prop.type}{marks}", _escaped(prop.qualifier("Description") + _values(prop))]


def _method(method: Feature) -> List[str]:
    lines = [".TP", f"\\fB{method.name}\\fR(), {method.type}", _escaped(method.qualifier("Description")), ".RS"]
    for parameter in method.parameters:
        way = "in, out" if parameter.is_marked("Out") and parameter.is_marked("In") else "in"
        lines += [".TP", f"\\fI{parameter.name}\\fR, {parameter.type} ({way})",
                  _escaped(parameter.qualifier("Description"))]
    return lines + [".RE"]


def classes(schema: Schema, ours: List[Class]) -> str:
    """Each class with its properties, where their values come from, and its methods."""
    lines: List[str] = []
    for declared in ours:
        lines += [f".SS {declared.name}", f"Derived from {declared.superclass}.",
                  _escaped(declared.qualifier("Description"))]
        for prop in declared.properties:
            lines += _property(schema, declared, prop)
        for method in declared.methods:
            lines += _method(method)
    return "\n".join(lines)
