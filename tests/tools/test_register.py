"""vk-provider-register against installations of both kinds of object managers that record what is asked of them."""

import os
import shutil
import unittest

import fakes
from registering import CLASSES, MODULE, PREFIX, SHARE, Register
from support import LIBRARY, folder, snapshot_of


class WithoutObjectManager(Register):
    def test_says_so_and_succeeds(self):
        for action in ("install", "status", "remove"):
            done = self.register(action)
            self.assertIn("No object manager found", done.stdout)
            self.assertEqual(done.stderr, "")
        self.assertEqual(snapshot_of(self.root), {})

    def test_half_an_installation_is_none(self):
        fakes.pegasus(self.root, up=True, without=["cimmof"])
        self.assertIn("No object manager found", self.register("install").stdout)


class OpenPegasus(Register):
    link = f"usr/lib64/Pegasus/providers/{LIBRARY}"

    def registering(self, mof="vk-baseserver"):
        return [f"cimmof -n root/cimv2 {SHARE}/{mof}.mof", f"cimmof -n root/PG_InterOp {SHARE}/{mof}-registration.mof"]

    def test_installs_with_the_server_up(self):
        manager = fakes.pegasus(self.root, up=True)
        done = self.register("install")
        self.assertEqual(manager.calls(), self.registering())
        self.assertEqual(os.readlink(self.root / self.link), f"{PREFIX}/lib/{LIBRARY}.1")
        self.assertIn(f"OpenPegasus: registered the module {MODULE}", done.stdout)
        where, target = self.cimconfig_link()
        self.assertTrue(where.endswith("lib/vk/vcm/bin/cimconfig"), where)
        self.assertEqual(target, "/usr/sbin/cimconfig")
        self.assertTrue(manager.up)

    def test_starts_a_server_that_is_down_and_stops_it_again(self):
        manager = fakes.pegasus(self.root, up=False)
        self.register("install")
        self.assertEqual(manager.calls(), ["cimserver", *self.registering(), "cimserver -s"])
        self.assertFalse(manager.up)
        self.register("remove")
        self.assertEqual(manager.calls()[0], "cimserver")
        self.assertFalse(manager.up)

    def test_a_second_install_changes_nothing(self):
        manager = fakes.pegasus(self.root, up=True)
        self.register("install")
        before = snapshot_of(self.root)
        manager.calls()
        done = self.register("install")
        self.assertEqual(manager.calls(), [])
        self.assertIn("registered already", done.stdout)
        before["calls"] = b""
        self.assertEqual(snapshot_of(self.root), before)

    def test_a_new_library_is_taken_into_use(self):
        prefix = folder() / "p"
        shutil.copytree(PREFIX, prefix, symlinks=True)
        manager = fakes.pegasus(self.root, up=True)
        self.register("install", prefix=prefix)
        manager.calls()
        library = prefix / "lib" / f"{LIBRARY}.1"
        shutil.copy(library, library.with_suffix(".new"))
        os.replace(library.with_suffix(".new"), library)
        self.register("install", prefix=prefix)
        self.assertEqual(manager.calls(), [f"cimprovider -d -m {MODULE}", f"cimprovider -e -m {MODULE}"])

    def test_a_changed_registration_is_made_anew(self):
        prefix = folder() / "p"
        shutil.copytree(PREFIX, prefix, symlinks=True)
        manager = fakes.pegasus(self.root, up=True)
        self.register("install", prefix=prefix)
        manager.calls()
        share = prefix / "share/vk-baseserver"
        with open(share / "vk-baseserver.mof", "a", encoding="ascii") as file:
            file.write("// newer\n")
        self.register("install", prefix=prefix)
        self.assertEqual(manager.calls(), [
            f"cimprovider -d -m {MODULE}", f"cimprovider -r -m {MODULE}",
            f"cimmof -uC -n root/cimv2 {share}/vk-baseserver.mof",
            f"cimmof -n root/PG_InterOp {share}/vk-baseserver-registration.mof"])

    def test_remove_takes_everything_back(self):
        manager = fakes.pegasus(self.root, up=True)
        manager.calls()
        before = snapshot_of(self.root)
        self.register("install")
        manager.calls()
        self.register("remove")
        self.assertEqual(manager.calls(), [
            f"cimprovider -d -m {MODULE}", f"cimprovider -r -m {MODULE}",
            *[f"cimcli dc -n root/cimv2 {name}" for name in reversed(CLASSES)]])
        after = snapshot_of(self.root)
        self.assertEqual(after.pop("state/classes"), b"")
        self.assertEqual(after, before)
        self.register("remove")
        self.assertEqual(manager.calls(), [])

    def test_remove_says_that_classes_stay_without_cimcli(self):
        fakes.pegasus(self.root, up=True, without=["cimcli"])
        self.register("install")
        self.assertIn("the classes stay declared", self.register("remove").stdout)

    def test_dry_run_changes_nothing(self):
        for up in (True, False):
            self.root = folder()
            manager = fakes.pegasus(self.root, up=up)
            manager.calls()
            before = snapshot_of(self.root)
            done = self.register("--dry-run", "install")
            self.assertIn(f"would run: {self.root}/usr/sbin/cimmof -n root/cimv2", done.stdout)
            self.assertEqual(manager.calls(), [])
            self.assertEqual(snapshot_of(self.root), before)

    def test_dry_run_of_remove_says_what_it_would_do_and_changes_nothing(self):
        for up in (True, False):
            self.root = folder()
            manager = fakes.pegasus(self.root, up=up)
            self.register("install")
            manager.calls()
            before = snapshot_of(self.root)
            lines = self.register("--dry-run", "remove").stdout.splitlines()
            self.assertEqual(manager.calls(), [])
            self.assertEqual(snapshot_of(self.root), before)
            sbin, started = f"would run: {self.root}/usr/sbin", [] if up else ["cimserver"]
            self.assertEqual(lines, [
                *[f"{sbin}/{command}" for command in started],
                f"{sbin}/cimprovider -d -m {MODULE}", f"{sbin}/cimprovider -r -m {MODULE}",
                *[f"{sbin}/cimcli dc -n root/cimv2 {name}" for name in reversed(CLASSES)],
                *[f"{sbin}/{command} -s" for command in started],
                f"would run: rm -f {self.root / self.link}",
                f"would run: rm -f {self.root / self.cimconfig_link()[0]}"])

    def test_a_server_that_never_answers_is_stopped_again(self):
        for action in ("install", "remove"):
            with self.subTest(action):
                self.root = folder()
                manager = fakes.pegasus(self.root, up=False)
                if action == "remove":
                    self.register("install")
                    manager.calls()
                manager.program("cimprovider", "exit 1")
                programs = folder()
                (programs / "sleep").symlink_to("/bin/true")
                done = self.register(action, status=1, PATH=f"{programs}:/usr/bin:/bin")
                self.assertIn("does not answer after its start", done.stderr)
                self.assertEqual(manager.calls(), ["cimserver", "cimserver -s"])
                self.assertFalse(manager.up)

    def test_a_module_that_is_disabled_already_is_removed(self):
        manager = fakes.pegasus(self.root, up=True)
        whole = (self.root / "usr/sbin/cimprovider").read_text(encoding="ascii")
        self.register("install")
        refusing = whole.split("}\n", 1)[1].replace("-l)", "-d) echo disabled already >&2; exit 1 ;;\n-l)")
        manager.program("cimprovider", refusing)
        self.assertIn("was not disabled: disabled already", self.register("remove").stdout)
        self.assertFalse((self.root / self.link).is_symlink())
        self.assertEqual((self.root / "state/modules").read_text(encoding="ascii"), "")
        self.assertFalse((self.root / "var/lib/vk").exists())

    def test_status_notices_what_keeps_a_registration_from_serving(self):
        prefix = folder() / "p"
        shutil.copytree(PREFIX, prefix, symlinks=True)
        fakes.pegasus(self.root, up=True)
        stamp = self.root / "var/lib/vk/registration/openpegasus"
        mof = prefix / "share/vk-baseserver/vk-baseserver.mof"
        for harm, flaw in [((self.root / self.link).unlink, "does not lead to the library"),
                           (stamp.unlink, "nothing is noted of it"),
                           (lambda: mof.write_text(mof.read_text() + "// newer\n"), "other classes")]:
            self.register("install", prefix=prefix)
            self.assertNotIn("but", self.register("status", prefix=prefix).stdout)
            harm()
            self.assertIn(flaw, self.register("status", prefix=prefix, status=1).stdout)

    def test_status_tells_by_its_exit_status_too(self):
        fakes.pegasus(self.root, up=True)
        self.assertIn("is not registered", self.register("status", status=1).stdout)
        self.register("install")
        self.assertIn("is registered", self.register("status").stdout)

    def test_a_failing_command_is_shown_and_nothing_counts_as_done(self):
        manager = fakes.pegasus(self.root, up=True)
        manager.program("cimmof", 'echo "no space left" >&2; exit 1')
        done = self.register("install", status=1)
        self.assertIn("no space left", done.stderr)
        self.register("status", status=1)
        self.assertFalse((self.root / "var/lib/vk/registration/openpegasus").exists())

    def test_an_installation_that_broke_off_is_finished_by_the_next(self):
        manager = fakes.pegasus(self.root, up=True)
        whole = (self.root / "usr/sbin/cimmof").read_text(encoding="ascii")
        manager.program("cimmof", whole.split("}\n", 1)[1].replace("root/PG_InterOp)", "root/PG_InterOp) exit 1"))
        self.register("install", status=1)
        (self.root / "usr/sbin/cimmof").write_text(whole, encoding="ascii")
        manager.calls()
        self.register("install")
        classes, registration = self.registering()
        self.assertEqual(manager.calls(), [classes, classes.replace("cimmof", "cimmof -uC"), registration])
        self.register("status")

    def test_remove_after_the_object_manager_went_takes_back_the_rest(self):
        fakes.pegasus(self.root, up=True)
        self.register("install")
        shutil.rmtree(self.root / "usr/sbin")
        self.register("remove")
        self.assertFalse((self.root / self.link).is_symlink())
        self.assertFalse((self.root / "var/lib/vk").exists())
        self.assertIsNone(self.cimconfig_link())


