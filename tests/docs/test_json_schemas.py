"""What the programs print as JSON is what the documented schemas say, and the schemas refuse everything else."""

import copy
import json
import os
import subprocess
import unittest
from pathlib import Path

from schemas import schema, validator

SOURCE = Path(__file__).resolve().parents[2]
VKCIM = os.environ["VKCIM"]
BUILD = Path(os.environ["VK_BUILD_DIR"])
CHECK = BUILD / "installed/vk-provider-check"
HOST = {"VK_INSTRUMENTATION_TREE": str(SOURCE / "docs/examples/rack-server.json"), "NVLOG_SINK": "none"}
COMPUTER = 'VESKA_ComputerSystem.CreationClassName="VESKA_ComputerSystem",Name="node7"'
CLASSES = [file.stem for file in (SOURCE / "schema").glob("VESKA_*.mof")]

SCHEMA = schema(BUILD / "schema/vkcim.schema.json")
VALIDATOR = validator(SCHEMA)
TIMING = validator({"$defs": SCHEMA["$defs"], "$ref": "#/$defs/timing"})


def run(*words, **environment):
    done = subprocess.run(words, env={**os.environ, **HOST, **environment}, capture_output=True, timeout=120,
                          stdin=subprocess.DEVNULL, check=False)
    return done.returncode, done.stdout.decode("utf-8"), done.stderr.decode("utf-8", "replace")


def ask(*words, status=0):
    """vkcim's answer, which must be one line, end with that status and be what the schema says."""
    code, output, error = run(VKCIM, "--format", "json", *words)
    assert code == status, (words, code, error)
    assert output.count("\n") == 1 and output.endswith("\n"), words
    document = json.loads(output)
    VALIDATOR.validate(document)
    return document


def echo(*words, status=0):
    """The answer of the tests' own provider, which has a value of every type."""
    return ask("--library", os.environ["ECHO_PROVIDER"], "--provider", "Echo", *words, status=status)


class Vkcim(unittest.TestCase):
    def test_the_report_holds_every_class(self):
        report = ask("report")
        self.assertEqual(set(report["classes"]) | set(report["associations"]), set(CLASSES))
        self.assertEqual(len(report["classes"]["VESKA_PhysicalPackage"]["results"]), 1)

    def test_a_report_of_a_host_that_tells_nothing(self):
        code, output, _ = run(VKCIM, "--format", "json", "report", VK_INSTRUMENTATION_TREE="/dev/null")
        self.assertEqual(code, 4)
        report = json.loads(output)
        VALIDATOR.validate(report)
        self.assertEqual(report["classes"]["VESKA_ComputerSystem"]["results"], [])

    def test_every_class_and_association(self):
        for name in CLASSES:
            self.assertNotEqual(ask("instances", name)["results"], [], name)
            self.assertIsNone(ask("names", name)["results"][0]["properties"], name)

    def test_every_other_operation(self):
        self.assertEqual(ask("get", COMPUTER)["results"][0]["properties"]["Name"]["value"], "node7")
        for command in ("associators", "associator-names"):
            packages = ask(command, COMPUTER, "--assoc-class", "VESKA_ComputerSystemPackage")["results"]
            self.assertEqual([p["class"] for p in packages], ["VESKA_PhysicalPackage"], command)
        managed = ask("invoke", "VESKA_TimeService", "ManageTime", "GetRequest=true", f"ManagedElement={COMPUTER}")
        self.assertEqual(managed["returnValue"], {"type": "uint32", "value": 0})
        self.assertEqual(managed["out"]["TimeData"]["type"], "datetime")
        for words in (["create", "VESKA_ComputerSystem", "Name=x"], ["delete", COMPUTER], ["references", COMPUTER],
                      ["reference-names", COMPUTER], ["query", "SELECT * FROM VESKA_ComputerSystem"]):
            self.assertEqual(ask(*words, status=1)["status"]["name"], "CMPI_RC_ERR_NOT_SUPPORTED", words)

    def test_modify(self):
        answer = echo("modify", "Echo_Quiet", "A=1", status=4)
        self.assertEqual((answer["results"], answer["returnValue"], answer["out"]), ([], None, {}))

    def test_errors_with_and_without_a_name_and_a_message(self):
        self.assertEqual(ask("names", "VESKA_Nothing", status=1)["status"]["code"], 5)
        self.assertEqual(echo("names", "Echo_Odd", status=1)["status"], {"code": 77, "name": "UNKNOWN", "message": None})
        self.assertIsNotNone(echo("names", "Echo_Fail", status=1)["status"]["message"])

    def test_values_of_every_type(self):
        types = set()
        for answer in (echo("instances", "Echo_Everything"), echo("invoke", "Echo_Thing", "Run", *(
                f"A{n}={text}" for n, text in enumerate(
                    ["null:uint64", "sint8:-128", "uint16[]:", "string[]:a,b", "real64:1e300", "sint32:-5", "sint16:-5",
                     "ref:Echo_Thing.Name=\"x\"", "datetime:00000001000000.000000:000", "char16[]:65", "uint16:7"])))):
            for result in answer["results"]:
                types |= {value["type"] for value in result["properties"].values()}
            types |= {value["type"] for value in answer["out"].values()}
        self.assertLessEqual({"boolean", "char16", "real32", "real64", "uint8", "uint16", "uint32", "uint64", "sint8",
                              "sint16", "sint32", "sint64", "string", "datetime", "ref", "instance", "uint16[]",
                              "string[]", "char16[]"}, types)

    def test_the_line_of_timing(self):
        _, _, error = run(VKCIM, "--timing", "--repeat", "3", "names", "VESKA_TimeService")
        TIMING.validate(json.loads(error))
        self.assertFalse(TIMING.is_valid({**json.loads(error), "runs": 0}))


