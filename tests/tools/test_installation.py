"""An installation: what it holds, that it runs from where it is, and that nothing in it names where it was built."""

import json
import os
import re
import sys
import unittest
from pathlib import Path

from support import BUILD, LIBRARY, files_below, directory, install, run

SOURCE = Path(__file__).resolve().parents[2]
PREFIX = directory() / "installed"
install(PREFIX)
LIBRARIES = ["nvlog", "vkcommon", "vkproduct", "vkinstrumentation", "vkproviderutilities",
             "vknabaseserverprofileprovider"]
# Of a tree with VK_ENDPOINT=ON.
ENDPOINT = ["sbin/vkcimd", "share/man/man8/vkcimd.8",
            "lib/systemd/system/vkcimd.service", "lib/systemd/system/vkcimd.socket",
            "etc/vkcimd.conf", "etc/pam.d/vkcimd"] if (BUILD / "bin/vkcimd").exists() else []
EXAMPLE = PREFIX / "share/vk-baseserver/examples/rack-server.json"
OPEN = "import ctypes, sys; ctypes.CDLL(sys.argv[1], mode=ctypes.RTLD_GLOBAL).BaseServerProvider_Create_InstanceMI"


def simulated(**more):
    return {"PATH": "/usr/bin:/bin", "VK_INSTRUMENTATION_TREE": str(EXAMPLE), "NVLOG_SINK": "none", **more}


class Contents(unittest.TestCase):
    def test_holds_everything_in_its_directory(self):
        expected = [f"lib/lib{name}.so.1" for name in LIBRARIES] + [f"lib/lib{name}.so" for name in LIBRARIES]
        expected += ["bin/vkcim", "sbin/vk-provider-register", "sbin/vk-provider-check", "sbin/vk-host-snapshot",
                     "share/man/man1/vkcim.1", "share/man/man7/libvknabaseserverprofileprovider.7",
                     "share/man/man8/vk-provider-register.8", "share/man/man8/vk-provider-check.8",
                     "share/man/man8/vk-host-snapshot.8", "share/bash-completion/completions/vkcim",
                     "share/bash-completion/completions/vk-provider-check",
                     "share/bash-completion/completions/vk-host-snapshot",
                     "share/vk-baseserver/vk-baseserver.mof", "share/vk-baseserver/vk-baseserver-registration.mof",
                     "share/vk-baseserver/vk-baseserver.reg",
                     "share/vk-baseserver/examples/rack-server.json",
                     "share/doc/vk-baseserver-tools/vkcim.schema.json",
                     "share/doc/vk-baseserver-tools/vkcim-facts.schema.json",
                     "share/doc/vk-baseserver-tools/vk-provider-check.schema.json"]
        expected += ["lib/vk/ntp/daemons.sh", "lib/vk/ntp/ntp", "lib/vk/ntp/ntpd", "sbin/vk-ntp-setup",
                     "share/man/man8/vk-ntp-setup.8"]
        expected += ["lib/vk/metrics/vk-metrics", "lib/systemd/system/vk-metrics.service",
                     "lib/systemd/system/vk-metrics.timer", "share/vk-baseserver/prometheus/vk-rules.yml",
                     "share/vk-baseserver/prometheus/vk-dashboard.json", "etc/ansible/facts.d/vk.fact"]
        collection = SOURCE / "tools/ansible/collection"
        expected += [f"share/ansible/collections/ansible_collections/vk/baseserver/{path.relative_to(collection)}"
                     for path in files_below(collection)]
        expected += ENDPOINT
        expected += [f"share/vk-baseserver/register/{path.name}" for path in (SOURCE / "tools/register").glob("*.py")]
        expected += [f"lib/pkgconfig/{name}.pc" for name in LIBRARIES[:-1] + ["vk-cmpi"]]
        expected += [f"lib/cmake/vk-baseserver/vk-baseserver-config{part}.cmake"
                     for part in ("", "-relwithdebinfo", "-version")]
        headers = (SOURCE / "platform/include").rglob("*.h")
        expected += [f"include/vk-baseserver/{h.relative_to(SOURCE / 'platform/include')}" for h in headers]
        self.assertEqual([str(p.relative_to(PREFIX)) for p in files_below(PREFIX)], sorted(expected))

    def test_each_component_alone_holds_its_part_and_all_of_them_everything(self):
        parts = []
        for component in ["provider", "tools", "development", "ntp", "ansible"] + ["endpoint"] * bool(ENDPOINT):
            where = directory() / "p"
            install(where, component=component)
            parts += [str(p.relative_to(where)) for p in files_below(where)]
        self.assertEqual(sorted(parts), [str(p.relative_to(PREFIX)) for p in files_below(PREFIX)])

    def test_names_no_place_where_it_was_built(self):
        for path in files_below(PREFIX):
            data = os.readlink(path).encode() if path.is_symlink() else path.read_bytes()
            for place in (SOURCE, BUILD):
                self.assertFalse(os.fsencode(place) in data, f"{path} names {place}")

    def test_leaves_no_variable_of_the_build_unfilled(self):
        for path in files_below(PREFIX):
            if not path.read_bytes().startswith(b"\x7fELF"):
                self.assertNotRegex(path.read_text(encoding="utf-8"), r"@[A-Z_]+@", path)


