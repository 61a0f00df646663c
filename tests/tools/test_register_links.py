"""The links that vk-provider-register makes: only its own are ever replaced or removed."""

import json
import os
import shutil
import unittest

import fakes
from registering import PREFIX, Register
from support import BUILD, LIBRARY, directory, run


class Library(Register):
    link = f"usr/lib64/Pegasus/providers/{LIBRARY}"

    def test_a_file_of_somebody_else_is_never_replaced_nor_removed(self):
        fakes.pegasus(self.root, up=True)
        (self.root / self.link).write_text("somebody else's", encoding="ascii")
        self.assertIn("no link: not replaced", self.register("install", status=1).stderr)
        self.register("remove")
        self.assertEqual((self.root / self.link).read_text(encoding="ascii"), "somebody else's")

    def test_a_link_of_somebody_else_is_never_replaced_nor_removed(self):
        theirs = "../../../../opt/other/libsomebody.so.9"
        manager = fakes.pegasus(self.root, up=True)
        (self.root / self.link).symlink_to(theirs)
        self.assertIn(f"{self.link} links to {theirs}, which is not ours: not replaced",
                      self.register("install", status=1).stderr)
        self.assertEqual(manager.calls(), [])
        self.assertIn("was not made here and stays", self.register("remove").stdout)
        self.assertEqual(os.readlink(self.root / self.link), theirs)

    def test_a_link_that_was_changed_since_stays(self):
        fakes.pegasus(self.root, up=True)
        self.register("install")
        (self.root / self.link).unlink()
        (self.root / self.link).symlink_to("/opt/mine/libmine.so")
        self.register("status", status=1)
        self.assertIn("leads to /opt/mine/libmine.so, was not made here and stays", self.register("remove").stdout)
        self.assertTrue((self.root / self.link).is_symlink())
        self.assertFalse((self.root / "var/lib/vk").exists())

    def test_a_link_that_was_there_already_serves_and_stays(self):
        fakes.pegasus(self.root, up=True)
        (self.root / self.link).symlink_to(PREFIX / "lib" / f"{LIBRARY}.1")
        self.register("install")
        self.register("status")
        self.assertIn("was not made here and stays", self.register("remove").stdout)
        self.assertTrue((self.root / self.link).is_symlink())

    def test_a_link_to_another_installation_of_the_library_is_replaced(self):
        fakes.pegasus(self.root, up=True)
        (self.root / self.link).symlink_to(f"/opt/older/lib/{LIBRARY}.1")
        self.register("install")
        self.assertEqual(os.readlink(self.root / self.link), f"{PREFIX}/lib/{LIBRARY}.1")
        self.register("remove")
        self.assertFalse((self.root / self.link).is_symlink())

    def test_an_installation_that_fails_takes_its_link_back(self):
        manager = fakes.pegasus(self.root, up=True)
        manager.set("fail", "cimmof")
        self.register("install", status=1)
        self.assertFalse((self.root / self.link).is_symlink())
        self.register("remove")
        self.assertFalse((self.root / "var/lib/vk").exists())

    def test_a_named_provider_directory_wins(self):
        fakes.pegasus(self.root, up=True).set("any-directory", "yes")
        where = directory()
        self.register("--provider-dir", where, "install")
        self.assertTrue((where / LIBRARY).is_symlink())
        self.assertFalse((self.root / self.link).is_symlink())
        self.register("remove")
        self.assertFalse((where / LIBRARY).is_symlink())

    def test_remove_takes_back_the_links_in_every_directory_that_was_named(self):
        fakes.pegasus(self.root, up=True).set("any-directory", "yes")
        self.register("install")
        where = directory()
        self.register("--provider-dir", where, "install")
        self.assertTrue((where / LIBRARY).is_symlink())
        (self.root / self.link).unlink()
        self.register("status")  # the last directory counts
        self.register("--provider-dir", self.root / "usr/lib64/Pegasus/providers", "install")
        self.register("remove")
        self.assertFalse((where / LIBRARY).is_symlink())
        self.assertFalse((self.root / self.link).is_symlink())


