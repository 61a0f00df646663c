"""The facts and the metrics of a report: what is known of a host, as the report has it, and nothing else."""

import copy
import json
import os
import re
import shutil
import subprocess
import tempfile
import unittest
from pathlib import Path

from schemas import schema, validator

SOURCE = Path(__file__).resolve().parents[2]
VKCIM = os.environ["VKCIM"]
EXAMPLE = SOURCE / "docs/examples/rack-server.json"
VALIDATOR = validator(schema(SOURCE / "docs/json/vkcim-facts.schema.json"))
PREFIXES = {"VESKA_ComputerSystem": "computer", "VESKA_PhysicalPackage": "chassis", "VESKA_TimeService": "time_service"}
SERIALS = re.compile(r"CZ1234|CZ9999")


def run(format, *words, **environment):
    done = subprocess.run([VKCIM, "report", "--format", format, *words], capture_output=True, timeout=120, text=True,
                          env={**os.environ, "NVLOG_SINK": "none", **environment}, stdin=subprocess.DEVNULL, check=False)
    return done.returncode, done.stdout, done.stderr


def facts_of(**environment):
    code, output, error = run("facts", **environment)
    assert (code, error) == (0, ""), (environment, code, error)
    assert output.count("\n") == 1 and output.endswith("\n")
    facts = json.loads(output)
    VALIDATOR.validate(facts)
    return facts


def is_unknown(value, words):
    return value in (None, "", [], "Unknown") or words == ["Unknown"]


def expected_of(report):
    """The flat object that a report in JSON stands for, but what is of the moment."""
    facts = {"version": report["version"]}
    for name, prefix in PREFIXES.items():
        for at, instance in enumerate(report["classes"][name]["results"]):
            for key, typed in instance["properties"].items():
                value, words = typed["value"], typed.get("words")
                if key.endswith("CreationClassName") or is_unknown(value, words):
                    continue
                full = prefix + (str(at + 1) if at else "") + "_" + key
                facts[full] = value
                if words:
                    facts[full + ("_words" if isinstance(value, list) else "_word")] = \
                        words if isinstance(value, list) else words[0]
    if "computer_HealthState_word" in facts:
        facts["health"] = facts["computer_HealthState_word"]
    if "computer_Name" in facts:
        facts["host"] = facts["computer_Name"]
    return facts


def hosts():
    """This host, the example, variants of it, snapshots, and hosts that are broken."""
    yield {}
    yield {"VK_INSTRUMENTATION_TREE": str(EXAMPLE)}
    if os.environ.get("VK_TEST_HOSTS"):
        for host in sorted(Path(os.environ["VK_TEST_HOSTS"]).iterdir()):
            yield {"VK_INSTRUMENTATION_ROOT": str(host)}
    for broken in ("/nowhere", "/dev/null"):
        yield {"VK_INSTRUMENTATION_ROOT": broken}
        yield {"VK_INSTRUMENTATION_TREE": broken}


class Temporary(unittest.TestCase):
    def setUp(self):
        self.directory = Path(tempfile.mkdtemp())
        self.addCleanup(shutil.rmtree, self.directory)

    def changed(self, change):
        """The example, changed."""
        tree = json.loads(EXAMPLE.read_text(encoding="utf-8"))
        change(tree["nodes"])
        file = self.directory / "host.json"
        file.write_text(json.dumps(tree), encoding="utf-8")
        return {"VK_INSTRUMENTATION_TREE": str(file)}


def without_texts(nodes):
    for node in nodes:
        node["description"] = ""
        node["properties"] = {key: "" if isinstance(value, str) else value for key, value in node["properties"].items()
                              if key != "108"}
    nodes[0]["properties"]["108"] = "node7"


def without_name(nodes):
    del nodes[0]["properties"]["108"]


def two_chassis(nodes):
    nodes.append({**copy.deepcopy(nodes[1]), "path": "/computer/0/chassis/1"})
    nodes[2]["properties"]["50"] = "CZ9999"


