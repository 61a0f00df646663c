"""What is made of a schema: the object manager's table in C++, a description in JSON, one MOF file."""

import json
from typing import Any, Dict, List, Union

from .model import Class, Feature, Schema, Type

_CODES = {"datetime": "dateTime"}


def _code(kind: Type) -> str:
    return f"CMPI_{'ref' if kind.reference else _CODES.get(kind.name, kind.name)}{'A' if kind.array else ''}"


def _printed(value: Union[str, bool, int, List[str]]) -> str:
    if isinstance(value, list):
        return "{" + ", ".join(map(_printed, value)) + "}"
    return json.dumps(value)  # our texts need no more than C++ and JSON have in common


def _qualifiers(feature: Feature) -> str:
    each = [f"{{{_printed(q.name)}, qualifierValue({_printed(q.value)})}}" for q in feature.qualifiers.values()]
    return "{" + ", ".join(each) + "}"


def _declaration(feature: Feature, key: bool) -> str:
    kind = feature.type
    return (f"{{{_printed(feature.name)}, {_code(kind)}, {_printed(key)}, "
            f"{_printed(kind.name if kind.reference else '')}, {_qualifiers(feature)}}}")


def _parameter(parameter: Feature) -> str:
    is_in = parameter.qualifier("In") is not False
    return f"{{{_declaration(parameter, False)}, {_printed(is_in)}, {_printed(parameter.is_marked('Out'))}}}"


def _method(method: Feature) -> str:
    parameters = ", ".join(map(_parameter, method.parameters))
    return f"{{{_printed(method.name)}, {_code(method.type)}, {{{parameters}}}, {_qualifiers(method)}}}"


def _class(schema: Schema, declared: Class) -> List[str]:
    def listed(items: List[str]) -> str:
        return "{" + "".join(f"\n         {item}," for item in items) + "}"
    properties = [_declaration(p, schema.is_key(declared, p)) for p in declared.properties]
    head = ", ".join(map(_printed, (declared.name, declared.superclass or "", declared.association)))
    return [f"    {{{head},",
            f"     {listed(properties)},",
            f"     {listed([_method(m) for m in declared.methods])},",
            f"     {_qualifiers(declared)}}},"]


def cpp(schema: Schema) -> str:
    """The table behind om::Schema::builtin()."""
    lines = ["// Made from the MOF files at build time.", '#include "objectmanager/model/Schema.h"', "",
             "namespace om {", "", "const Schema& Schema::builtin() {",
             "    static const Schema schema(std::vector<ClassDeclaration>{"]
    for declared in schema:
        lines += _class(schema, declared)
    lines += ["    });", "    return schema;", "}", "", "} // namespace om", ""]
    return "\n".join(lines)


def _facts(feature: Feature) -> Dict[str, Any]:
    qualifiers = {name: feature.qualifier(name) for name in ("ValueMap", "Description")}
    said = {name: value for name, value in qualifiers.items() if value is not None}
    return {"name": feature.name, "type": str(feature.type), **said}


def _property_facts(schema: Schema, declared: Class, prop: Feature) -> Dict[str, Any]:
    return {**_facts(prop), "key": schema.is_key(declared, prop), "write": prop.is_marked("Write")}


def described(schema: Schema, ours: List[Class]) -> str:
    """Our classes with what the MOF files say of each property and method, in JSON."""
    listed = [{"name": c.name, "superclass": c.superclass, "association": c.association,
               "keys": schema.keys(c),
               "properties": [_property_facts(schema, c, p) for p in c.properties],
               "methods": [{**_facts(m), "parameters": [_facts(p) for p in m.parameters]} for m in c.methods]}
              for c in ours]
    return json.dumps({"classes": listed}, indent=1) + "\n"
