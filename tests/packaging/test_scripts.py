"""What the packages' scripts say and do where the registration fails."""

import os
import subprocess
import tempfile
import unittest
from pathlib import Path

SCRIPTS = Path(os.environ["VK_BUILD_DIR"]) / "packaging"


class Registration(unittest.TestCase):
    def run_script(self, script, *words):
        with tempfile.TemporaryDirectory() as programs:
            for name in ("vk-provider-register", "ldconfig"):
                program = Path(programs) / name
                program.write_text(f'#!/bin/sh\necho "$*" >>{programs}/calls\nexit 1\n', encoding="ascii")
                program.chmod(0o755)
            text = (SCRIPTS / script).read_text(encoding="utf-8").replace("/sbin/ldconfig", "ldconfig")
            done = subprocess.run(["sh", "-c", text, script, *words], env={"PATH": f"{programs}:/usr/bin:/bin"},
                                  capture_output=True, text=True, check=False)
            calls = Path(programs) / "calls"
            return done, calls.read_text(encoding="ascii").split() if calls.exists() else []

    def test_a_failed_registration_names_the_command_and_fails_no_installation(self):
        for script, words in [("debian/postinst", ["configure"]), ("rpm/post", ["1"])]:
            with self.subTest(script):
                done, calls = self.run_script(script, *words)
                self.assertEqual(done.returncode, 0)
                self.assertIn("install", calls)
                self.assertEqual(done.stderr, "Run vk-provider-register install again once this is mended.\n")

    def test_a_registration_that_cannot_be_taken_back_fails_no_removal(self):
        for script, words in [("debian/prerm", ["remove"]), ("rpm/preun", ["0"])]:
            with self.subTest(script):
                done, calls = self.run_script(script, *words)
                self.assertEqual((done.returncode, calls), (0, ["remove"]))
                self.assertEqual(done.stderr, "Some of the registration could not be taken back.\n")

    def test_an_upgrade_keeps_the_registration(self):
        for script, words in [("debian/prerm", ["upgrade", "2"]), ("rpm/preun", ["1"])]:
            with self.subTest(script):
                done, calls = self.run_script(script, *words)
                self.assertEqual((done.returncode, calls), (0, []))


if __name__ == "__main__":
    unittest.main()
