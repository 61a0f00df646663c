"""Every command that the documents and the helps show can be typed as it stands there. Commands that build or install are
run by other tests, which each row names."""

import os
import re
import shlex
import shutil
import subprocess
import sys
import tempfile
import unittest
from pathlib import Path

SOURCE = Path(__file__).resolve().parents[2]
BUILD = Path(os.environ["VK_BUILD_DIR"])
VKCIM = BUILD / "bin/vkcim"
NOT_SUPPORTED = {"create", "delete", "query", "references", "reference-names"}

# What stands for something that a reader has: here it is the tests' own provider.
STAND_INS = {"/path/to/libother.so": os.environ["ECHO_PROVIDER"], "OtherProvider": "Echo", "CIM_Other": "Echo_Thing"}
# Commands that this test cannot run, by how they begin, and where they are run.
ELSEWHERE = {
    "./test.sh": ".ci/run",
    "packaging/build": "tests/system/packages",
    "sudo apt-get": "tests/system/packages",
    "sudo systemctl": "tests/system/packages",
    "ansible": "tests/system/fleet",
    "promtool query": "tests/system/fleet",
    "promtool check metrics": "tests/docs/test_facts.py",
    "printf": "tests/system/installed_endpoint",
    "wbemcli": "tests/system/installed_endpoint",
    "vkcim --url unix:": "tests/system/installed_endpoint",
    "vkcim --url https:": "tests/system/endpoint_https",
    "vkcimd --make-certificate": "tests/system/installed_endpoint",
    "cmake --install": "tests/tools/test_installation.py",
    "cmake --build": ".ci/run",
    "vk-provider-register": "tests/tools/test_register.py",
    "vk-provider-check": "tests/tools/test_check.py",
    "vk-host-snapshot": "tests/tools/test_snapshot.py",
    "vk-ntp-setup": "tests/tools/test_ntp.py",
    "bench/": "bench/README.md",
}
PROGRAMS = (r"(?:[A-Z_]+=\S+ )*(?:\./run\.sh|\./test\.sh|vkcim|vk-[a-z-]+|packaging/build|sudo|printf|wbemcli|cmake|bench/\S+|"
            r"ansible(?:-playbook)?|promtool|hyperfine)")


def unrolled(text):
    """A manual page's example as it is shown."""
    return text.replace("\\-", "-").replace("\\(ti", "~").replace("\\(aq", "'")


def shown():
    """Each command with the document that shows it."""
    for document in (SOURCE / "README.md", SOURCE / "CONTRIBUTING.md", *(SOURCE / "docs").glob("*.md")):
        text = document.read_text(encoding="utf-8")
        lines = re.findall(rf"^    ({PROGRAMS}(?: .*)?)$", text, re.M) + re.findall(rf"`({PROGRAMS} [^`…]*)`", text)
        yield from ((document.name, re.sub(r" +# .*", "", line)) for line in lines)
    for page in (SOURCE / "docs/man").glob("*.in"):
        for block in re.findall(r"^\.nf\n(.*?)^\.fi$", page.read_text(encoding="utf-8"), re.M | re.S):
            yield from ((page.name, line) for line in unrolled(block).splitlines() if re.match(PROGRAMS, line))
    commands = subprocess.run([VKCIM, "--help"], capture_output=True, text=True, check=True).stdout
    for command in re.findall(r"^  ([a-z-]+)  ", commands.split("\nCommands:")[1], re.M):
        text = subprocess.run([VKCIM, command, "--help"], capture_output=True, text=True, check=True).stdout
        yield f"vkcim {command} --help", re.search(r"^Example:\n  (vkcim .*)$", text, re.M).group(1)


def is_pattern(command):
    """Whether words in capitals stand for something."""
    return re.search(r"(?<![\w.\"'=-])[A-Z]{2,}(?![\w-])", command) is not None


class Commands(unittest.TestCase):
    def setUp(self):
        self.directory = Path(tempfile.mkdtemp(prefix="vk-docs-"))
        self.addCleanup(shutil.rmtree, self.directory)
        tree = self.directory / "tree.json"
        tree.write_bytes((SOURCE / "docs/examples/rack-server.json").read_bytes())
        self.environment = {"PATH": f"{VKCIM.parent}:/usr/bin:/bin", "NVLOG_SINK": "none", "HOME": str(self.directory),
                            "VK_INSTRUMENTATION_TREE": str(tree)}

    def run_it(self, command):
        for name, instead in STAND_INS.items():
            command = command.replace(name, shlex.quote(instead))
        command = command.replace('"vm"', '"node7"')  # the host that the documents show, and that of the tests
        command = re.sub(r"^hyperfine -N '(.*)'$", r"\1", command)  # what is measured need run only once
        command = re.sub(r"^((?:[A-Z_]+=\S+ )*)\./run\.sh$", r"\1vkcim report", command).replace("./run.sh", "vkcim")
        return subprocess.run(["bash", "-c", command], capture_output=True, text=True, check=False, timeout=300,
                              env=self.environment, stdin=subprocess.DEVNULL)

    def test_that_are_shown_can_be_typed(self):
        tried, found = 0, list(shown())
        for document, command in found:
            if any(command.startswith(prefix) for prefix in ELSEWHERE) or is_pattern(command):
                continue
            tried += 1
            with self.subTest(f"{document}: {command}"):
                # Nothing else is safe to run, and this one sets the clock.
                self.assertRegex(command, r"^(?:[A-Z_]+=\S+ |hyperfine -N ')*(?:\./run\.sh|vkcim)(?: |$)")
                self.assertNotIn("GetRequest=false", command)
                done = self.run_it(command)
                refused = any(f" {name} " in command for name in NOT_SUPPORTED)
                self.assertEqual(done.returncode, 1 if refused else 0, done.stderr)
                self.assertEqual("CMPI_RC_ERR_NOT_SUPPORTED" in done.stderr, refused, done.stderr)
                self.assertNotIn("nothing returned", done.stdout if "modify" not in command else "")
        self.assertGreater(tried, 35, found)

    def test_that_are_run_elsewhere_are_run_by_files_that_are_there(self):
        for prefix, where in ELSEWHERE.items():
            self.assertTrue((SOURCE / where).exists(), f"{prefix}: {where}")

    def test_name_programs_that_there_are(self):
        for document, command in shown():
            for word in re.findall(r"\bvk-(?:provider|host)-[a-z]+", command):
                self.assertTrue((SOURCE / f"docs/man/{word}.8.in").exists(), f"{document}: {command}")


if __name__ == "__main__":
    sys.exit(unittest.main())
