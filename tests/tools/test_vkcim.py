"""vkcim as somebody at a terminal meets it: colours, completion in a shell, the width of lines."""

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
        self.assertEqual(self.complete("--with-serials --format=op"), ["--with-serials", "--format=openmetrics"])
        self.assertEqual(self.complete("--format=json rep"), ["--format=json", "report"])
        self.assertEqual(self.complete("--provider="), ["--provider=BaseServerProvider"])


class Width(unittest.TestCase):
    """At 80 columns a report and a help are broken where people would break them."""

    def shown(self, *words, **environment):
        return run(VKCIM, *words, env={**HOST, **environment}).stdout.splitlines()

    def test_of_the_terminal_breaks_lines(self):
        for words in (["report"], ["describe", "VESKA_ComputerSystem"], ["classes"], ["--help"], ["modify", "--help"]):
            for line in self.shown(*words, COLUMNS="80", LC_ALL="C.UTF-8"):
                self.assertLessEqual(len(line), 80, line)

    def test_of_the_terminal_breaks_notes(self):
        tree = json.loads(Path(HOST["VK_INSTRUMENTATION_TREE"]).read_text(encoding="utf-8"))
        tree["product"]["rootDirectory"] = "/nowhere/platform/"  # whatever commands this machine has
        host = directory() / "tree.json"
        host.write_text(json.dumps(tree), encoding="utf-8")
        lines = self.shown("report", COLUMNS="80", VK_INSTRUMENTATION_TREE=str(host))
        first = lines.index("  - no /nowhere/vcm/bin/cimconfig: the delivery settings of the CIM server read")
        self.assertEqual(lines[first + 1], "    as 0, which then means nothing")

    def test_of_the_terminal_breaks_messages(self):
        words = [VKCIM, "invoke", "VESKA_TimeService", "ManageTime"]
        lines = on_a_terminal(words, COLUMNS="80").splitlines()
        self.assertIn("vkcim: ManageTime takes GetRequest (boolean, in), TimeData (datetime, in and", lines)
        self.assertLessEqual(max(map(len, lines)), 80)
        self.assertGreater(max(map(len, run(*words, env={**HOST, "COLUMNS": "80"}).stderr.splitlines())), 80)

    def test_of_no_terminal_leaves_lines_whole(self):
        self.assertGreater(max(map(len, self.shown("report"))), 110)
        self.assertEqual(self.shown("names", "VESKA_TimeService"), self.shown("names", "VESKA_TimeService", COLUMNS="40"))

    def test_boxes_are_drawn_in_utf8_locales_only(self):
        self.assertIn("  └─ VESKA_ComputerSystem.Name=\"node7\"  (VESKA_ComputerSystemPackage)",
                      self.shown("report", LC_ALL="C.UTF-8"))
        self.assertIn("  `- VESKA_ComputerSystem.Name=\"node7\"  (VESKA_ComputerSystemPackage)",
                      self.shown("report", LC_ALL="C"))


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
