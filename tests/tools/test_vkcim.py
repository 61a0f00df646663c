"""vkcim as somebody at a terminal meets it: colours, completion in a shell, the examples of its help."""

import json
import os
import pty
import re
import select
import subprocess
import time
import unittest
from pathlib import Path

from support import BUILD, directory, run

SOURCE = Path(__file__).resolve().parents[2]
VKCIM = BUILD / "bin/vkcim"
HOST = {"PATH": f"{VKCIM.parent}:/usr/bin:/bin", "NVLOG_SINK": "none", "LC_ALL": "C",
        "VK_INSTRUMENTATION_TREE": str(SOURCE / "docs/examples/rack-server.json")}


def on_a_terminal(words, typed=b"", until=None, **environment):
    """What a program writes to a terminal, up to a text or its end."""
    ours, its = pty.openpty()
    child = subprocess.Popen([str(w) for w in words], stdin=its, stdout=its, stderr=its, close_fds=True,
                             start_new_session=True, env={**HOST, "TERM": "xterm", **environment})
    os.close(its)
    os.write(ours, typed)
    written, deadline = b"", time.monotonic() + 60
    while time.monotonic() < deadline and (until is None or until not in written):
        if not select.select([ours], [], [], 1)[0]:
            continue
        try:
            some = os.read(ours, 65536)
        except OSError:  # the other side is closed
            break
        if not some:
            break
        written += some
    if until is not None:
        child.kill()
    child.wait(60)
    os.close(ours)
    return written.decode("utf-8", "replace")


class Colours(unittest.TestCase):
    WORDS = [VKCIM, "instances", "VESKA_PhysicalPackage"]
    BOLD = "\x1b[1mVESKA_PhysicalPackage.CreationClassName"

    def test_are_for_terminals(self):
        self.assertIn(self.BOLD, on_a_terminal(self.WORDS))
        self.assertIn(self.BOLD, on_a_terminal(self.WORDS, NO_COLOR=""))
        piped = run(*self.WORDS, env={**HOST, "TERM": "xterm"}).stdout
        self.assertIn("VESKA_PhysicalPackage.CreationClassName", piped)
        self.assertNotIn("\x1b", piped)

    def test_are_left_out_where_nobody_wants_them(self):
        for environment in ({"NO_COLOR": "1"}, {"TERM": "dumb"}):
            text = on_a_terminal(self.WORDS, **environment)
            self.assertIn("VESKA_PhysicalPackage.CreationClassName", text)
            self.assertNotIn("\x1b", text, environment)

    def test_stay_out_of_what_programs_read(self):
        for kind in ("json", "mof"):
            self.assertNotIn("\x1b", on_a_terminal([*self.WORDS, "--format", kind]), kind)


class Completion(unittest.TestCase):
    """In bash itself, which splits the line its own way."""

    def complete(self, typed):
        rc = directory() / "rc"
        rc.write_text(f". '{BUILD}/schema/vkcim.bash-completion'\nPS1='$ '\nbind 'set enable-bracketed-paste off'\n"
                      "bind 'set bell-style none'\n"
                      "vkcim() { printf '<%s>' \"$@\"; echo; }\n", encoding="utf-8")
        text = on_a_terminal(["bash", "--noprofile", "--rcfile", rc, "-i"], f"vkcim {typed}\t\nexit\n".encode())
        return re.findall(r"<([^>]*)>", text)

    def test_completes_commands_classes_and_options(self):
        for typed, words in [("rep", ["report"]), ("names VESKA_Ph", ["names", "VESKA_PhysicalPackage"]),
                             ("--format json inst", ["--format", "json", "instances"]),
                             ("get VESKA_CIM", ["get", "VESKA_CIMServiceConfig"]),
                             ("invoke VESKA_TimeService M", ["invoke", "VESKA_TimeService", "ManageTime"]),
                             ("names --thr", ["names", "--threads"]),
                             ("associators VESKA_ComputerSystem --assoc-class VESKA_TimeServiceA",
                              ["associators", "VESKA_ComputerSystem", "--assoc-class", "VESKA_TimeServiceAffectsElement"])]:
            self.assertEqual(self.complete(typed), words, typed)

    def test_completes_behind_an_equals_sign(self):
        self.assertEqual(self.complete("--format=j"), ["--format=json"])
        self.assertEqual(self.complete("--format=json rep"), ["--format=json", "report"])
        self.assertEqual(self.complete("--provider="), ["--provider=BaseServerProvider"])


class Help(unittest.TestCase):
    # What the provider does not offer.
    NOT_SUPPORTED = {"create", "delete", "query", "references", "reference-names"}

    def test_shows_an_example_of_each_command_that_can_be_typed(self):
        commands = re.findall(r"^  ([a-z-]+)  ", run(VKCIM, "--help").stdout.split("\nCommands:")[1], re.M)
        self.assertGreater(len(commands), 10)
        for command in commands:
            help_text = run(VKCIM, command, "--help").stdout
            example = re.search(r"^Example:\n  (vkcim .*)$", help_text, re.M).group(1)
            self.assertRegex(example, rf"\b{command}\b")
            tree = directory() / "tree.json"
            tree.write_bytes((SOURCE / "docs/examples/rack-server.json").read_bytes())
            done = run("sh", "-c", example, env={**HOST, "VK_INSTRUMENTATION_TREE": str(tree)})
            with self.subTest(example):
                self.assertEqual(done.returncode, 1 if command in self.NOT_SUPPORTED else 0, done.stderr)
                self.assertEqual("CMPI_RC_ERR_NOT_SUPPORTED" in done.stderr, command in self.NOT_SUPPORTED, done.stderr)
                if command not in self.NOT_SUPPORTED | {"modify"}:
                    self.assertNotIn("nothing returned", done.stdout)


class Errors(unittest.TestCase):
    def asked(self, *words):
        done = run(VKCIM, *words, env=HOST)
        self.assertEqual(done.returncode, 1)
        return done.stderr

    def test_name_the_nearest_class_for_a_typing_error(self):
        self.assertIn("did you mean VESKA_TimeService?", self.asked("names", "VESKA_TimeSevice"))
        self.assertIn("did you mean VESKA_ComputerCapabilities?",
                      self.asked("associators", "VESKA_ComputerSystem", "--assoc-class", "VESKA_ComputerCapabilites"))


class Associators(unittest.TestCase):
    def test_without_an_association_class_are_all_partners(self):
        for command in ("associators", "associator-names"):
            done = run(VKCIM, "--format", "json", command, "VESKA_ComputerSystem", env=HOST)
            self.assertEqual(done.returncode, 0, done.stderr)
            self.assertEqual([result["class"] for result in json.loads(done.stdout)["results"]],
                             ["VESKA_EnabledLogicalElementCapabilities", "VESKA_PhysicalPackage", "VESKA_TimeService"])


if __name__ == "__main__":
    unittest.main()
