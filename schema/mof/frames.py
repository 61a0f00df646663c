"""Files that name our classes, made of frames: each @NAME@ in a frame stands for one of these texts."""

import json
from typing import Dict, List

from . import manual
from .model import Class, Schema


def _texts(schema: Schema, ours: List[Class]) -> Dict[str, str]:
    classes = [c.name for c in ours if not c.association]
    associations = [c.name for c in ours if c.association]
    roles = dict.fromkeys(p.name for c in ours for p in c.properties if p.type.reference)
    return {
        "CLASSES": manual.classes(schema, ours),
        "CLASS_LIST": json.dumps(classes), "ASSOCIATION_LIST": json.dumps(associations),
        "CLASS_WORDS": " ".join(classes), "ASSOCIATION_WORDS": " ".join(associations), "ROLE_WORDS": " ".join(roles),
        "METHOD_WORDS": " ".join(f"{c.name}={m.name}" for c in ours for m in c.methods),
        "PROPERTY_WORDS": " ".join(f"{c.name}={p.name}" for c in ours for p in c.properties),
    }


def filled(frame: str, schema: Schema, ours: List[Class]) -> str:
    """The frame with its texts."""
    for name, text in _texts(schema, ours).items():
        frame = frame.replace(f"@{name}@", text)
    return frame
