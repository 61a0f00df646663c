"""Classes and instances as the schema files and the object managers write them."""

import re

from host import Failure, indented, match

OLDEST_SCHEMA = "2.22"
NEWEST_CLASS = "CIM_TimeService"  # came with that CIM schema; the others are older
TEXT = r'"(?:[^"\\]|\\.)*"'


def declared(mof):
    """The text of each class by its name."""
    return {name: text for text, name in re.findall(r"^(\[.*?^class (\w+).*?^\};)", mof, re.M | re.S)}


def blocks(mof):
    return re.findall(r"^instance of .*?^\};", mof, re.M | re.S)


def assignments(block):
    return {block.split()[2], *(line.strip() for line in block.splitlines() if " = " in line and "= NULL" not in line)}


def without_state(block):
    """An instance as it can be registered: the module's state is the server's own."""
    return re.sub(r"^.*(= NULL|OperationalStatus = .*);\n", "", block, flags=re.M)


def same_class(ours, theirs):
    """The server breaks texts elsewhere and adds inherited qualifiers; it adds no property and no method."""
    joined = [re.sub(r'"\s*"', "", re.sub(r"^\s*//.*", "", text, flags=re.M)).replace("\\'", "'") for text in (ours, theirs)]
    words = [set(re.findall(rf"{TEXT}|\w+", text)) for text in joined]
    features = [set(re.findall(r"(\w+)(?:\[\])?;|(\w+)\(\s*\[", re.sub(TEXT, "", text))) for text in joined]
    return words[0] <= words[1] and features[0] == features[1]


def require_schema(text, said=""):
    """TEXT is the newest class that is needed, as the server has it."""
    version = match(r'Version *\( *"([0-9.]+)"', text) or "0"
    if [int(part) for part in version.split(".")] < [int(part) for part in OLDEST_SCHEMA.split(".")]:
        raise Failure(indented(f"the server's CIM schema is too old: {OLDEST_SCHEMA} or later is needed, which has {NEWEST_CLASS}", said))