class Libraries(unittest.TestCase):
    def open_in_a_clean_process(self, path):
        return run(sys.executable, "-c", OPEN, path, cwd="/", env={"PATH": "/usr/bin:/bin"})

    def test_load_from_their_directory(self):
        done = self.open_in_a_clean_process(PREFIX / "lib" / f"{LIBRARY}.1")
        self.assertEqual(done.returncode, 0, done.stderr)

    def test_load_through_a_link_in_another_directory(self):
        link = directory() / LIBRARY
        link.symlink_to(PREFIX / "lib" / f"{LIBRARY}.1")
        done = self.open_in_a_clean_process(link)
        self.assertEqual(done.returncode, 0, done.stderr)

    def test_load_through_the_link_that_the_registration_puts(self):
        root, where = directory(), directory()
        import fakes
        fakes.pegasus(root, up=True).set("any-directory", "yes")
        done = run(PREFIX / "sbin/vk-provider-register", "--root", root, "--provider-dir", where, "install")
        self.assertEqual(done.returncode, 0, done.stderr)
        self.assertEqual(self.open_in_a_clean_process(where / LIBRARY).returncode, 0)

    def test_take_each_other_from_the_same_installation(self):
        link = directory() / LIBRARY
        link.symlink_to(PREFIX / "lib" / f"{LIBRARY}.1")
        script = OPEN + "; print(open('/proc/self/maps').read())"
        maps = run(sys.executable, "-c", script, link, cwd="/").stdout
        loaded = {Path(line.split()[-1]) for line in maps.splitlines() if "/libvk" in line or "/libnvlog" in line}
        self.assertEqual({p.name for p in loaded}, {f"lib{name}.so.1" for name in LIBRARIES})
        self.assertEqual({p.parent for p in loaded}, {PREFIX / "lib"})

    def test_have_no_run_path_in_a_directory_of_the_system(self):
        stage = directory()
        install(Path("/usr"), destdir=stage, component="provider")
        for path in (stage / "usr").rglob(f"{LIBRARY}.1"):
            found = re.search(r"RUNPATH.*\[(.*)\]", run("readelf", "-d", path).stdout)
            in_system_directory = re.fullmatch(r"/usr/lib(64|/[^/]*-linux-[^/]*)?", f"/{path.parent.relative_to(stage)}")
            self.assertEqual(found is None, in_system_directory is not None, path)


class Programs(unittest.TestCase):
    def test_run_from_the_prefix(self):
        done = run(PREFIX / "bin/vkcim", "--format", "json", "instances", "VESKA_PhysicalPackage", cwd="/", env=simulated())
        self.assertEqual(done.returncode, 0, done.stderr)
        package = json.loads(done.stdout)["results"][0]["properties"]
        self.assertEqual(package["SerialNumber"]["value"], "CZ1234")
        self.assertEqual(package["PackageType"]["value"], 2)

    def test_run_from_a_staged_installation(self):
        stage = directory()
        install(Path("/opt/vk"), destdir=stage)
        self.assertEqual([p.name for p in stage.iterdir()], ["opt"])
        there = stage / "opt/vk"
        run_path = re.search(r"RUNPATH.*\[(.*)\]", run("readelf", "-d", there / "lib" / f"{LIBRARY}.1").stdout)
        self.assertEqual(run_path.group(1), "$ORIGIN:/opt/vk/lib")
        done = run(there / "bin/vkcim", "names", "VESKA_ComputerSystem", cwd="/", env=simulated())
        self.assertIn('Name="node7"', done.stdout, done.stderr)
        done = run(there / "sbin/vk-provider-register", "--root", directory(), "install")
        self.assertEqual(done.returncode, 0, done.stderr)

    def test_the_example_answers_every_class(self):
        done = run(PREFIX / "bin/vkcim", "--format", "json", "report", env=simulated())
        answers = json.loads(done.stdout)
        for name, answer in {**answers["classes"], **answers["associations"]}.items():
            self.assertEqual(answer["status"]["code"], 0, name)
        self.assertEqual(len(answers["classes"]["VESKA_ComputerSystem"]["results"]), 1)
        self.assertEqual(len(answers["associations"]["VESKA_ComputerSystemPackage"]["results"]), 1)

    def test_the_manual_pages_are_sound_and_know_every_property(self):
        if run("sh", "-c", "command -v groff").returncode != 0:
            self.skipTest("groff is not installed")
        for page in (PREFIX / "share/man").rglob("*.[178]"):
            done = run("groff", "-man", "-Tutf8", "-ww", "-z", page)
            self.assertEqual(done.stderr, "", page)
        manual = (PREFIX / "share/man/man7/libvknabaseserverprofileprovider.7").read_text(encoding="utf-8")
        for declared in json.loads((BUILD / "schema/schema.json").read_text(encoding="utf-8"))["classes"]:
            section = manual.split(f".SS {declared['name']}\n")[1].split("\n.SS ")[0].split("\n.SH ")[0]
            for feature in declared["properties"] + declared["methods"]:
                self.assertIn(f"\\fB{feature['name']}\\fR", section)


