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
# Commands that this test cannot run, by how they begin: the test that runs them, and what of them stands there.
ELSEWHERE = {
    "./test.sh": (".ci/run", "step tests ./test.sh"),
    "./test.sh --coverage": (".ci/run", "step coverage ./test.sh --coverage"),
    "packaging/build": ("tests/system/packages", 'packaging/build" deb'),
    "sudo apt-get install ./build-packages": ("tests/system/packages", 'readme_command "apt-get install'),
    "sudo apt-get purge": ("tests/system/packages", 'readme_command "apt-get purge'),
    "sudo apt-get install ./vk-baseserver-ansible": ("tests/system/packages", "vk-baseserver-ansible"),
    "sudo systemctl": ("tests/system/packages", "enable vk-metrics.timer"),
    "ansible": ("tests/system/fleet", 'shown("ansible -i hosts'),
    "ansible-playbook": ("tests/system/fleet", 'shown("ansible-playbook -'),
    "promtool query": ("tests/system/fleet", 'shown("promtool query'),
    "promtool check metrics": ("tests/docs/test_facts.py", '"promtool", "check", "metrics"'),
    "printf": ("tests/system/installed_endpoint", "eval \"${commands[0]}\""),
    "wbemcli": ("tests/system/installed_endpoint", "eval \"${commands[1]}\""),
    "vkcim --url unix:": ("tests/system/installed_endpoint", "vkcim --format json --url unix:"),
    "vkcim --url https:": ("tests/system/endpoint_https", '"--cacert", world.certificate'),
    "vkcimd --make-certificate": ("tests/system/installed_endpoint", "vkcimd --make-certificate"),
    "cmake --install": ("tests/tools/support.py", '"cmake", "--install"'),
    "cmake --build": (".ci/run", "build_tree release build benches"),
    "vk-ntp-setup": ("tests/tools/test_ntp.py", 'host.setup("install")'),
}
# They measure for minutes, on a machine that does nothing else.
BY_HAND = "bench/"
PROGRAMS = (r"(?:[A-Z_]+=\S+ )*(?:\./run\.sh|\./test\.sh|vkcim|vk-[a-z-]+|packaging/build|sudo|printf|wbemcli|cmake|bench/[\w/]+|"
            r"ansible(?:-playbook)?|promtool|hyperfine)")


SAFE = r"^(?:[A-Z_]+=\S+ |hyperfine -N ')*(?:\./run\.sh|vkcim|vk-provider-check|vk-host-snapshot|vk-provider-register)(?: |$)"
# Words that stand for something that a reader puts there.
PLACEHOLDERS = ("ARGS", "CLASS", "CTEST", "DIR", "FILE", "NAME", "USER")
# What root and others may run anywhere; they may exit with 1 as well, where something is missing or cannot be read here.
ADMINISTRATORS = ("vk-provider-check", "vk-host-snapshot", "vk-provider-register")
INSTALLED = Path(tempfile.mkdtemp(prefix="vk-docs-installed-"))


def setUpModule():
    unittest.addModuleCleanup(shutil.rmtree, INSTALLED)
    for component in ("provider", "tools"):
        subprocess.run(["cmake", "--install", BUILD, "--prefix", INSTALLED, "--component", component], check=True,
                       capture_output=True)


def help_of(program, *words):
    path = f"{VKCIM.parent}:{INSTALLED}/sbin:/usr/bin:/bin"
    return subprocess.run([program, *words, "--help"], capture_output=True, text=True, check=True, env={"PATH": path}).stdout


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
        blocks = re.findall(r"^\.(?:nf|SH EXAMPLE)\n(.*?)^\.(?:fi|SH)", page.read_text(encoding="utf-8"), re.M | re.S)
        lines = [line for block in blocks for line in unrolled(block).splitlines() if re.match(PROGRAMS, line)]
        yield from ((page.name, line) for line in lines)
    commands = help_of("vkcim")
    for command in re.findall(r"^  ([a-z-]+)  ", commands.split("\nCommands:")[1], re.M):
        yield f"vkcim {command} --help", re.search(r"^Example:\n  (vkcim .*)$", help_of("vkcim", command), re.M).group(1)
    for program in ADMINISTRATORS:
        yield f"{program} --help", re.search(r"^Example: (vk-.*)$", help_of(program), re.M).group(1)


