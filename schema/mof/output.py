"""What is made of a schema: the object manager's table in C++, a description in JSON, one MOF file."""

import json
from typing import Any, Dict, List

from .model import Class, Method, Parameter, Property, Schema, Type

_CODES = {"datetime": "dateTime"}


def _code(kind: Type) -> str:
    if kind.reference:
        return "CMPI_refA" if kind.array else "CMPI_ref"
    return f"CMPI_{_CODES.get(kind.name, kind.name)}" + ("A" if kind.array else "")


def _text(value: str) -> str:
    return json.dumps(value)  # our names need no more than C++ and JSON have in common


def _bool(value: bool) -> str:
    return "true" if value else "false"


def _declaration(name: str, kind: Type, key: bool) -> str:
    return f"{{{_text(name)}, {_code(kind)}, {_bool(key)}, {_text(kind.name if kind.reference else '')}}}"


def _parameter(parameter: Parameter) -> str:
    is_in = parameter.qualifier("In") is not False
    return (f"{{{_declaration(parameter.name, parameter.type, False)}, {_bool(is_in)}, "
            f"{_bool(parameter.is_marked('Out'))}}}")


def _method(method: Method) -> str:
    parameters = ", ".join(_parameter(p) for p in method.parameters)
    return f"{{{_text(method.name)}, {_code(method.type)}, {{{parameters}}}}}"


def _class(schema: Schema, declared: Class) -> List[str]:
    def listed(items: List[str]) -> str:
        return "{" + "".join(f"\n         {item}," for item in items) + "}"
    properties = [_declaration(p.name, p.type, schema.is_key(declared, p)) for p in declared.properties]
    return [f"    {{{_text(declared.name)}, {_text(declared.superclass or '')}, {_bool(declared.association)},",
            f"     {listed(properties)},",
            f"     {listed([_method(m) for m in declared.methods])}}},"]


def cpp(schema: Schema) -> str:
    """The table behind om::Schema::builtin()."""
    lines = ["// Made from the MOF files at build time.", '#include "objectmanager/model/Schema.h"', "",
             "namespace om {", "", "const Schema& Schema::builtin() {",
             "    static const Schema schema(std::vector<ClassDeclaration>{"]
    for declared in schema:
        lines += _class(schema, declared)
    lines += ["    });", "    return schema;", "}", "", "} // namespace om", ""]
    return "\n".join(lines)


def _facts(feature) -> Dict[str, Any]:
    facts: Dict[str, Any] = {"name": feature.name, "type": str(feature.type)}
    for name in ("ValueMap", "Description"):
        if feature.qualifier(name) is not None:
            facts[name] = feature.qualifier(name)
    return facts


def _property_facts(schema: Schema, declared: Class, prop: Property) -> Dict[str, Any]:
    return {**_facts(prop), "key": schema.is_key(declared, prop), "write": prop.is_marked("Write")}


def described(schema: Schema, ours: List[Class]) -> str:
    """Our classes with what the MOF files say of each property and method, in JSON."""
    listed = [{"name": c.name, "superclass": c.superclass, "association": c.association,
               "keys": schema.keys(c),
               "properties": [_property_facts(schema, c, p) for p in c.properties],
               "methods": [{**_facts(m), "parameters": [_facts(p) for p in m.parameters]} for m in c.methods]}
              for c in ours]
    return json.dumps({"classes": listed}, indent=1) + "\n"