class Cimconfig(Register):
    """The link to the object manager's command, where the provider looks for it."""

    def setUp(self):
        super().setUp()
        self.manager = fakes.pegasus(self.root, up=True)

    def usual_place(self):
        self.register("install")
        place = self.root / self.cimconfig_link()[0]
        self.register("remove")
        return place

    def move_command_to_opt(self):
        (self.root / "opt/tog-pegasus/bin").mkdir(parents=True)
        (self.root / "usr/sbin/cimconfig").rename(self.root / "opt/tog-pegasus/bin/cimconfig")

    def make_kvm_guest(self, file="sys/class/dmi/id/sys_vendor", text="QEMU\n"):
        path = self.root / file
        path.parent.mkdir(parents=True)
        path.write_text(text, encoding="ascii")

    def test_goes_with_the_last_registration_whichever_way_that_goes(self):
        fakes.sfcb(self.root, up=False)
        self.register("--manager", "openpegasus", "install")
        self.register("--manager", "sfcb", "install")
        self.register("--manager", "sfcb", "remove")
        place = self.root / self.cimconfig_link()[0]
        self.assertTrue(place.is_symlink())
        self.register("--manager", "openpegasus", "remove")
        self.assertFalse(place.is_symlink())
        self.assertFalse(place.parents[2].exists())
        self.assertFalse((self.root / "var/lib/vk").exists())

    def test_made_by_somebody_else_is_left_alone(self):
        place = self.usual_place()
        place.parent.mkdir(parents=True)
        for target in ("/usr/sbin/cimconfig", "/usr/local/sbin/cimconfig"):
            with self.subTest(target):
                theirs = self.root / target.lstrip("/")
                theirs.parent.mkdir(parents=True, exist_ok=True)
                if not theirs.exists():
                    shutil.copy(self.root / "usr/sbin/cimconfig", theirs)
                place.symlink_to(target)
                self.assertIn(f"cimconfig: {place} is there already", self.register("install").stdout)
                self.assertEqual(os.readlink(place), target)
                self.assertIn(f"{place} leads to {target}, was not made here and stays", self.register("remove").stdout)
                self.assertEqual(os.readlink(place), target)
                place.unlink()

    def test_made_by_somebody_else_serves_wherever_its_relative_links_lead(self):
        self.make_kvm_guest()
        self.move_command_to_opt()
        (self.root / "etc/alternatives").mkdir(parents=True)
        (self.root / "etc/alternatives/cimconfig").symlink_to("/opt/tog-pegasus/bin/cimconfig")
        for target in ("../../opt/tog-pegasus/bin/cimconfig", "../../etc/alternatives/cimconfig"):
            with self.subTest(target):
                place = self.root / "usr/sbin/cimconfig"
                place.symlink_to(target)
                self.assertIn(f"{place} is there already", self.register("install").stdout)
                place.unlink()

    def test_made_by_somebody_else_and_leading_nowhere_is_told(self):
        place = self.usual_place()
        place.parent.mkdir(parents=True)
        place.symlink_to("/opt/gone/cimconfig")
        self.assertIn("links to /opt/gone/cimconfig, which is not ours", self.register("install", status=1).stderr)
        self.assertEqual(os.readlink(place), "/opt/gone/cimconfig")

    def test_follows_the_command(self):
        self.register("install")
        self.move_command_to_opt()
        self.register("install")
        self.assertEqual(self.cimconfig_link()[1], "/opt/tog-pegasus/bin/cimconfig")
        self.register("remove")
        self.assertIsNone(self.cimconfig_link())

    def test_is_not_needed_in_a_kvm_guest_with_the_command_in_its_place(self):
        self.make_kvm_guest()
        self.assertIn("usr/sbin/cimconfig is there already", self.register("install").stdout)
        self.assertIsNone(self.cimconfig_link())
        self.register("remove")
        self.assertTrue((self.root / "usr/sbin/cimconfig").is_file())

    def test_lies_in_usr_sbin_in_a_kvm_guest(self):
        self.make_kvm_guest()
        self.move_command_to_opt()
        (self.root / "sbin").symlink_to("usr/sbin")
        expected = ("usr/sbin/cimconfig", "/opt/tog-pegasus/bin/cimconfig")
        self.register("install")
        self.assertEqual(self.cimconfig_link(), expected)
        self.register("install")
        self.assertEqual(self.cimconfig_link(), expected)
        self.register("remove")
        self.assertIsNone(self.cimconfig_link())
        self.assertTrue((self.root / "usr/sbin").is_dir())

    def test_never_leads_to_itself(self):
        # As where / is the root: the link can be followed, and is found by both names of its directory.
        self.make_kvm_guest()
        self.move_command_to_opt()
        (self.root / "sbin").symlink_to("usr/sbin")
        home = directory()
        for where in (home / "bin", self.root / str(home / "bin").lstrip("/")):
            where.mkdir(parents=True)
            shutil.copy(self.root / "opt/tog-pegasus/bin/cimconfig", where)
        self.register("install", PEGASUS_HOME=str(home))
        self.assertEqual(self.cimconfig_link()[1], f"{home}/bin/cimconfig")
        (self.root / "opt/tog-pegasus/bin/cimconfig").unlink()
        self.assertIn(f"links to {home}/bin/cimconfig already", self.register("install").stdout)
        self.assertEqual(self.cimconfig_link()[1], f"{home}/bin/cimconfig")

    def test_is_where_the_check_asks_for_it(self):
        clocks = "sys/devices/system/clocksource/clocksource0/available_clocksource"
        for file, text in [(clocks, "tsc kvm-clock\n"), (clocks, "tsc hpet\n"), ("sys/class/dmi/id/sys_vendor", "QEMU\n"),
                           ("sys/class/dmi/id/sys_vendor", "Example\n"), ("sys/class/dmi/id/product_name", "KVM\n"),
                           ("sys/class/dmi/id/product_name", "Not KVM\n")]:
            with self.subTest(text):
                self.root = directory()
                fakes.pegasus(self.root, up=True)
                self.make_kvm_guest(file, text)
                self.move_command_to_opt()
                self.register("install")
                done = run(BUILD / "installed/vk-provider-check", "--root", self.root, "--format", "json")
                asked = next(c for c in json.loads(done.stdout)["checks"] if c["name"] == "cimconfig")
                self.assertEqual(asked["detail"].split(" ")[0], "/" + self.cimconfig_link()[0])


if __name__ == "__main__":
    unittest.main()