class Completion(unittest.TestCase):
    def complete(self, *words):
        script = ('. "$1"; shift; COMP_WORDS=("$@"); COMP_CWORD=$(($# - 1)); _vkcim; printf "%s\\n" "${COMPREPLY[@]}"')
        done = run("bash", "-c", script, "-", PREFIX / "share/bash-completion/completions/vkcim", "vkcim", *words)
        self.assertEqual(done.stderr, "")
        return set(done.stdout.split())

    def test_knows_the_commands_and_options_of_the_program(self):
        text = run(PREFIX / "bin/vkcim", "--help").stdout
        commands = set(re.findall(r"^  ([a-z-]+)  ", text.split("\nCommands:")[1], re.M))
        options = set(re.findall(r"^  (?:-\w,)?(--[a-z-]+)", text, re.M))
        self.assertGreater(len(commands), 10)
        self.assertEqual(self.complete(""), commands)
        self.assertEqual(self.complete("report", "--"), options)

    def test_knows_the_classes_and_methods_of_the_schema(self):
        declared = json.loads((BUILD / "schema/schema.json").read_text(encoding="utf-8"))["classes"]
        self.assertEqual(self.complete("instances", "V"), {c["name"] for c in declared})
        self.assertEqual(self.complete("--assoc-class", ""), {c["name"] for c in declared if c["association"]})
        for c in declared:
            self.assertEqual(self.complete("invoke", c["name"], ""), {m["name"] for m in c["methods"]})
            self.assertEqual(self.complete("value", c["name"], ""), {p["name"] for p in c["properties"]})
        ends = {p["name"] for c in declared if c["association"] for p in c["properties"] if p["type"].endswith(" ref")}
        self.assertEqual(self.complete("associators", "--role", ""), ends)

    def test_narrows_by_what_is_typed(self):
        self.assertEqual(self.complete("inst"), {"instances"})
        self.assertEqual(self.complete("--format", "j"), {"json"})
        self.assertEqual(self.complete("--format", "json", "get", "VESKA_T"),
                         {"VESKA_TimeService", "VESKA_TimeServiceAffectsElement"})


class ToolCompletion(unittest.TestCase):
    """Of the administrators' programs."""

    def complete(self, program, *words, cwd="/"):
        script = '. "$1"; shift; COMP_WORDS=("$@"); COMP_CWORD=$(($# - 1)); _vk_tools "$1"; printf "%s\\n" "${COMPREPLY[@]}"'
        done = run("bash", "-c", script, "-", PREFIX / "share/bash-completion/completions" / program, program, *words, cwd=cwd)
        self.assertEqual(done.stderr, "")
        return set(done.stdout.split())

    def test_knows_the_options_of_each_program(self):
        for program in ("vk-provider-check", "vk-host-snapshot"):
            text = run(PREFIX / "sbin" / program, "--help").stdout
            options = set(re.findall(r"(?m)^ +(?:-\w,)?(--[a-z-]+)", text))
            self.assertGreater(len(options), 3)
            self.assertEqual(self.complete(program, "--"), options)

    def test_knows_what_they_are_asked_for(self):
        self.assertEqual(self.complete("vk-provider-check", "s"), {"setting"})
        self.assertEqual(self.complete("vk-provider-check", "--format", ""), {"text", "json"})
        self.assertEqual(self.complete("vk-provider-check", "--format", "=", "j"), {"json"})
        place = directory()
        (place / "snapshots").mkdir()
        (place / "some-file").write_bytes(b"")
        for words in (["s"], ["--root", "s"]):
            self.assertEqual(self.complete("vk-host-snapshot", *words, cwd=place), {"snapshots"})


if __name__ == "__main__":
    unittest.main()
