"""What the packages' scripts say and do: where the registration fails, and to the endpoint's groups and units."""

import os
import subprocess
import tempfile
import unittest
from pathlib import Path

SCRIPTS = Path(os.environ["VK_BUILD_DIR"]) / "packaging"
PACKAGING = Path(__file__).resolve().parents[2] / "packaging"
ENDPOINT = PACKAGING / "endpoint"


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


class Endpoint(unittest.TestCase):
    def calls(self, script, *words, failing=()):
        """What a script calls where a service manager runs, in its order. Commands that begin as in `failing` fail."""
        with tempfile.TemporaryDirectory() as directory:
            programs = Path(directory)
            for name in ("getent", "addgroup", "groupadd", "groupdel", "systemctl", "deb-systemd-helper", "deb-systemd-invoke"):
                program = programs / name
                refusals = "".join(f'case "{name} $*" in "{each}"*) exit 1 ;; esac\n' for each in failing)
                program.write_text(f'#!/bin/sh\necho "{name} $*" >>{programs}/calls\n{refusals}', encoding="ascii")
                program.chmod(0o755)
            text = (ENDPOINT / script).read_text(encoding="utf-8").replace("/run/systemd/system", directory)
            for path in ("/run/vkcimd.sock", "/etc/vkcimd", "/var/lib/vk"):
                text = text.replace(path, f"{directory}/none")
            done = subprocess.run(["sh", "-c", text, script, *words], env={"PATH": f"{programs}:/usr/bin:/bin"},
                                  capture_output=True, text=True, check=False)
            self.assertEqual((done.returncode, done.stderr), (0, ""))
            calls = programs / "calls"
            return calls.read_text(encoding="ascii").splitlines() if calls.exists() else []

    def test_installing_makes_both_groups_and_enables_the_socket_alone(self):
        for script, word, add, enable in [
                ("debian/postinst", "configure", "addgroup --quiet --system", "deb-systemd-helper enable"),
                ("rpm/post", "1", "groupadd --system", "systemctl --no-reload enable")]:
            with self.subTest(script):
                calls = self.calls(script, word, failing=["getent", "systemctl --quiet is-active"])
                self.assertEqual([call for call in calls if call.startswith(add)], [f"{add} vkcim", f"{add} vkcim-admin"])
                self.assertEqual([call for call in calls if "enable" in call.split()], [f"{enable} vkcimd.socket"])
                self.assertFalse([call for call in calls if "start vkcimd.service" in call and "try" not in call])

    def test_an_upgrade_leaves_what_an_administrator_disabled(self):
        for script, words in [("debian/postinst", ["configure", "1.0.0"]), ("rpm/post", ["2"])]:
            with self.subTest(script):
                calls = self.calls(script, *words, failing=["deb-systemd-helper --quiet was-enabled"])
                self.assertEqual([call for call in calls if "enable" in call.split() or "group" in call.split()[0]], [])

    def test_an_upgrade_starts_a_service_that_runs_anew(self):
        self.assertIn("deb-systemd-invoke restart vkcimd.service", self.calls("debian/postinst", "configure", "1.0.0"))
        self.assertIn("systemctl try-restart vkcimd.service", self.calls("rpm/post", "2"))

    def test_an_upgrade_stops_nothing(self):
        self.assertEqual(self.calls("debian/prerm", "upgrade", "2.0.0"), [])
        self.assertEqual(self.calls("rpm/preun", "1"), [])

    def test_removing_keeps_the_groups_and_purging_takes_them(self):
        self.assertFalse([call for call in self.calls("debian/postrm", "remove") if call.startswith("groupdel")])
        purging = self.calls("debian/postrm", "purge")
        self.assertEqual([call for call in purging if call.startswith("groupdel")], ["groupdel vkcim", "groupdel vkcim-admin"])


class Metrics(unittest.TestCase):
    def run_script(self, script, *words, status=0, running=True):
        """What the script has systemctl do where a service manager runs, whether the metrics stay, and what it complains of."""
        with tempfile.TemporaryDirectory() as directory:
            place = Path(directory)
            (place / "vk.prom").touch()
            (place / "systemctl").write_text(f'#!/bin/sh\necho "$*" >>{place}/calls\nexit {status}\n', encoding="ascii")
            (place / "systemctl").chmod(0o755)
            text = (PACKAGING / "metrics" / script).read_text(encoding="utf-8")
            text = text.replace("/run/systemd/system", directory if running else f"{directory}/none")
            text = text.replace("/var/lib/prometheus/node-exporter", directory)
            done = subprocess.run(["sh", "-c", text, script, *words], env={"PATH": f"{directory}:/usr/bin:/bin"},
                                  capture_output=True, text=True, check=False)
            self.assertEqual(done.returncode, 0, script)
            calls = place / "calls"
            return (calls.read_text(encoding="ascii").splitlines() if calls.exists() else [], (place / "vk.prom").exists(), done.stderr)

    def test_removing_disables_the_timer_and_takes_the_metrics(self):
        for words in (["prerm", "remove"], ["prerm", "deconfigure", "in-favour"], ["preun", "0"]):
            with self.subTest(words):
                self.assertEqual(self.run_script(*words), (["disable --now vk-metrics.timer"], False, ""))
                self.assertEqual(self.run_script(*words, running=False), ([], False, ""))

    def test_a_timer_that_cannot_be_disabled_fails_no_removal(self):
        for words in (["prerm", "remove"], ["preun", "0"]):
            with self.subTest(words):
                self.assertEqual(self.run_script(*words, status=1), (
                    ["disable --now vk-metrics.timer"], False, "vk-metrics.timer could not be disabled.\n"))

    def test_an_upgrade_leaves_both(self):
        for words in (["prerm", "upgrade", "2.0.0"], ["prerm", "failed-upgrade", "1.0.0"], ["preun", "1"]):
            with self.subTest(words):
                self.assertEqual(self.run_script(*words), ([], True, ""))


if __name__ == "__main__":
    unittest.main()
