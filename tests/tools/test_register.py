"""vk-provider-register against installations of both kinds of object managers that record what is asked of them."""

import os
import shutil
import signal
import unittest

import fakes
from registering import CLASSES, MODULE, PREFIX, SHARE, Register
from support import LIBRARY, directory, snapshot_of, widest


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
        prefix = directory() / "p"
        shutil.copytree(PREFIX, prefix, symlinks=True)
        manager = fakes.pegasus(self.root, up=True)
        self.register("install", prefix=prefix)
        manager.calls()
        library = prefix / "lib" / f"{LIBRARY}.1"
        shutil.copy(library, library.with_suffix(".new"))
        os.replace(library.with_suffix(".new"), library)
        self.register("install", prefix=prefix)
        self.assertEqual(manager.calls(), [f"cimprovider -d -m {MODULE}", f"cimprovider -e -m {MODULE}"])

    def copy_of_the_prefix(self):
        prefix = directory() / "p"
        shutil.copytree(PREFIX, prefix, symlinks=True)
        return prefix

    def change_classes(self, prefix, old="Always VESKA_TimeService.", new="Always that."):
        file = prefix / "share/vk-baseserver/vk-baseserver.mof"
        text = file.read_text(encoding="utf-8")
        self.assertIn(old, text)
        file.write_text(text.replace(old, new), encoding="utf-8")

    def deleting(self):
        return [f"cimcli dc -n root/cimv2 {name}" for name in reversed(CLASSES)]

    def test_a_newer_version_takes_the_place_of_the_older_one(self):
        prefix = self.copy_of_the_prefix()
        manager = fakes.pegasus(self.root, up=True)
        self.register("install", prefix=prefix)
        manager.calls()
        self.change_classes(prefix)
        self.assertIn("other classes than those installed", self.register("status", prefix=prefix, status=1).stdout)
        self.register("install", prefix=prefix)
        share = prefix / "share/vk-baseserver"
        self.assertEqual(manager.calls(), [
            f"cimprovider -d -m {MODULE}", f"cimprovider -r -m {MODULE}", *self.deleting(),
            f"cimmof -n root/cimv2 {share}/vk-baseserver.mof",
            f"cimmof -n root/PG_InterOp {share}/vk-baseserver-registration.mof"])
        self.assertIn("Always that.", manager.get("classes/VESKA_TimeService"))
        self.register("status", prefix=prefix)

    def test_a_newer_version_that_fails_leaves_the_older_one_in_force(self):
        prefix = self.copy_of_the_prefix()
        manager = fakes.pegasus(self.root, up=True)
        self.register("install", prefix=prefix)
        before = {name: manager.get(name).split() for name in ("module", *(f"classes/{name}" for name in CLASSES))}
        capabilities = len(list(self.root.glob("state/instances/*")))
        self.change_classes(prefix)
        self.change_classes(prefix, "VESKA_CIMServiceConfig : CIM_ManagedElement", "VESKA_CIMServiceConfig : CIM_Gone")
        done = self.register("install", prefix=prefix, status=1)
        self.assertIn("CIM_ERR_INVALID_SUPERCLASS", done.stderr)
        self.assertIn("the older registration is back in force", done.stdout)
        after = {name: manager.get(name).split() for name in before}
        self.assertEqual(after["module"], before["module"])
        self.assertNotIn("that.", after["classes/VESKA_TimeService"])
        self.assertEqual(manager.classes, sorted(CLASSES))
        self.assertEqual(len(list(self.root.glob("state/instances/*"))), capabilities)

    def test_a_server_that_takes_the_files_and_changes_nothing_is_an_error(self):
        prefix = self.copy_of_the_prefix()
        manager = fakes.pegasus(self.root, up=True)
        self.register("install", prefix=prefix)
        self.change_classes(prefix)
        manager.set("deaf", "dc")
        self.assertIn("took the files, and shows the module with other", self.register("install", prefix=prefix, status=1).stderr)

    def test_a_first_install_that_fails_takes_back_what_it_declared(self):
        for harm, said in [("schema", "CIM_ERR_INVALID_SUPERCLASS"), ("fail", "it cannot be done"), ("mute", "does not answer")]:
            with self.subTest(harm):
                self.root = directory()
                manager = fakes.pegasus(self.root, up=True)
                manager.set(harm, {"schema": manager.get("schema").replace("CIM_ElementCapabilities ", ""),
                                   "fail": "cimmof -n root/PG_InterOp", "mute": "yes"}[harm])
                self.assertIn(said, self.register("install", status=1).stderr)
                self.assertEqual((manager.classes, manager.module), ([], ""))
                self.assertFalse((self.root / self.link).is_symlink())
                self.assertFalse((self.root / "var/lib/vk/registration/openpegasus").exists())

    def test_what_an_install_left_that_was_killed_goes_with_the_next_one_or_with_remove(self):
        for action in ("install", "remove"):
            with self.subTest(action):
                self.root = directory()
                manager = fakes.pegasus(self.root, up=True)
                self.register("install")
                shutil.rmtree(self.root / "state/instances")
                (self.root / "state/module").unlink()
                (self.root / "state/classes/VESKA_TimeService").unlink()
                self.register(action)
                self.assertEqual(manager.classes, sorted(CLASSES) if action == "install" else [])
                self.assertEqual(manager.module, f"{MODULE} OK" if action == "install" else "")
                self.assertEqual((self.root / self.link).is_symlink(), action == "install")

    def test_an_install_that_is_ended_by_a_signal_takes_back_what_it_declared(self):
        for number in (signal.SIGHUP, signal.SIGINT, signal.SIGTERM):
            with self.subTest(number.name):
                self.root = directory()
                manager = fakes.pegasus(self.root, up=True)
                manager.set("signal", int(number))
                said = self.register("install", status=1).stderr
                self.assertIn(f"ended by {number.name}; what was begun is taken back", said)
                self.assertNotIn("Traceback", said)
                self.assertEqual((manager.classes, manager.module), ([], ""))
                self.assertFalse((self.root / self.link).is_symlink())

    def test_an_incomplete_installation_is_named_before_anything_is_changed(self):
        for name in ("share/vk-baseserver/vk-baseserver.mof", "share/vk-baseserver/vk-baseserver.reg", "lib/libnvlog.so.1"):
            with self.subTest(name):
                prefix = self.copy_of_the_prefix()
                (prefix / name).unlink()
                manager = fakes.pegasus(self.root, up=True)
                self.assertIn(f"incomplete: {prefix}/{name} missing", self.register("install", prefix=prefix, status=1).stderr)
                self.assertEqual(manager.calls(), [])

    def test_notes_hold_paths_of_any_bytes(self):
        odd = os.fsdecode(os.fsencode(directory()) + b"/\xff")
        os.mkdir(odd)
        fakes.pegasus(self.root, up=True).set("any-directory", "yes")
        self.register("--provider-dir", odd, "install")
        self.assertTrue(os.path.islink(f"{odd}/{LIBRARY}"))
        self.register("status")
        self.register("remove")
        self.assertEqual(os.listdir(odd), [])

    def test_a_busy_provider_is_asked_again(self):
        manager = fakes.pegasus(self.root, up=True)
        self.register("install")
        manager.calls()
        manager.set("busy", 3)
        self.register("remove")
        self.assertEqual(manager.calls()[:5], [f"cimprovider -d -m {MODULE}"] * 4 + [f"cimprovider -r -m {MODULE}"])

    def test_a_provider_that_stays_busy_keeps_its_registration(self):
        prefix = self.copy_of_the_prefix()
        manager = fakes.pegasus(self.root, up=True)
        self.register("install", prefix=prefix)
        self.change_classes(prefix)
        manager.set("busy", 1000)
        self.assertIn("Provider is busy", self.register("install", prefix=prefix, status=1).stderr)
        self.assertEqual((manager.module, manager.classes), (f"{MODULE} OK", sorted(CLASSES)))

    def test_an_older_cim_schema_is_named_before_anything_is_changed(self):
        for harm in ("schema", "version"):
            with self.subTest(harm):
                self.root = directory()
                manager = fakes.pegasus(self.root, up=True)
                manager.set(harm, "CIM_ManagedElement" if harm == "schema" else "2.21.0")
                before = snapshot_of(self.root)
                said = self.register("install", status=1).stderr
                self.assertIn("2.22 or later is needed", said)
                self.assertEqual(manager.calls(), [])
                after = snapshot_of(self.root)
                after.pop("calls")
                self.assertEqual({name: after[name] for name in before}, before)
                self.assertFalse((self.root / "var/lib/vk").exists())

    def test_a_module_that_was_stopped_stays_so(self):
        prefix = self.copy_of_the_prefix()
        manager = fakes.pegasus(self.root, up=True)
        self.register("install", prefix=prefix)
        manager.set("module", f"{MODULE} Stopped")
        starting = f"was stopped by the administrator: cimprovider -e -m {MODULE} starts it"
        self.assertIn(f"registered, but {starting}", self.register("status", prefix=prefix, status=1).stdout)
        self.assertIn(starting, self.register("install", prefix=prefix).stdout)
        self.assertEqual(manager.module, f"{MODULE} Stopped")
        self.change_classes(prefix)
        self.register("install", prefix=prefix)
        self.assertIn("Always that.", manager.get("classes/VESKA_TimeService"))
        self.assertEqual(manager.module, f"{MODULE} Stopped")

    def test_a_new_helper_library_restarts_the_agent(self):
        prefix = self.copy_of_the_prefix()
        manager = fakes.pegasus(self.root, up=True)
        self.register("install", prefix=prefix)
        manager.calls()
        library = prefix / "lib/libnvlog.so.1"
        shutil.copy(library, library.with_suffix(".new"))
        os.replace(library.with_suffix(".new"), library)
        self.assertIn("had the new library taken into use", self.register("install", prefix=prefix).stdout)
        self.assertEqual(manager.calls(), [f"cimprovider -d -m {MODULE}", f"cimprovider -e -m {MODULE}"])

    def test_the_directory_is_where_the_server_will_look(self):
        manager = fakes.pegasus(self.root, up=False)
        (self.root / "opt/planned").mkdir(parents=True)
        manager.set("providerDir", "/opt/planned")
        self.register("install")
        self.assertTrue((self.root / "opt/planned" / LIBRARY).is_symlink())
        self.assertFalse((self.root / self.link).is_symlink())

    def test_no_directory_is_guessed(self):
        fakes.pegasus(self.root, up=True, without=["cimconfig"])
        self.assertIn("name it with --provider-dir", self.register("install", status=1).stderr)
        self.assertFalse((self.root / self.link).is_symlink())

    def test_every_install_asks_the_provider_through_the_server(self):
        manager = fakes.pegasus(self.root, up=True)
        self.register("install")
        manager.set("mute", "yes")
        done = self.register("install", status=1)
        self.assertIn("does not answer through the server", done.stderr)
        self.assertIn("CIM_ERR_FAILED: cannot load library", done.stderr)
        self.assertEqual(manager.module, f"{MODULE} OK")

    def elsewhere(self, up=True, home="opt/wbem"):
        manager = fakes.pegasus(self.root, up=up)
        manager.move(manager.commands, f"{home}/bin")
        (self.root / home / "lib").mkdir()
        manager.set("providerDir", "lib")
        manager.set("home", home)
        return manager

    def test_a_relative_directory_is_below_the_servers_own_home(self):
        self.elsewhere(home="opt/tog-pegasus")
        self.register("install")
        self.assertTrue((self.root / "opt/tog-pegasus/lib" / LIBRARY).is_symlink())

    def test_the_servers_place_is_remembered(self):
        manager = self.elsewhere(up=False)
        self.register("install", PEGASUS_HOME="/opt/wbem")
        notes = (self.root / "var/lib/vk/registration/openpegasus").read_text(encoding="utf-8").splitlines()
        self.assertIn(f"home: {self.root}/opt/wbem", notes)
        self.assertIn(f"directories: {self.root}/opt/wbem/bin", notes)
        self.assertIn("registered", self.register("status").stdout)
        self.assertIn("registered already", self.register("install").stdout)
        self.register("remove")
        self.assertEqual((manager.module, manager.classes), ("", []))
        self.assertFalse((self.root / "opt/wbem/lib" / LIBRARY).is_symlink())

    def test_a_note_of_an_older_version_leads_to_the_server(self):
        manager = self.elsewhere()
        self.register("install", PEGASUS_HOME="/opt/wbem")
        (self.root / "var/lib/vk/registration/openpegasus").write_text(
            f"library-link: {self.root}/opt/wbem/lib/{LIBRARY}\nfiles: 1 2\nlibrary: 1 2 3\n", encoding="utf-8")
        self.register("remove")
        self.assertEqual((manager.module, manager.classes), ("", []))

    def test_a_named_directory_is_remembered(self):
        manager = fakes.pegasus(self.root, up=True)
        where = directory()
        manager.set("any-directory", "yes")
        self.register("--provider-dir", where, "install")
        self.register("install")
        self.assertTrue((where / LIBRARY).is_symlink())
        self.assertFalse((self.root / self.link).is_symlink())

    def test_status_asks_the_repository_and_no_note(self):
        manager = fakes.pegasus(self.root, up=True)
        self.register("install")
        (self.root / "var/lib/vk/registration/openpegasus").unlink()
        self.assertIn("is registered\n", self.register("status").stdout)
        (self.root / "state/classes/VESKA_TimeService").unlink()
        self.assertIn("without the classes VESKA_TimeService in root/cimv2", self.register("status", status=1).stdout)
        self.register("install")
        (self.root / "state/up").unlink()
        self.assertIn("not running; the module VKBaseServerModule is registered\n", self.register("status").stdout)
        (self.root / "state/up").touch()
        manager.set("module", "")
        self.assertIn("is not registered", self.register("status", status=1).stdout)

    def test_what_cannot_be_taken_back_is_named_with_the_commands_for_it(self):
        manager = fakes.pegasus(self.root, up=False)
        self.register("install")
        manager.set("starts", "never")
        said = self.register("remove", status=1).stderr
        self.assertIn(f"cimserver; cimprovider -d -m {MODULE}; cimprovider -r -m {MODULE}; cimcli dc -n root/cimv2 "
                      "VESKA_TimeServiceAffectsElement;", said)
        self.assertIn(f"rm -f {self.root / self.link}", said)
        self.assertTrue((self.root / self.link).is_symlink())
        manager.set("starts", "")
        self.register("remove")
        self.assertEqual((manager.module, manager.classes), ("", []))
        self.assertFalse((self.root / "var/lib/vk").exists())

    def test_classes_cannot_be_replaced_without_cimcli(self):
        prefix = self.copy_of_the_prefix()
        manager = fakes.pegasus(self.root, up=True, without=["cimcli"])
        self.register("install", prefix=prefix)
        self.assertIn("registered already", self.register("install", prefix=prefix).stdout)
        self.change_classes(prefix)
        self.assertIn("they stay in force", self.register("install", prefix=prefix, status=1).stderr)
        self.assertEqual(manager.module, f"{MODULE} OK")

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
        (self.root / "state/classes").rmdir()
        self.assertEqual(snapshot_of(self.root), before)
        self.register("remove")
        self.assertEqual(manager.calls(), [])

    def test_remove_says_that_classes_stay_without_cimcli(self):
        fakes.pegasus(self.root, up=True, without=["cimcli"])
        self.register("install")
        self.assertIn("the classes stay declared", self.register("remove").stdout)

    def test_dry_run_changes_nothing(self):
        for up in (True, False):
            self.root = directory()
            manager = fakes.pegasus(self.root, up=up)
            manager.calls()
            before = snapshot_of(self.root)
            done = self.register("--dry-run", "install")
            self.assertIn(f"would run: {self.root}/usr/sbin/cimmof -n root/cimv2", done.stdout)
            self.assertEqual(manager.calls(), [])
            self.assertEqual(snapshot_of(self.root), before)

    def test_dry_run_of_remove_says_what_it_would_do_and_changes_nothing(self):
        for up in (True, False):
            self.root = directory()
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
                self.root = directory()
                manager = fakes.pegasus(self.root, up=False)
                if action == "remove":
                    self.register("install")
                    manager.calls()
                manager.set("fail", "cimprovider -l")
                self.assertIn("does not answer after its start", self.register(action, status=1).stderr)
                self.assertEqual(manager.calls(), ["cimserver", "cimserver -s"])
                self.assertFalse(manager.up)

    def test_a_module_that_refuses_to_be_disabled_is_removed(self):
        manager = fakes.pegasus(self.root, up=True)
        self.register("install")
        manager.set("fail", "cimprovider -d")
        self.assertIn("was not disabled: it cannot be done", self.register("remove").stdout)
        self.assertFalse((self.root / self.link).is_symlink())
        self.assertEqual(manager.module, "")
        self.assertFalse((self.root / "var/lib/vk").exists())

    def test_status_notices_what_keeps_a_registration_from_serving(self):
        prefix = directory() / "p"
        shutil.copytree(PREFIX, prefix, symlinks=True)
        fakes.pegasus(self.root, up=True)
        mof = prefix / "share/vk-baseserver/vk-baseserver.mof"
        capability = self.root / f"state/instances/PG_ProviderCapabilities.{MODULE}.VESKA_TimeService"
        for harm, flaw in [((self.root / self.link).unlink, "does not lead to the library"),
                           (capability.unlink, "other classes"),
                           (lambda: mof.write_text(mof.read_text(encoding="utf-8").replace("Its capabilities.", "Other ones.")), "other classes")]:
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
        manager.set("fail", "cimmof")
        self.assertIn("it cannot be done", self.register("install", status=1).stderr)
        self.register("status", status=1)
        self.assertFalse((self.root / "var/lib/vk/registration/openpegasus").exists())

    def test_remove_after_the_object_manager_went_takes_back_the_rest(self):
        fakes.pegasus(self.root, up=True)
        self.register("install")
        shutil.rmtree(self.root / "usr/sbin")
        self.register("remove")
        self.assertFalse((self.root / self.link).is_symlink())
        self.assertFalse((self.root / "var/lib/vk").exists())
        self.assertIsNone(self.cimconfig_link())


class Both(Register):
    def test_each_is_served_and_can_be_chosen(self):
        fakes.pegasus(self.root, up=True)
        fakes.sfcb(self.root, up=False)
        self.register("--manager", "openpegasus", "install")
        self.assertTrue((self.root / OpenPegasus.link).is_symlink())
        self.assertFalse((self.root / "usr/lib64/cmpi" / LIBRARY).is_symlink())
        self.register("--manager=sfcb", "install")
        self.assertTrue((self.root / "usr/lib64/cmpi" / LIBRARY).is_symlink())


class Arguments(Register):
    def test_unusable_ones_end_with_2(self):
        for words in ([], ["install", "remove"], ["frobnicate"], ["--root"], ["--manager", "other", "install"],
                      ["--provider-dir", "/nonexistent", "install"], ["--root", "/nonexistent", "status"]):
            with self.subTest(words):
                self.assertIn("--help", self.register(*words, status=2).stderr)

    def test_help_and_version(self):
        self.assertIn("--dry-run", self.register("--help").stdout)
        self.assertLessEqual(widest(self.register("--help").stdout), 80)
        self.assertRegex(self.register("--version").stdout, r"^vk-provider-register \d+\.\d+\.\d+$")


if __name__ == "__main__":
    unittest.main()