def of_unknown_health(nodes):
    for node in nodes:
        node["status"] = 0


class Facts(Temporary):
    def compare(self, environment):
        code, output, _ = run("json", **environment)
        self.assertIn(code, (0, 4))
        report = json.loads(output)
        facts = facts_of(**environment)
        steady = {key: value for key, value in facts.items() if key not in (
            "time", "notes", "time_service_time", "time_service_offset_minutes")}
        self.assertEqual(steady, expected_of(report), environment)
        self.assertEqual(len(facts["notes"]), len(report["notes"]))
        return facts

    def test_are_what_the_report_knows(self):
        for environment in hosts():
            self.compare(environment)

    def test_of_every_machine_hold_its_model(self):
        if not os.environ.get("VK_TEST_HOSTS"):
            self.skipTest("VK_TEST_HOSTS names no machines")
        models = [self.compare({"VK_INSTRUMENTATION_ROOT": str(host)})["chassis_Model"]
                  for host in Path(os.environ["VK_TEST_HOSTS"]).iterdir()]
        self.assertEqual(len(set(models)), 6)

    def test_of_a_second_chassis_have_its_number(self):
        facts = self.compare(self.changed(two_chassis))
        self.assertEqual((facts["chassis_SerialNumber"], facts["chassis2_SerialNumber"]), ("CZ1234", "CZ9999"))

    def test_leave_out_what_is_unknown(self):
        facts = self.compare(self.changed(of_unknown_health))
        for key in ("health", "computer_HealthState", "computer_HealthState_word", "computer_Status"):
            self.assertNotIn(key, facts)
        self.assertNotIn("Unknown", json.dumps(facts))

    def test_leave_out_empty_texts(self):
        facts = facts_of(**self.changed(without_texts))
        self.assertNotIn("chassis_Model", facts)
        self.assertEqual(facts["computer_Name"], "node7")

    def test_of_a_broken_host_say_why(self):
        facts = facts_of(VK_INSTRUMENTATION_ROOT="/nowhere")
        self.assertIn("/nowhere: No such file or directory", facts["notes"])
        self.assertFalse([key for key in facts if key.startswith(("computer", "chassis", "host", "health"))])

    def test_of_a_host_without_a_name_have_no_host(self):
        for environment in (self.changed(without_name), {"VK_INSTRUMENTATION_ROOT": str(self.directory)}):
            self.assertNotIn("host", self.compare(environment), environment)

    def test_hold_the_hosts_own_time_and_offset(self):
        (self.directory / "etc").mkdir()
        shutil.copy("/usr/share/zoneinfo/Asia/Kolkata", self.directory / "etc/localtime")
        facts = facts_of(VK_INSTRUMENTATION_ROOT=str(self.directory))
        self.assertEqual((facts["time_service_time"][21:], facts["time_service_offset_minutes"]), ("+330", 330))

    def test_without_a_time_have_no_offset(self):
        facts = facts_of(VK_INSTRUMENTATION_ROOT="/nowhere")
        self.assertFalse([key for key in facts if key.startswith("time_service") and not key.endswith("ame")])


class Strictness(unittest.TestCase):
    def test_anything_else_is_refused(self):
        right = facts_of(VK_INSTRUMENTATION_TREE=str(EXAMPLE))
        for key in right:
            for wrong in (None, "", 1.5, {}, "Unknown"):
                self.assertFalse(VALIDATOR.is_valid({**right, key: wrong}), (key, wrong))
        for key in ("version", "time", "notes", "health", "computer_HealthState"):
            self.assertFalse(VALIDATOR.is_valid({k: v for k, v in right.items() if k != key}), key)
        for key in ("extra", "chassis1_Model", "computer_CreationClassName", "Model"):
            self.assertFalse(VALIDATOR.is_valid({**right, key: "x"}), key)


