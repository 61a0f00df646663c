"""What registers the provider's classes with object managers."""

import json
from dataclasses import dataclass
from typing import List

from .model import Class

INSTANCE, ASSOCIATION, METHOD = 2, 3, 5
_WORDS = {INSTANCE: "instance", ASSOCIATION: "association", METHOD: "method"}


@dataclass
class Provider:
    module: str  # the registered module's name
    name: str  # the prefix of the factory functions
    location: str  # the library, without "lib" and ".so"
    version: str
    vendor: str
    description: str
    namespace: str


def kinds(declared: Class) -> List[int]:
    """What the provider does for a class. It runs the methods that the class itself declares, and no inherited one."""
    return [INSTANCE] + [ASSOCIATION] * declared.association + [METHOD] * bool(declared.methods)


def _instance(name: str, properties) -> str:
    def printed(value) -> str:
        if isinstance(value, list):
            return "{" + ", ".join(printed(v) for v in value) + "}"
        return json.dumps(value)
    return "\n".join([f"instance of {name}", "{", *(f"    {key} = {printed(value)};" for key, value in properties),
                      "};", ""])


def module_instances(provider: Provider, classes: List[Class]) -> str:
    """The provider module, the provider and what it serves, as instances in MOF."""
    made = [_instance("PG_ProviderModule", [
        ("Name", provider.module), ("Description", provider.description), ("Location", provider.location),
        ("Vendor", provider.vendor), ("Version", provider.version), ("InterfaceType", "CMPI"),
        ("InterfaceVersion", "2.0.0")])]
    made.append(_instance("PG_Provider", [("ProviderModuleName", provider.module), ("Name", provider.name)]))
    made += [_instance("PG_ProviderCapabilities", [
        ("ProviderModuleName", provider.module), ("ProviderName", provider.name),
        ("CapabilityID", f"{provider.module}.{declared.name}"), ("ClassName", declared.name),
        ("Namespaces", [provider.namespace]), ("ProviderType", kinds(declared)),
        ("SupportedProperties", None), ("SupportedMethods", None)]) for declared in classes]
    return "\n".join(made).replace("= null;", "= NULL;")


def stanzas(provider: Provider, classes: List[Class]) -> str:
    """A stanza a class, each class once."""
    return "".join(f"[{declared.name}]\n   provider: {provider.name}\n   location: {provider.location}\n"
                   f"   type: {' '.join(_WORDS[kind] for kind in kinds(declared))}\n"
                   f"   namespace: {provider.namespace}\n#\n" for declared in classes)