class Strictness(unittest.TestCase):
    """Every change to a right document that makes it a wrong one is refused."""

    def refuse(self, document, reason):
        self.assertFalse(VALIDATOR.is_valid(document), reason)

    def changed(self, document, place, change):
        wrong = copy.deepcopy(document)
        holder = wrong
        for step in place:
            holder = holder[step]
        change(holder)
        self.refuse(wrong, f"{change} at {place}")

    PLACES = [(), ("status",), ("results", 0), ("results", 0, "keys", "Name"), ("results", 0, "properties", "Name")]

    def test_a_key_that_is_missing(self):
        right = ask("get", COMPUTER)
        for place in self.PLACES:
            holder = right
            for step in place:
                holder = holder[step]
            for key in holder:
                self.changed(right, place, lambda at, key=key: at.pop(key))

    def test_a_key_too_many(self):
        right = ask("get", COMPUTER)
        for place in self.PLACES:
            self.changed(right, place, lambda at: at.update(extra=None))

    def test_a_value_of_another_kind(self):
        right = ask("get", COMPUTER)
        for place in self.PLACES:
            for key in [*right] if not place else ["code", "name", "path", "namespace", "class", "keys", "type"]:
                self.changed(right, place, lambda at, key=key: at.update({key: 1.5}))

    def test_words_that_are_none(self):
        right = ask("get", COMPUTER)
        self.assertEqual(right["results"][0]["properties"]["OperationalStatus"]["words"], ["OK", "In Service"])
        for kind, words in [("uint16", []), ("uint16", [None]), ("uint16", [2]), ("uint16", "OK"), ("string", ["OK"])]:
            self.changed(right, ("results", 0, "properties"), lambda at, kind=kind, words=words: at.update(
                X={"type": kind, "value": None, "words": words}))
        self.changed(right, ("results", 0, "keys", "Name"), lambda at: at.update(words=["node7"]))

    def test_a_value_that_its_type_cannot_hold(self):
        right = ask("get", COMPUTER)
        for kind, value in [("string", 1), ("boolean", 0), ("uint8", 256), ("uint16", -1), ("uint64", 2 ** 64),
                            ("sint64", 2 ** 63), ("sint8", 1.5), ("uint32", "1"), ("real32", "1"), ("char16", "A"),
                            ("datetime", "now"), ("ref", {}), ("instance", "x"), ("uint16[]", 1), ("uint16[]", [-1]),
                            ("string[]", ["a", 1]), ("null", 1), ("uint128", 1), ("string[][]", [])]:
            self.changed(right, ("results", 0, "properties"),
                         lambda at, kind=kind, value=value: at.update(X={"type": kind, "value": value}))

    def test_a_status_whose_name_is_anothers(self):
        right = ask("get", COMPUTER)
        self.changed(right, ("status",), lambda at: at.update(code=1))
        self.changed(right, ("status",), lambda at: at.update(name="CMPI_RC_ERR_FAILED"))

    def test_a_report_that_lacks_a_class_or_has_another(self):
        right = ask("report")
        for part in ("classes", "associations"):
            for name in right[part]:
                self.changed(right, (part,), lambda at, name=name: at.pop(name))
            self.changed(right, (part,), lambda at: at.update(VESKA_Tenth=at[next(iter(at))]))
        self.changed(right, (), lambda at: at.update(notes=[1]))
        for key in ("notes", "host", "version", "time"):
            self.changed(right, (), lambda at, key=key: at.pop(key))
        self.changed(right, (), lambda at: at.update(time="2026-11-21 06:00:00"))


class Check(unittest.TestCase):
    VALIDATOR = validator(schema(SOURCE / "docs/json/vk-provider-check.schema.json"))

    def test_what_it_prints(self):
        for directory, part in (("/", "reading"), (str(SOURCE), "reading"), (str(SOURCE), "setting")):
            code, output, error = run(str(CHECK), part, "--root", directory, "--format", "json")
            document = json.loads(output)
            self.VALIDATOR.validate(document)
            self.assertEqual(code, 1 if document["missing"] else 0, error)
            self.assertEqual(document["asked"], part)
            self.assertEqual({c["part"] for c in document["checks"]}, {"reading", "setting"})

    def test_anything_else_is_refused(self):
        right = json.loads(run(str(CHECK), "--format", "json")[1])
        for key in right:
            self.assertFalse(self.VALIDATOR.is_valid({k: v for k, v in right.items() if k != key}), key)
        for key in right["checks"][0]:
            for wrong in ({k: v for k, v in right["checks"][0].items() if k != key}, {**right["checks"][0], key: 1.5}):
                self.assertFalse(self.VALIDATOR.is_valid({**right, "checks": [wrong]}), key)
        for wrong in ({"missing": -1}, {"missing": "none"}, {"asked": "writing"}, {"checks": []}, {"extra": 1}):
            self.assertFalse(self.VALIDATOR.is_valid({**right, **wrong}), wrong)


if __name__ == "__main__":
    unittest.main()