class Metrics(Temporary):
    SAMPLE = re.compile(r'([a-z_]+)(?:\{((?:[a-z_]+="(?:[^"\\\n]|\\["\\n])*",?)*)\})? (-?[0-9]+)')

    def metrics(self, *words, **environment):
        code, output, error = run("openmetrics", *words, **environment)
        self.assertEqual((code, error), (0, ""))
        self.assertTrue(output.endswith("\n# EOF\n"))
        series, types = {}, set()
        for line in output.splitlines()[:-1]:
            if line.startswith("#"):
                types.add(re.fullmatch(r"# (?:HELP ([a-z_]+) .+|TYPE ([a-z_]+) gauge)", line).group(2))
                continue
            name, labels, value = self.SAMPLE.fullmatch(line).groups()
            self.assertIn(name, types)
            self.assertNotIn((name, labels), series)
            series[name, labels] = int(value)
        return series

    def names(self, **environment):
        return {name for name, _ in self.metrics(**environment)}

    def test_of_every_host_have_a_time_and_no_series_twice(self):
        for environment in hosts():
            self.assertIn("vk_report_timestamp_seconds", self.names(**environment))
        two = self.metrics(**self.changed(two_chassis))
        self.assertEqual(len([name for name, _ in two if name == "vk_chassis_info"]), 2)

    def test_say_what_is_missing(self):
        self.assertEqual(self.metrics(VK_INSTRUMENTATION_ROOT="/nowhere")["vk_source_missing", 'source="/nowhere"'], 1)
        empty = self.metrics(VK_INSTRUMENTATION_ROOT=str(self.directory))
        self.assertEqual(empty["vk_source_missing", 'source="SMBIOS tables"'], 1)

    def test_leave_out_what_is_unknown(self):
        known = self.names(VK_INSTRUMENTATION_TREE=str(EXAMPLE))
        unknown = self.names(**self.changed(of_unknown_health))
        self.assertEqual(known - unknown, {"vk_computer_health", "vk_computer_operational_status"})

    def test_hold_serial_numbers_only_where_asked(self):
        for words, found in (([], 0), (["--with-serials"], 1)):
            output = run("openmetrics", *words, VK_INSTRUMENTATION_TREE=str(EXAMPLE))[1]
            self.assertEqual(len(SERIALS.findall(output)), found)
        for host in hosts():
            facts = facts_of(**host)
            output = run("openmetrics", **host)[1]
            for key, value in facts.items():
                if key.endswith(("SerialNumber", "UUID", "Tag")):
                    self.assertNotIn(value, output)

    def test_are_read_alike_by_strict_readers_of_both_formats(self):
        try:
            from prometheus_client import parser
            from prometheus_client.openmetrics import parser as openmetrics
        except ImportError:
            self.skipTest("python3-prometheus-client is not installed")
        for environment in hosts():
            output = run("openmetrics", "--with-serials", **environment)[1]
            of_both = [sorted((sample.name, *sorted(sample.labels.items()), sample.value) for family in
                              reader.text_string_to_metric_families(output) for sample in family.samples)
                       for reader in (openmetrics, parser)]
            self.assertEqual(*of_both)
            self.assertEqual(len(of_both[0]), len(self.metrics("--with-serials", **environment)))

    def test_are_accepted_by_promtool(self):
        if shutil.which("promtool") is None:
            self.skipTest("promtool is not installed")
        for environment in hosts():
            for words in ([], ["--with-serials"]):
                done = subprocess.run(["promtool", "check", "metrics"], input=run("openmetrics", *words, **environment)[1],
                                      capture_output=True, text=True, timeout=60, check=False)
                # CIM counts a time zone's offset in minutes.
                remarks = [line for line in done.stderr.splitlines() if not line.startswith("vk_time_offset_minutes use base")]
                self.assertEqual((remarks, done.stdout), ([], ""), environment)


if __name__ == "__main__":
    unittest.main()
