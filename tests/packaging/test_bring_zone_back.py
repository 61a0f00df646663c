"""The shell that brings a replaced time zone back when the package is purged."""

import os
import subprocess
import tempfile
import unittest
from pathlib import Path

SOURCE = Path(__file__).resolve().parents[2]
SCRIPT = SOURCE / "packaging/bring-zone-back.sh"
KEPT = "var/lib/vk/instrumentation/former-zone"
OF_FIRST_VERSION = "var/lib/vk/instrumentation/replaced-zone"
BERLIN = b"TZif2\0\n\n\0 rule: link 3\nCET-1CEST,M3.5.0,M10.5.0/3\n"


def of_first_version(local_time, zone_name=("absent", b"")):
    return b"vk-zone 1\n" + b"".join(f"{kind} {len(data)}\n".encode() + data + b"\n" for kind, data in (local_time, zone_name))


class BringZoneBack(unittest.TestCase):
    def setUp(self):
        holder = tempfile.TemporaryDirectory()
        self.addCleanup(holder.cleanup)
        self.root = Path(holder.name)
        for directory in ("etc", "usr/share/zoneinfo/Europe", "usr/share/zoneinfo/Etc", "var/lib/vk/instrumentation"):
            (self.root / directory).mkdir(parents=True)
        (self.root / "usr/share/zoneinfo/Europe/Berlin").write_bytes(BERLIN)
        (self.root / "usr/share/zoneinfo/Etc/GMT-1").write_bytes(b"TZif2 other")
        os.symlink("../usr/share/zoneinfo/Etc/GMT-1", self.root / "etc/localtime")
        (self.root / "etc/timezone").write_bytes(b"Etc/GMT-1\n")

    def run_it(self, function="bring_zone_back", shell="sh"):
        done = subprocess.run([shell, "-ec", f'. "$1"; {function} "$2"; echo went on', "-", SCRIPT, self.root],
                              capture_output=True, text=True, check=False)
        self.assertEqual((done.returncode, done.stdout), (0, "went on\n"), done.stderr)
        return done.stderr

    def keep(self, local_time, zone_name=None):
        """A link as text, a file as bytes, nothing as None."""
        (self.root / KEPT).mkdir()
        for name, content in (("localtime", local_time), ("timezone", zone_name)):
            path = self.root / KEPT / name
            if isinstance(content, str):
                os.symlink(content, path)
            elif content is not None:
                path.write_bytes(content)
        if local_time is None:
            (self.root / KEPT / "no-localtime").touch()

    def zone(self):
        return (self.root / "etc/localtime").read_bytes()

    def assert_nothing_is_left_over(self):
        self.assertEqual(sorted(os.listdir(self.root / "etc")), ["localtime", "timezone"])
        left = set(os.listdir(self.root / "var/lib/vk/instrumentation")) - {"lock"}
        self.assertEqual(left, set())

    def test_puts_a_link_and_the_name_back(self):
        for shell in ("sh", "bash"):
            self.keep("../usr/share/zoneinfo/Europe/Berlin", b"Europe/Berlin\n")
            self.assertEqual(self.run_it(shell=shell), "")
            self.assertEqual(os.readlink(self.root / "etc/localtime"), "../usr/share/zoneinfo/Europe/Berlin")
            self.assertEqual((self.root / "etc/timezone").read_bytes(), b"Europe/Berlin\n")
            self.assert_nothing_is_left_over()

    def test_puts_a_file_back_byte_for_byte(self):
        self.keep(BERLIN)
        (self.root / KEPT / "localtime").chmod(0o640)
        self.run_it()
        self.assertFalse((self.root / "etc/localtime").is_symlink())
        self.assertEqual((self.root / "etc/localtime").stat().st_mode & 0o7777, 0o640)
        self.assertEqual(self.zone(), BERLIN)
        self.assertEqual((self.root / "etc/timezone").read_bytes(), b"Etc/GMT-1\n")
        self.assert_nothing_is_left_over()

    def test_makes_no_name_where_there_is_none(self):
        (self.root / "etc/timezone").unlink()
        self.keep("../usr/share/zoneinfo/Europe/Berlin", b"Europe/Berlin\n")
        self.run_it()
        self.assertEqual(os.listdir(self.root / "etc"), ["localtime"])

    def test_removes_what_was_not_there_before(self):
        self.keep(None)
        self.run_it()
        self.assertEqual(os.listdir(self.root / "etc"), ["timezone"])

    def test_leaves_a_zone_that_an_administrator_chose_since(self):
        for chosen in ("/usr/share/zoneinfo/Asia/Tokyo", "../usr/share/zoneinfo/Etc/UTC"):
            for kept in ("../usr/share/zoneinfo/Europe/Berlin", None):
                (self.root / "etc/localtime").unlink()
                os.symlink(chosen, self.root / "etc/localtime")
                self.keep(kept, b"Europe/Berlin\n")
                self.assertEqual(self.run_it(), "")
                self.assertEqual(os.readlink(self.root / "etc/localtime"), chosen)
                self.assert_nothing_is_left_over()

    def test_brings_back_from_where_nothing_is(self):
        (self.root / "etc/localtime").unlink()
        self.keep(BERLIN)
        self.run_it()
        self.assertEqual(self.zone(), BERLIN)

    def test_does_nothing_without_a_kept_zone(self):
        self.assertEqual(self.run_it(), "")
        self.assertEqual(self.zone(), b"TZif2 other")

    def bring_back_of_first_version(self, local_time, zone_name):
        """With each shell, from the same start."""
        for shell in ("sh", "bash"):
            (self.root / "etc/localtime").unlink(missing_ok=True)
            os.symlink("../usr/share/zoneinfo/Etc/GMT-1", self.root / "etc/localtime")
            (self.root / OF_FIRST_VERSION).write_bytes(of_first_version(local_time, zone_name))
            self.assertEqual(self.run_it(shell=shell), "")
            self.assertEqual(os.listdir(self.root / "var/lib/vk/instrumentation"), [])

    def test_puts_back_what_the_first_version_kept(self):
        self.bring_back_of_first_version(("file", BERLIN), ("absent", b""))
        self.assertFalse((self.root / "etc/localtime").is_symlink())
        self.assertEqual(self.zone(), BERLIN)
        self.assertEqual((self.root / "etc/timezone").read_bytes(), b"Etc/GMT-1\n")
        self.bring_back_of_first_version(("link", b"../usr/share/zoneinfo/Europe/Berlin"), ("file", b"Europe/Berlin\n"))
        self.assertEqual(os.readlink(self.root / "etc/localtime"), "../usr/share/zoneinfo/Europe/Berlin")
        self.assertEqual((self.root / "etc/timezone").read_bytes(), b"Europe/Berlin\n")
        self.bring_back_of_first_version(("absent", b""), ("file", b""))
        self.assertEqual(os.listdir(self.root / "etc"), ["timezone"])

    def assert_the_zone_is_left_alone(self):
        self.assertIn("cannot be brought back", self.run_it())
        self.assertEqual(self.zone(), b"TZif2 other")
        self.assertEqual(sorted(os.listdir(self.root / "etc")), ["localtime", "timezone"])

    def test_leaves_the_zone_alone_where_the_kept_one_is_unusable(self):
        for what, local_time in [("a link that leads nowhere", "../usr/share/zoneinfo/Gone"), ("no zone", b"text"),
                                 ("nothing", b"")]:
            with self.subTest(what):
                self.keep(local_time)
                self.assert_the_zone_is_left_alone()
                (self.root / KEPT / "localtime").unlink()
                self.assert_the_zone_is_left_alone()
                (self.root / KEPT).rmdir()

    def test_leaves_the_zone_alone_where_that_of_the_first_version_is_unusable(self):
        of_berlin = of_first_version(("file", BERLIN))
        for what, data in [("a link that leads nowhere", of_first_version(("link", b"../usr/share/zoneinfo/Gone"))),
                           ("another header", of_berlin.replace(b"zone 1", b"zone 2")),
                           ("an unknown kind", of_first_version(("pipe", b"x"))),
                           ("a length that is none", b"vk-zone 1\nfile x\n"),
                           ("a file cut short", of_berlin[:30]), ("no end", of_berlin[:-1]), ("nothing", b"")]:
            with self.subTest(what):
                (self.root / OF_FIRST_VERSION).write_bytes(data)
                self.assert_the_zone_is_left_alone()
                self.run_it("forget_provider")
                (self.root / OF_FIRST_VERSION).parent.mkdir(parents=True)

    def test_forgets_everything_but_what_others_keep_there(self):
        (self.root / "var/lib/vk/registration").mkdir()
        self.run_it("forget_provider")
        self.assertFalse((self.root / "var/lib/vk").exists())
        (self.root / "var/lib/vk/other").mkdir(parents=True)
        self.run_it("forget_provider")
        self.assertTrue((self.root / "var/lib/vk/other").exists())

    def test_undoes_what_the_provider_did(self):
        vkcim = Path(os.environ["VK_BUILD_DIR"]) / "bin/vkcim"
        berlin = Path("/usr/share/zoneinfo/Europe/Berlin")
        if not berlin.exists():
            self.skipTest("no time zones here")
        (self.root / "usr/share/zoneinfo/Europe/Berlin").write_bytes(berlin.read_bytes())
        for before in ("link", "file"):
            (self.root / "etc/localtime").unlink()
            if before == "link":
                os.symlink("/usr/share/zoneinfo/Europe/Berlin", self.root / "etc/localtime")
            else:
                (self.root / "etc/localtime").write_bytes(berlin.read_bytes())
            env = {"VK_INSTRUMENTATION_ROOT": str(self.root), "NVLOG_SINK": "none", "PATH": "/usr/bin:/bin"}
            subprocess.run([vkcim, "modify", "VESKA_TimeService", "AutomaticDSTAdjustment=false"], env=env, check=True)
            self.assertTrue((self.root / KEPT).is_dir())
            self.assertNotEqual(self.zone(), berlin.read_bytes())
            self.run_it()
            self.assertEqual((self.root / "etc/localtime").is_symlink(), before == "link")
            if before == "link":
                self.assertEqual(os.readlink(self.root / "etc/localtime"), "/usr/share/zoneinfo/Europe/Berlin")
            else:
                self.assertEqual(self.zone(), berlin.read_bytes())
            self.assert_nothing_is_left_over()


class RpmScripts(unittest.TestCase):
    def test_hold_nothing_that_rpm_would_expand(self):
        for path in [SCRIPT, *(SOURCE / "packaging/rpm").glob("*.in")]:
            self.assertNotIn("%", path.read_text(encoding="utf-8"), path)


if __name__ == "__main__":
    unittest.main()