def is_pattern(command):
    """Whether words in it stand for something."""
    return re.search(rf"(?<![\w.\"'-])(?:{'|'.join(PLACEHOLDERS)})(?![\w-])", command) is not None


class Commands(unittest.TestCase):
    def setUp(self):
        self.directory = Path(tempfile.mkdtemp(prefix="vk-docs-"))
        self.addCleanup(shutil.rmtree, self.directory)
        tree = self.directory / "tree.json"
        tree.write_bytes((SOURCE / "docs/examples/rack-server.json").read_bytes())
        self.environment = {"PATH": f"{VKCIM.parent}:{INSTALLED}/sbin:/usr/bin:/bin", "NVLOG_SINK": "none",
                            "HOME": str(self.directory), "VK_INSTRUMENTATION_TREE": str(tree),
                            "VK_REGISTER_ROOT": str(self.directory)}

    def run_it(self, command):
        for name, instead in STAND_INS.items():
            command = command.replace(name, shlex.quote(instead))
        command = command.replace('"vm"', '"node7"')  # the host that the documents show, and that of the tests
        command = re.sub(r"^hyperfine -N '(.*)'$", r"\1", command)  # what is measured need run only once
        command = re.sub(r"^((?:[A-Z_]+=\S+ )*)\./run\.sh$", r"\1vkcim report", command).replace("./run.sh", "vkcim")
        environment = dict(self.environment)
        if command.startswith("VK_INSTRUMENTATION_ROOT="):
            del environment["VK_INSTRUMENTATION_TREE"]
        if command.startswith("vk-host-snapshot"):
            shutil.rmtree(self.directory / "snapshot", ignore_errors=True)
        return subprocess.run(["bash", "-c", command], capture_output=True, text=True, check=False, timeout=300,
                              env=environment, stdin=subprocess.DEVNULL)

    def expect_done(self, command, done):
        if command.startswith(ADMINISTRATORS[:2]):
            self.assertIn(done.returncode, (0, 1), done.stderr)
            self.assertNotEqual(done.stdout, "")
            return
        refused = any(f" {name} " in command for name in NOT_SUPPORTED)
        self.assertEqual(done.returncode, 1 if refused else 0, done.stderr)
        self.assertEqual("CMPI_RC_ERR_NOT_SUPPORTED" in done.stderr, refused, done.stderr)
        self.assertNotIn("nothing returned", done.stdout if "modify" not in command else "")

    def test_that_are_shown_can_be_typed(self):
        tried, found = 0, list(shown())
        for document, command in found:
            if command.startswith((*ELSEWHERE, BY_HAND)) or is_pattern(command):
                continue
            tried += 1
            with self.subTest(f"{document}: {command}"):
                # Nothing else is safe to run, and this one sets the clock.
                self.assertRegex(command, SAFE)
                self.assertNotIn("GetRequest=false", command)
                self.expect_done(command, self.run_it(command))
        self.assertGreater(tried, 50, found)
        self.assertTrue((self.directory / "snapshot/etc/hostname").exists(), "what was copied is what was asked")

    def test_that_are_run_elsewhere_are_run_there(self):
        found = [command for _, command in shown()]
        for prefix, (where, words) in ELSEWHERE.items():
            self.assertTrue(words in (SOURCE / where).read_text(encoding="utf-8"), f"{prefix}: no {words} in {where}")
            self.assertTrue(any(command.startswith(prefix) for command in found), f"{prefix} is not shown any more")

    def test_name_programs_that_there_are(self):
        for document, command in shown():
            for word in re.findall(r"\bvk-(?:provider|host)-[a-z]+", command):
                self.assertTrue((SOURCE / f"docs/man/{word}.8.in").exists(), f"{document}: {command}")


if __name__ == "__main__":
    sys.exit(unittest.main())
