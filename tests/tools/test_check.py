"""vk-provider-check on hosts made of a few files."""

import json
import os
import re
import unittest
from pathlib import Path

from support import BUILD, NOBODY, directory, run, run_as_nobody, widest

CHECK = BUILD / "installed/vk-provider-check"


def make_host(without=()):
    """A host on which everything is there, but for what is named."""
    root = directory()
    files = {"sys/firmware/dmi/tables/smbios_entry_point": b"_SM_", "sys/firmware/dmi/tables/DMI": b"\x7f\x04",
             "etc/machine-id": b"0123456789abcdef0123456789abcdef\n", "etc/localtime": b"TZif2",
             "usr/share/zoneinfo/Etc/GMT": b"TZif2", "bin/ps": b"", "bin/ntpd": b"", "etc/init.d/ntp": b"",
             "usr/sbin/cimconfig": b"", "sys/class/dmi/id/sys_vendor": b"QEMU\n"}
    (root / "etc").mkdir()
    for name, data in files.items():
        if name in without:
            continue
        path = root / name
        path.parent.mkdir(parents=True, exist_ok=True)
        path.write_bytes(data)
        path.chmod(0o755)
    return root


def check(root, *words, **env):
    return run(CHECK, "--root", root, "--format", "json", *words, env={"PATH": "/bin", **env})


def missing(done, part=None):
    return {c["name"]: c for c in json.loads(done.stdout)["checks"] if not c["found"] and part in (None, c["part"])}


