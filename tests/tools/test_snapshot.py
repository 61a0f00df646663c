"""vk-host-snapshot: what is copied, and where to."""

import os
import resource
import shutil
import unittest

from hosts import SNAPSHOT, make_host, properties, take
from support import directory, run, snapshot_of


class Plain(unittest.TestCase):
    def test_copies_what_the_provider_reads(self):
        root = make_host()
        target, done = take(root)
        self.assertEqual(done.returncode, 0, done.stderr)
        for name in ("sys/firmware/dmi/tables/DMI", "sys/firmware/dmi/tables/smbios_entry_point", "etc/machine-id",
                     "sys/class/dmi/id/product_uuid", "etc/hostname", "usr/share/zoneinfo/Europe/Berlin",
                     "sys/devices/system/edac/mc/mc0/ue_count"):
            self.assertEqual((target / name).read_bytes(), (root / name).read_bytes(), name)
        self.assertEqual(os.readlink(target / "etc/localtime"), "/usr/share/zoneinfo/Europe/Berlin")
        self.assertEqual((target / "proc/sys/kernel/arch").read_text(encoding="ascii").strip(), os.uname().machine)
        self.assertEqual(target.stat().st_mode & 0o777, 0o700)

    def test_tells_the_same_as_the_host(self):
        root = make_host()
        target, _ = take(root)
        for name in ("VESKA_ComputerSystem", "VESKA_PhysicalPackage"):
            self.assertEqual(properties(target, name), properties(root, name))

    def test_a_copy_of_a_copy_keeps_the_other_machines_architecture(self):
        target, _ = take(make_host(**{"proc/sys/kernel/arch": b"s390x\n"}))
        self.assertEqual((target / "proc/sys/kernel/arch").read_bytes(), b"s390x\n")

    def test_a_directory_that_holds_something_is_refused(self):
        root = make_host()
        self.assertEqual(run(SNAPSHOT, "--root", root, root).returncode, 2)
        self.assertEqual(run(SNAPSHOT).returncode, 2)

    @unittest.skipIf(os.geteuid() != 0, "takes root to become somebody else")
    def test_what_cannot_be_read_is_named(self):
        root = make_host()
        root.chmod(0o755)
        target = directory()
        os.chown(target, 65534, 65534)
        (root / "sys/firmware/dmi/tables/DMI").chmod(0o400)
        done = run("setpriv", "--reuid=65534", "--regid=65534", "--clear-groups", SNAPSHOT, "--root", root, target)
        if "vk-host-snapshot" not in done.stderr:
            self.skipTest(f"the program cannot be run as another user here: {done.stderr}")
        self.assertEqual(done.returncode, 1)
        self.assertIn("/sys/firmware/dmi/tables/DMI: Permission denied", done.stderr)


