"""What programs of others are built with: pkg-config files and a CMake package, in an installation below a prefix."""

import os
import re
import shutil
import unittest
from pathlib import Path

from support import directory, install, run

SOURCE = Path(__file__).resolve().parents[2]
LIBRARIES = ["nvlog", "vkcommon", "vkproduct", "vkinstrumentation", "vkproviderutilities"]
PREFIX = directory() / "installed"
install(PREFIX)
os.environ["CMAKE_GENERATOR"] = "Ninja"  # as for our own tree; there need be no make
EXAMPLE = PREFIX / "share/vk-baseserver/examples/rack-server.json"
EXPECTED = "architecture x86_64\nkeys 1\nclass 22\ncomputer Example RX200 rack server\nCMPI 200\n"


def pkg_config(*words):
    return run("pkg-config", *words, env={**os.environ, "PKG_CONFIG_PATH": str(PREFIX / "lib/pkgconfig")})


@unittest.skipUnless(shutil.which("pkg-config"), "pkg-config is not installed")
class Development(unittest.TestCase):
    def test_a_program_is_built_by_each_and_answers(self):
        into = directory()
        done = run(SOURCE / "tests/tools/consumer/build", PREFIX, into)
        self.assertEqual(done.returncode, 0, done.stderr)
        for name in ("by-pkg-config", "by-cmake"):
            asked = run(into / name, env={"VK_INSTRUMENTATION_TREE": str(EXAMPLE), "NVLOG_SINK": "stderr",
                                          "LD_LIBRARY_PATH": str(PREFIX / "lib")})
            self.assertEqual((asked.returncode, asked.stdout), (0, EXPECTED), name + asked.stderr)
            self.assertIn(" LOG 3000 Consumer main:", asked.stderr)

    def test_each_library_is_found_alone_and_only_one_brings_the_headers_of_cmpi(self):
        version = re.search(r"project\(\S+ VERSION (\S+)", (SOURCE / "CMakeLists.txt").read_text(encoding="utf-8")).group(1)
        for name in LIBRARIES:
            self.assertEqual(pkg_config("--modversion", name).stdout.strip(), version)
            self.assertIn(f"-l{name}", pkg_config("--libs", name).stdout.split())
            cmpi = "-DCMPI_VERSION=200" in pkg_config("--cflags", name).stdout.split()
            self.assertEqual(cmpi, name == "vkproviderutilities", name)

    def test_a_version_that_is_too_new_is_refused(self):
        self.assertNotEqual(pkg_config("--exists", "nvlog >= 2").returncode, 0)
        source = directory()
        (source / "CMakeLists.txt").write_text("cmake_minimum_required(VERSION 3.25)\nproject(x NONE)\n"
                                               "find_package(vk-baseserver 2.0 REQUIRED)\n", encoding="utf-8")
        done = run("cmake", "-S", source, "-B", source / "build", f"-DCMAKE_PREFIX_PATH={PREFIX}")
        self.assertNotEqual(done.returncode, 0)
        self.assertIn("compatible with requested", done.stderr)

    def test_names_places_relative_to_itself(self):
        moved = directory() / "moved"
        shutil.copytree(PREFIX, moved, symlinks=True)
        done = run("pkg-config", "--cflags", "vkcommon", env={**os.environ, "PKG_CONFIG_PATH": str(moved / "lib/pkgconfig")})
        include = Path(done.stdout.strip().removeprefix("-I"))
        self.assertEqual(include.resolve(), moved / "include/vk-baseserver")


if __name__ == "__main__":
    unittest.main()