class Check(unittest.TestCase):
    # Rights are those of this process, whatever the host looks like.
    RIGHTS = {"right to set the clock", "right to change the zone"}

    def test_finds_everything(self):
        for asked in ("reading", "setting"):
            done = check(make_host(), asked)
            self.assertEqual(set(missing(done)) - self.RIGHTS, set())
            answer = json.loads(done.stdout)
            self.assertEqual((answer["asked"], answer["missing"]), (asked, len(missing(done, asked))))
            self.assertEqual(done.returncode, 1 if answer["missing"] else 0)
            self.assertEqual({k for c in answer["checks"] for k in c}, {"part", "name", "found", "detail", "without"})

    def test_names_each_thing_that_is_missing_and_what_fails_then(self):
        for part, file, name, effect in [
                ("reading", "sys/firmware/dmi/tables/DMI", "hardware tables", "VESKA_PhysicalPackage"),
                ("reading", "etc/machine-id", "machine id", "unique identifier"),
                ("reading", "etc/localtime", "time zone", "UTC"),
                ("reading", "usr/sbin/cimconfig", "cimconfig", "VESKA_CIMServiceConfig"),
                ("setting", "usr/sbin/cimconfig", "cimconfig", "SetCIMconfig"),
                ("setting", "usr/share/zoneinfo/Etc/GMT", "time zones", "file of its own"),
                ("setting", "bin/ps", "ps", "not running"), ("setting", "bin/ntpd", "ntpd", "ManageTime"),
                ("setting", "etc/init.d/ntp", "/etc/init.d/ntp", "ManageTime")]:
            with self.subTest(file):
                done = check(make_host(without=[file]), part)
                self.assertEqual(done.returncode, 1)
                self.assertEqual(set(missing(done)) - self.RIGHTS, {name})
                self.assertIn(effect, missing(done, part)[name]["without"])

    def test_ends_by_what_the_part_that_was_asked_for_lacks(self):
        no_daemon, no_tables = make_host(without=["bin/ntpd"]), make_host(without=["sys/firmware/dmi/tables/DMI"])
        self.assertEqual([check(no_daemon, *words).returncode for words in ([], ["reading"], ["setting"])], [0, 0, 1])
        self.assertEqual([check(no_tables, *words).returncode for words in ([], ["reading"])], [1, 1])
        done = check(no_tables, "setting")
        self.assertEqual(done.returncode, 1 if set(missing(done)) & self.RIGHTS else 0)
        self.assertIn("hardware tables", missing(done))

    def test_tells_a_file_without_use_from_one_that_is_there(self):
        root = make_host()
        (root / "etc/machine-id").write_bytes(b"\n")
        (root / "etc/localtime").write_bytes(b"something else")
        (root / "bin/ntpd").chmod(0o644)
        found = missing(check(root))
        self.assertIn("empty", found["machine id"]["detail"])
        self.assertIn("no time zone file", found["time zone"]["detail"])
        self.assertIn("not in PATH", found["ntpd"]["detail"])

    def test_looks_for_cimconfig_where_the_provider_does(self):
        root = make_host()
        (root / "sys/class/dmi/id/sys_vendor").write_bytes(b"Example\n")
        detail = missing(check(root))["cimconfig"]["detail"]
        self.assertIn("/lib/vk/vcm/bin/cimconfig", detail)
        there = Path(root / detail.split("cimconfig")[0].lstrip("/") / "cimconfig")
        there.parent.mkdir(parents=True)
        there.write_bytes(b"")
        there.chmod(0o755)
        self.assertNotIn("cimconfig", missing(check(root)))

    def test_a_device_tree_serves_in_place_of_tables(self):
        root = make_host(without=["sys/firmware/dmi/tables/DMI", "sys/firmware/dmi/tables/smbios_entry_point"])
        (root / "proc/device-tree").mkdir(parents=True)
        (root / "proc/device-tree/model").write_bytes(b"Board\0")
        self.assertNotIn("hardware tables", missing(check(root)))

    def missing_for_nobody(self, root):
        """What is missing for a user without rights."""
        root.chmod(0o755)
        return missing(run_as_nobody(CHECK, "--root", root, "--format", "json", env={"PATH": "/bin:/usr/bin"}))

    @unittest.skipIf(os.geteuid() != 0, "takes root to become somebody else")
    def test_passes_over_directories_in_path_that_may_not_be_entered(self):
        root = make_host()
        for name in ("closed", "gone/below"):
            (root / name).mkdir(parents=True)
            (root / name / "ntpd").write_bytes(b"")
            (root / name / "ntpd").chmod(0o755)
        (root / "closed").chmod(0o700)
        (root / "gone").chmod(0o000)
        path = "/closed:/gone/below::/nonexistent:/etc/machine-id:/bin"
        root.chmod(0o755)
        done = run_as_nobody(CHECK, "--root", root, "--format", "json", "reading", env={"PATH": path})
        self.assertEqual((done.returncode, done.stderr), (0, ""))
        found = {c["name"]: c["detail"] for c in json.loads(done.stdout)["checks"] if c["found"]}
        self.assertEqual((found["ntpd"], found["ps"]), ("/bin/ntpd", "/bin/ps"))

    @unittest.skipIf(os.geteuid() != 0, "takes root to become somebody else")
    def test_a_root_that_may_not_be_entered_is_refused(self):
        closed = directory()
        (closed / "host").mkdir()
        done = run_as_nobody(CHECK, "--root", closed / "host")
        self.assertEqual(done.returncode, 2, done.stderr)
        self.assertIn(f"vk-provider-check: {closed}/host: Permission denied\n", done.stderr)

    @unittest.skipIf(os.geteuid() != 0, "takes root to become somebody else")
    def test_knows_what_a_user_without_rights_cannot_do(self):
        root = make_host()
        (root / "sys/firmware/dmi/tables/DMI").chmod(0o400)
        found = self.missing_for_nobody(root)
        self.assertEqual(set(found), {"hardware tables"} | self.RIGHTS)
        self.assertIn("no right to read it", found["hardware tables"]["detail"])

    @unittest.skipIf(os.geteuid() != 0, "takes root to become somebody else")
    def test_asks_for_the_right_to_keep_the_zone_that_is_replaced(self):
        root = make_host()
        (root / "var/lib").mkdir(parents=True)
        zone = "right to change the zone"
        self.assertEqual(self.missing_for_nobody(root)[zone]["detail"],
                         "/etc and /var/lib/vk/instrumentation cannot be written")
        os.chown(root / "etc", NOBODY, NOBODY)
        self.assertEqual(self.missing_for_nobody(root)[zone]["detail"], "/var/lib/vk/instrumentation cannot be written")
        os.chown(root / "var/lib", NOBODY, NOBODY)
        self.assertNotIn(zone, self.missing_for_nobody(root))
        (root / "var/lib/vk/instrumentation").mkdir(parents=True)
        self.assertIn(zone, self.missing_for_nobody(root))
        os.chown(root / "var/lib/vk/instrumentation", NOBODY, NOBODY)
        self.assertNotIn(zone, self.missing_for_nobody(root))

    def test_takes_a_file_for_no_directory_to_write_in(self):
        root = make_host()
        (root / "var/lib").mkdir(parents=True)
        (root / "var/lib/vk").write_bytes(b"")
        self.assertEqual(missing(check(root))["right to change the zone"]["detail"],
                         "/var/lib/vk/instrumentation cannot be written")

    def test_prints_for_people(self):
        done = run(CHECK, "--root", make_host(without=["bin/ntpd"]), env={"PATH": "/bin"})
        self.assertEqual(re.findall(r"(?m)^For (.*):$", done.stdout), ["reading", "setting"])
        self.assertLess(done.stdout.index("machine id"), done.stdout.index("For setting:"))
        self.assertRegex(done.stdout, r"(?m)^MISSING  ntpd +not in PATH$")
        self.assertRegex(done.stdout, r"(?m)^found    ps +/bin/ps$")
        self.assertIn("without it: ManageTime", done.stdout)

    def test_refuses_unusable_arguments(self):
        self.assertEqual(run(CHECK, "--format", "xml").returncode, 2)
        done = run(CHECK, "writing")
        self.assertEqual(done.returncode, 2)
        self.assertIn("reading,setting", done.stderr)
        self.assertEqual(run(CHECK, "--root", "/nonexistent").returncode, 2)
        self.assertIn("Example:", run(CHECK, "--help").stdout)

    def test_the_help_is_as_wide_as_the_terminal(self):
        self.assertLessEqual(widest(run(CHECK, "--help", env={"COLUMNS": "80"}).stdout), 80)
        self.assertGreater(widest(run(CHECK, "--help").stdout), 80)


if __name__ == "__main__":
    unittest.main()
