"""How scripts/common.sh builds a tree, tried with a project of one file: what it refuses, what it builds anew, what it shows;
and that it names the packages that it may not install."""

import os
import pty
import shutil
import subprocess
import tempfile
import unittest
from pathlib import Path

COMMON = Path(__file__).resolve().parents[2] / "scripts/common.sh"
PROJECT = """cmake_minimum_required(VERSION 3.25)
project(sample LANGUAGES NONE)
add_custom_command(OUTPUT program COMMAND ${CMAKE_COMMAND} -E copy ${CMAKE_SOURCE_DIR}/source program
    DEPENDS ${CMAKE_SOURCE_DIR}/source VERBATIM)
add_custom_target(all_of_it ALL DEPENDS program)
"""
PRESETS = '{"version": 6, "configurePresets": [{"name": "release", "generator": "Ninja", "binaryDir": "${sourceDir}/build"}]}'
BUILD = 'set -euo pipefail; . "$0"; build_tree release build; cat build/program'
SHOWN = "building the release tree in build\n"


class Checkout(unittest.TestCase):
    def setUp(self):
        holder = tempfile.TemporaryDirectory(prefix="vk scripts ")
        self.addCleanup(holder.cleanup)
        self.here = Path(holder.name) / "checkout"
        self.here.mkdir()
        for name, text in (("CMakeLists.txt", PROJECT), ("CMakePresets.json", PRESETS), ("source", "first\n")):
            (self.here / name).write_text(text, encoding="ascii")

    def build(self, where=None):
        """Exit status, standard output and standard error."""
        done = subprocess.run(["bash", "-c", BUILD, COMMON], cwd=where or self.here, capture_output=True, text=True, check=False)
        return done.returncode, done.stdout, done.stderr

    def build_on_a_terminal(self):
        ours, its = pty.openpty()
        done = subprocess.run(["bash", "-c", BUILD, COMMON], cwd=self.here, stdout=subprocess.PIPE, stderr=its, text=True,
                              env={**os.environ, "TERM": "xterm"}, check=False)
        os.write(its, b"end")
        shown = b""
        while not shown.endswith(b"end"):
            shown += os.read(ours, 65536)
        os.close(its)
        os.close(ours)
        return done.stdout, shown.decode()


class Failure(Checkout):
    def test_a_log_that_cannot_be_written_ends_it_although_an_older_program_is_there(self):
        self.build()
        (self.here / "source").write_text("second\n", encoding="ascii")
        (self.here / "build/build.log").unlink()
        (self.here / "build/build.log").mkdir()
        status, output, error = self.build()
        self.assertEqual((status, output), (3, ""))
        self.assertIn(f"cannot write {self.here}/build/build.log, which belongs to {(self.here / 'build').owner()}", error)

    def test_a_build_that_fails_names_the_log(self):
        (self.here / "source").unlink()
        status, output, error = self.build()
        self.assertEqual((status, output), (3, ""))
        self.assertIn(f"the whole output is in {self.here}/build/build.log", error)


class Copies(Checkout):
    def test_one_that_was_copied_builds_its_own_sources(self):
        self.build()
        copy = self.here.parent / "copy"
        shutil.copytree(self.here, copy, symlinks=True)
        (copy / "source").write_text("the copy's\n", encoding="ascii")
        self.assertEqual(self.build(copy), (0, "the copy's\n", SHOWN))
        self.assertEqual((self.here / "build/program").read_text(encoding="ascii"), "first\n")

    def test_one_that_was_moved_builds_the_sources_beside_it(self):
        self.build()
        moved = self.here.rename(self.here.parent / "moved")
        (moved / "source").write_text("moved\n", encoding="ascii")
        self.assertEqual(self.build(moved), (0, "moved\n", SHOWN))

    def test_a_copy_that_cannot_be_configured_never_builds_the_originals_sources(self):
        self.build()
        copy = self.here.parent / "copy"
        shutil.copytree(self.here, copy, symlinks=True)
        (copy / "CMakeLists.txt").write_text(f"{PROJECT}message(FATAL_ERROR refused)\n", encoding="ascii")
        for _ in range(2):
            status, output, error = self.build(copy)
            self.assertEqual((status, output), (3, ""))
            self.assertIn("CMake Error", error)

    def test_a_link_to_a_checkout_is_the_checkout(self):
        self.build()
        link = self.here.parent / "link"
        link.symlink_to(self.here)
        self.assertEqual(self.build(link), (0, "first\n", ""))


class Progress(Checkout):
    def test_is_one_line_without_dots_where_nobody_looks_on(self):
        self.assertEqual(self.build(), (0, "first\n", SHOWN))
        self.assertNotIn(".", SHOWN)

    def test_is_silent_where_nothing_is_to_be_done(self):
        self.build()
        self.assertEqual(self.build(), (0, "first\n", ""))

    def test_is_silent_where_only_new_files_were_looked_for(self):
        (self.here / "CMakeLists.txt").write_text(f"{PROJECT}file(GLOB found CONFIGURE_DEPENDS *.cpp)\n", encoding="ascii")
        self.build()
        self.assertEqual(self.build(), (0, "first\n", ""))
        self.assertIn("Re-checking globbed directories", (self.here / "build/build.log").read_text(encoding="ascii"))

    def test_is_a_step_and_a_count_in_one_line_of_a_terminal_that_is_gone_at_the_end(self):
        output, shown = self.build_on_a_terminal()
        self.assertEqual(output, "first\n")
        self.assertRegex(shown, r"^(\r\x1b\[Kconfiguring)+\r\x1b\[Kbuilding: 1 of 1\r\x1b\[Kend$")
        self.assertEqual(self.build_on_a_terminal(), ("first\n", "end"))


class Packages(unittest.TestCase):
    INSTALL = 'set -euo pipefail; . "$0"; install_packages cmake ninja-build'

    def test_that_a_user_without_sudo_lacks_are_named(self):
        with tempfile.TemporaryDirectory() as commands:
            for name, what in (("dpkg-query", "exit 1"), ("id", "echo 1000")):
                command = Path(commands) / name
                command.write_text(f"#!/bin/sh\n{what}\n", encoding="ascii")
                command.chmod(0o755)
            done = subprocess.run(["/bin/bash", "-c", self.INSTALL, COMMON], env={"PATH": commands}, capture_output=True,
                                  text=True, check=False)
        self.assertEqual((done.returncode, done.stdout), (3, ""))
        self.assertTrue(done.stderr.endswith("installing them takes root or sudo: cmake ninja-build\n"), done.stderr)


if __name__ == "__main__":
    unittest.main()