class Directory(unittest.TestCase):
    """Where a snapshot is written to, and who can read it."""

    def refused(self, target, *said):
        done = run(SNAPSHOT, "--root", make_host(), target)
        self.assertEqual(done.returncode, 2, done.stderr)
        for text in said:
            self.assertIn(text, done.stderr)

    @unittest.skipIf(os.geteuid() != 0, "takes root to give a directory to somebody else")
    def test_somebody_elses_is_refused(self):
        target = directory()
        os.chown(target, 65534, 65534)
        self.refused(target, f"{target} belongs to somebody else")
        self.assertEqual(list(target.iterdir()), [])

    def test_one_open_to_others_is_refused(self):
        for mode in (0o755, 0o750, 0o701, 0o733):
            target = directory()
            target.chmod(mode)
            self.refused(target, f"{target} is open to others", "chmod 700")
            self.assertEqual((list(target.iterdir()), target.stat().st_mode & 0o777), ([], mode))

    def test_a_link_is_refused(self):
        elsewhere, link = directory(), directory() / "link"
        link.symlink_to(elsewhere)
        self.refused(link, "link: Not a directory")
        self.refused(f"{link}/", "link: Not a directory")
        self.assertEqual(list(elsewhere.iterdir()), [])

    def test_all_in_it_is_closed_to_others(self):
        root = make_host(**{"sys/class/dmi/id/product_name": b"RX200\n"})
        for parents, empty in [("copy", False), ("deep/copy", False), ("copy", True)]:
            target = directory() / parents
            if empty:
                target.mkdir(mode=0o700)
            done = run("sh", "-c", 'umask 0; exec "$@"', "sh", SNAPSHOT, "--root", root, target)
            self.assertEqual(done.returncode, 0, done.stderr)
            found = {str(p.relative_to(target)): p.stat().st_mode & 0o777 for p in target.rglob("*") if not p.is_symlink()}
            for name in ("etc/machine-id", "sys/class/dmi/id/product_serial", "sys/firmware/dmi/tables/DMI"):
                self.assertEqual(found[name], 0o600)
            self.assertEqual({m for n, m in found.items() if (target / n).is_dir()}, {0o700})
            self.assertEqual({m for n, m in found.items() if not (target / n).is_dir()}, {0o600})
            self.assertEqual({target.stat().st_mode & 0o777, target.parent.stat().st_mode & 0o777}, {0o700})

    def test_the_example_is_not_where_everybody_writes(self):
        self.assertNotIn("/tmp", run(SNAPSHOT, "--help").stdout)


class Failure(unittest.TestCase):
    def test_a_root_that_is_no_directory_is_refused(self):
        target = directory() / "copy"
        for root in ("/nonexistent", SNAPSHOT):
            done = run(SNAPSHOT, "--root", root, target)
            self.assertEqual(done.returncode, 2)
            self.assertIn(f"{root} is no directory", done.stderr)
            self.assertFalse(target.exists())

    def test_a_write_error_names_the_file_and_leaves_nothing(self):
        root = make_host(**{"etc/timezone": b"x" * 5000})
        for limit, name in [(0, "sys/firmware/dmi/tables/smbios_entry_point"), (4096, "etc/timezone")]:
            for parent in (directory(), directory() / "deep"):
                before = snapshot_of(parent.parent if parent.name == "deep" else parent)
                target = parent / "copy"
                done = run(SNAPSHOT, "--root", root, target,
                           preexec_fn=lambda limit=limit: resource.setrlimit(resource.RLIMIT_FSIZE, (limit, limit)))
                self.assertEqual(done.returncode, 1, done.stderr)
                self.assertEqual(done.stderr, f"vk-host-snapshot: {target}/{name}: File too large; "
                                              "nothing is left of the snapshot\n")
                self.assertEqual(snapshot_of(parent.parent if parent.name == "deep" else parent), before)

    def test_a_write_error_leaves_a_directory_that_was_there(self):
        target = directory()
        done = run(SNAPSHOT, "--root", make_host(), target,
                   preexec_fn=lambda: resource.setrlimit(resource.RLIMIT_FSIZE, (0, 0)))
        self.assertEqual((done.returncode, list(target.iterdir())), (1, []))

    @unittest.skipUnless(shutil.which("strace"), "strace is not installed")
    def test_one_that_is_interrupted_leaves_nothing(self):
        for name in ("SIGHUP", "SIGINT", "SIGTERM"):
            target = directory() / "copy"
            # A leak check at the end, where one is built in, fails under a tracer.
            done = run("strace", "-E", "ASAN_OPTIONS=detect_leaks=0", "-qq", "-o", "/dev/null", "-e", "trace=symlinkat", "-e", f"inject=symlinkat:signal={name}",
                       SNAPSHOT, "--root", make_host(), target)
            self.assertEqual((done.returncode, done.stderr),
                             (1, "vk-host-snapshot: interrupted; nothing is left of the snapshot\n"), name)
            self.assertFalse(target.exists())


if __name__ == "__main__":
    unittest.main()
