"""The documented JSON Schemas, to hold what is printed against. Exit status 77 without the library that does."""

import json
import sys

try:
    import jsonschema
except ImportError:
    print("skipped: python3-jsonschema is not installed")
    sys.exit(77)


def schema(file):
    document = json.loads(file.read_text(encoding="utf-8"))
    jsonschema.Draft202012Validator.check_schema(document)
    return document


def validator(document):
    return jsonschema.Draft202012Validator(document)