class Sfcb(Register):
    link = f"usr/lib64/cmpi/{LIBRARY}"
    staging = f"sfcbstage -n root/cimv2 -r {SHARE}/vk-baseserver.reg {SHARE}/vk-baseserver.mof"

    def test_installs_with_the_server_up(self):
        manager = fakes.sfcb(self.root, up=True)
        done = self.register("install")
        self.assertEqual(manager.calls(), ["systemctl stop sfcb", self.staging, "sfcbrepos -f", "systemctl start sfcb"])
        self.assertEqual(os.readlink(self.root / self.link), f"{PREFIX}/lib/{LIBRARY}.1")
        self.assertIn("cimconfig: not found", done.stdout)
        self.assertTrue(manager.up)

    def test_installs_with_the_server_down_and_leaves_it_so(self):
        manager = fakes.sfcb(self.root, up=False)
        self.register("install")
        self.assertEqual(manager.calls(), [self.staging, "sfcbrepos -f"])
        self.assertFalse(manager.up)

    def test_a_second_install_changes_nothing(self):
        manager = fakes.sfcb(self.root, up=True)
        self.register("install")
        manager.calls()
        self.assertIn("registered already", self.register("install").stdout)
        self.assertEqual(manager.calls(), [])

    def test_remove_takes_everything_back(self):
        manager = fakes.sfcb(self.root, up=True)
        manager.calls()
        before = snapshot_of(self.root)
        self.register("install")
        manager.calls()
        self.register("remove")
        self.assertEqual(manager.calls(), [
            "systemctl stop sfcb", "sfcbunstage -n root/cimv2 -r vk-baseserver.reg vk-baseserver.mof", "sfcbrepos -f",
            "systemctl start sfcb"])
        self.assertEqual(snapshot_of(self.root), before)

    def test_status_notices_that_the_link_is_gone(self):
        fakes.sfcb(self.root, up=True)
        self.register("install")
        self.register("status")
        (self.root / self.link).unlink()
        self.assertIn("does not lead to the library", self.register("status", status=1).stdout)
        self.register("install")
        self.register("status")

    def test_remove_takes_back_the_links_in_every_folder_that_was_named(self):
        fakes.sfcb(self.root, up=True)
        where = folder()
        self.register("install")
        self.register("--provider-dir", where, "install")
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

    def test_the_server_runs_again_after_a_failure(self):
        manager = fakes.sfcb(self.root, up=True)
        manager.program("sfcbrepos", "exit 1")
        self.register("install", status=1)
        self.assertTrue(manager.up)
        self.register("status", status=1)

    def test_an_init_script_serves_where_systemd_does_not(self):
        manager = fakes.sfcb(self.root, up=True, without=["systemctl"])
        (self.root / "etc/init.d").mkdir()
        script = self.root / "etc/init.d/sfcb"
        script.write_text('#!/bin/sh\nup=$(dirname "$0")/../../state/up\ncase $1 in\nstatus) [ -e "$up" ] ;;\n'
                          'stop) rm "$up" ;;\nstart) touch "$up" ;;\nesac\n', encoding="ascii")
        os.chmod(script, 0o755)
        done = self.register("install")
        self.assertEqual(manager.calls(), [self.staging, "sfcbrepos -f"])
        self.assertIn("started the server again", done.stdout)
        self.assertTrue(manager.up)

    def test_a_server_that_nobody_can_stop_is_an_error(self):
        manager = fakes.sfcb(self.root, up=True, without=["systemctl"])
        manager.program("pidof", '[ "$1" = sfcbd ] && echo 42')
        self.assertIn("stop it and run this again", self.register("install", status=1).stderr)


class Both(Register):
    def test_each_is_served_and_can_be_chosen(self):
        fakes.pegasus(self.root, up=True)
        fakes.sfcb(self.root, up=False)
        # One state file tells of both; SFCB's commands ask for it to be down.
        self.register("--manager", "openpegasus", "install")
        self.assertTrue((self.root / OpenPegasus.link).is_symlink())
        self.assertFalse((self.root / Sfcb.link).is_symlink())
        (self.root / "state/up").unlink()
        self.register("--manager=sfcb", "install")
        self.assertTrue((self.root / Sfcb.link).is_symlink())


class Arguments(Register):
    def test_unusable_ones_end_with_2(self):
        for words in ([], ["install", "remove"], ["frobnicate"], ["--root"], ["--manager", "other", "install"],
                      ["--provider-dir", "/nonexistent", "install"]):
            with self.subTest(words):
                self.assertIn("--help", self.register(*words, status=2).stderr)

    def test_help_and_version(self):
        self.assertIn("--dry-run", self.register("--help").stdout)
        self.assertRegex(self.register("--version").stdout, r"^vk-provider-register \d+\.\d+\.\d+$")


if __name__ == "__main__":
    unittest.main()
