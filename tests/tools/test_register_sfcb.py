"""vk-provider-register against an installation of SFCB that records what is asked of it."""

import os
import resource
import shutil
import subprocess
import unittest

import fakes
from registering import PREFIX, SHARE, Register
from support import LIBRARY, directory, snapshot_of

BUILDING = [f"sfcbstage -n root/cimv2 -r {SHARE}/vk-baseserver.reg {SHARE}/vk-baseserver.mof", "sfcbrepos -f"]
TAKING = ["sfcbunstage -n root/cimv2 -r vk-baseserver.reg vk-baseserver.mof", "sfcbrepos -f"]


class Sfcb(Register):
    link = f"usr/lib64/cmpi/{LIBRARY}"

    def test_installs_with_the_server_up(self):
        manager = fakes.sfcb(self.root, up=True)
        done = self.register("install")
        self.assertEqual(manager.calls(), ["systemctl stop sfcb", *BUILDING, "systemctl start sfcb"])
        self.assertEqual(os.readlink(self.root / self.link), f"{PREFIX}/lib/{LIBRARY}.1")
        self.assertIn("cimconfig: not found", done.stdout)
        self.assertTrue(manager.up)
        self.assertIn("registered already", self.register("install").stdout)
        self.assertEqual(manager.calls(), [])

    def test_installs_with_the_server_down_and_leaves_it_so(self):
        manager = fakes.sfcb(self.root, up=False)
        self.register("install")
        self.assertEqual(manager.calls(), BUILDING)
        self.assertFalse(manager.up)

    def test_remove_takes_everything_back(self):
        for up in (True, False):
            with self.subTest(up):
                self.root = directory()
                manager = fakes.sfcb(self.root, up)
                (self.root / "var/lib/sfcb/stage/regs").mkdir()
                (self.root / "var/lib/sfcb/stage/mofs/root/cimv2").mkdir(parents=True)
                self.register("install")
                manager.calls()
                self.register("remove")
                self.assertEqual(manager.calls(), ["systemctl stop sfcb", *TAKING, "systemctl start sfcb"] if up else TAKING)
                self.assertEqual((manager.staged, manager.register), ([], "[CIM_Default]\n"))
                self.assertFalse((self.root / self.link).is_symlink())
                self.assertFalse((self.root / "var/lib/vk").exists())

    def test_what_is_only_staged_goes_with_remove(self):
        manager = fakes.sfcb(self.root, up=False)
        self.register("install")
        shutil.rmtree(self.root / "var/lib/vk")
        (self.root / "var/lib/sfcb/registration/providerRegister").write_text("", encoding="ascii")
        self.register("remove")
        self.assertEqual(manager.staged, [])

    def test_status_looks_into_the_servers_own_directories(self):
        fakes.sfcb(self.root, up=True)
        self.register("install")
        shutil.rmtree(self.root / "var/lib/vk")
        self.register("status")
        (self.root / self.link).unlink()
        self.assertIn("does not lead to the library", self.register("status", status=1).stdout)
        self.register("install")
        registration = self.root / "var/lib/sfcb/registration"
        (registration / "repository/root/cimv2/classSchemas").write_text("VESKA_Other", encoding="ascii")
        self.assertIn("without the classes VESKA_ComputerSystem,", self.register("status", status=1).stdout)
        self.register("install")
        (self.root / "var/lib/sfcb/stage/mofs/root/cimv2/vk-baseserver.mof").write_text("other", encoding="ascii")
        self.assertIn("with other classes", self.register("status", status=1).stdout)
        (registration / "providerRegister").write_text("", encoding="ascii")
        self.assertIn("is not registered", self.register("status", status=1).stdout)

    def test_remove_takes_back_the_links_in_every_directory_that_was_named(self):
        fakes.sfcb(self.root, up=True)
        where = directory()
        self.register("install")
        self.register("--provider-dir", where, "install")
        self.register("install")
        self.assertTrue((where / LIBRARY).is_symlink())
        self.register("remove")
        self.assertFalse((where / LIBRARY).is_symlink())
        self.assertFalse((self.root / self.link).is_symlink())

    def test_dry_run_of_remove_changes_nothing(self):
        manager = fakes.sfcb(self.root, up=True)
        self.register("install")
        manager.calls()
        before = snapshot_of(self.root)
        for line in self.register("--dry-run", "remove").stdout.splitlines():
            self.assertTrue(line.startswith("would run: "), line)
        self.assertEqual(manager.calls(), [])
        self.assertEqual(snapshot_of(self.root), before)

    def test_a_dry_run_that_cannot_write_its_output_changes_nothing(self):
        manager = fakes.sfcb(self.root, up=True)
        said = self.register("--dry-run", "install").stdout
        manager.calls()
        before, room = snapshot_of(self.root), said.index("sfcbstage")
        with open(directory() / "output", "wb") as output:
            done = subprocess.run([PREFIX / "sbin/vk-provider-register", "--root", self.root, "--dry-run", "install"],
                                  stdout=output, stderr=subprocess.PIPE, check=False,
                                  preexec_fn=lambda: resource.setrlimit(resource.RLIMIT_FSIZE, (room, room)))
        self.assertEqual(done.returncode, 1, done.stderr)
        manager.calls()
        self.assertEqual(snapshot_of(self.root), before)

    def test_output_that_cannot_be_written_at_the_end_is_a_failure(self):
        fakes.sfcb(self.root, up=True)
        with open("/dev/full", "wb") as full:
            done = subprocess.run([PREFIX / "sbin/vk-provider-register", "--root", self.root, "--dry-run", "remove"],
                                  stdout=full, stderr=subprocess.PIPE, check=False)
        self.assertEqual(done.returncode, 1, done.stderr)
        self.assertIn(b"No space left on device", done.stderr)

    def test_a_failed_install_leaves_nothing_staged_and_the_repository_as_it_was(self):
        for harm in ("schema", "sfcbmofpp"):
            with self.subTest(harm):
                self.root = directory()
                manager = fakes.sfcb(self.root, up=True, without=[harm])
                (self.root / "var/lib/sfcb/registration/providerRegister").write_text("[CIM_Default]\n", encoding="ascii")
                manager.set("schema", "CIM_ManagedElement" if harm == "schema" else manager.get("schema"))
                self.register("install", status=1)
                self.assertEqual((manager.staged, manager.register, manager.up), ([], "[CIM_Default]\n", True))
                self.assertFalse((self.root / self.link).is_symlink())
                self.assertFalse((self.root / "var/lib/vk/registration/sfcb").exists())

    def test_a_newer_version_that_fails_leaves_the_older_one_in_force(self):
        manager = fakes.sfcb(self.root, up=True)
        self.register("install")
        (self.root / "var/lib/sfcb/registration/repository/root/cimv2/an_instance").touch()
        before, register = snapshot_of(self.root / "var/lib/sfcb"), manager.register
        prefix = directory() / "p"
        shutil.copytree(PREFIX, prefix, symlinks=True)
        mof = prefix / "share/vk-baseserver/vk-baseserver.mof"
        mof.write_text(mof.read_text(encoding="utf-8").replace(": CIM_ManagedElement", ": CIM_Gone"), encoding="utf-8")
        self.assertIn("Failed compiling", self.register("install", prefix=prefix, status=1).stderr)
        self.assertEqual(snapshot_of(self.root / "var/lib/sfcb"), before)
        self.assertEqual((manager.register, manager.up), (register, True))
        self.register("status")

    def test_an_older_cim_schema_is_named_before_anything_is_changed(self):
        manager = fakes.sfcb(self.root, up=True)
        (self.root / "usr/share/sfcb/CIM/Core/CIM_TimeService.mof").unlink()
        self.assertIn("2.22 or later is needed", self.register("install", status=1).stderr)
        self.assertEqual((manager.calls(), manager.staged), ([], []))
        self.assertFalse((self.root / "var/lib/vk").exists())

    def test_an_init_script_serves_where_systemd_does_not(self):
        manager = fakes.sfcb(self.root, up=True)
        manager.without_systemd()
        done = self.register("install")
        self.assertEqual(manager.calls(), ["sfcb stop", *BUILDING, "sfcb start"])
        self.assertEqual(done.stderr, "")
        self.assertTrue(manager.up)

    def test_a_server_that_is_down_is_not_stopped_whatever_its_init_script_says(self):
        manager = fakes.sfcb(self.root, up=False)
        manager.without_systemd()
        self.register("install")
        self.assertEqual(manager.calls(), BUILDING)
        self.assertFalse(manager.up)

    def test_a_server_that_does_not_listen_after_its_start_is_an_error(self):
        manager = fakes.sfcb(self.root, up=True)
        manager.without_systemd()
        manager.set("starts", "never")
        self.assertIn("failed: ", self.register("install", status=1).stderr)

    def test_systemctl_is_silent_where_systemd_does_not_run(self):
        manager = fakes.sfcb(self.root, up=False)
        manager.without_systemd(script=False)
        self.assertEqual(self.register("install").stderr, "")
        self.assertNotIn("systemctl", (self.root / "calls").read_text(encoding="ascii"))

    def test_a_server_that_was_started_by_hand_keeps_everything_as_it_is(self):
        manager = fakes.sfcb(self.root, up=True)
        manager.without_systemd(script=False)
        self.assertIn("stop it and run this again", self.register("install", status=1).stderr)
        self.assertEqual((manager.calls(), manager.staged), ([], []))
        self.assertFalse((self.root / self.link).is_symlink())
        manager.run_server(False)
        self.register("install")
        manager.run_server(True)
        self.assertIn("sfcbunstage -n root/cimv2 -r vk-baseserver.reg vk-baseserver.mof; sfcbrepos -f; rm -f",
                      self.register("remove", status=1).stderr)
        self.assertEqual(len(manager.staged), 2)

    def test_another_prefix_serves_with_its_own_commands_and_directories(self):
        manager = fakes.sfcb(self.root, up=False)
        manager.move(["sfcbd"], "opt/sfcb/sbin")
        manager.move([name for name in manager.commands if name.startswith("sfcb") and name != "sfcbd"], "opt/sfcb/bin")
        manager.set("sfcb-home", "opt/sfcb")
        shutil.rmtree(self.root / "etc/sfcb")
        (self.root / "opt/sfcb/lib/cmpi").mkdir(parents=True)
        self.register("install")
        self.assertEqual(len(manager.staged), 2)
        self.assertTrue((self.root / "opt/sfcb/lib/cmpi" / LIBRARY).is_symlink())
        self.assertFalse((self.root / self.link).is_symlink())
        self.register("status")
        self.register("remove")
        self.assertEqual(manager.staged, [])


if __name__ == "__main__":
    unittest.main()
