"""Where the dynamic linker looks for libraries: nothing that is built or installed makes it search the directory that a
process happens to be started in, which an empty or a relative element of a RUNPATH would."""

import re
import unittest
from pathlib import Path

from support import BUILD, directory, install, run

LIBRARIES = ["nvlog", "vkcommon", "vkproduct", "vkinstrumentation", "vkproviderutilities",
             "vknabaseserverprofileprovider"]
RELOCATABLE, LINKED = 1, (2, 3)  # the kinds of ELF file


def kind(path: Path):
    """The kind of an ELF file, None for any other file."""
    with path.open("rb") as file:
        head = file.read(18)
    if not head.startswith(b"\x7fELF"):
        return None
    return int.from_bytes(head[16:18], "little" if head[5] == 1 else "big")


def linked_files(where: Path):
    """Every program and shared library below a directory; an object file has no dynamic section."""
    kinds = {p: kind(p) for p in sorted(where.rglob("*")) if p.is_file() and not p.is_symlink()}
    strange = [p for p, k in kinds.items() if k not in (None, RELOCATABLE, *LINKED)]
    assert not strange, f"neither program nor library nor object file: {strange}"
    return [p for p, k in kinds.items() if k in LINKED]


def search_path(path: Path):
    """The elements of a file's RPATH and RUNPATH."""
    done = run("readelf", "--dynamic", "--wide", path, env={"PATH": "/usr/bin:/bin", "LC_ALL": "C"})
    assert done.returncode == 0 and not done.stderr, f"{path}: {done.stderr}"
    assert "Dynamic section" in done.stdout or "There is no dynamic section" in done.stdout, f"{path}: {done.stdout}"
    values = re.findall(r"\((?:RPATH|RUNPATH)\) .*: \[(.*)\]$", done.stdout, re.M)
    assert len(values) == len(re.findall(r"\((?:RPATH|RUNPATH)\)", done.stdout)), f"{path}: {done.stdout}"
    return [element for value in values for element in value.split(":")]


def is_fixed(element):
    return element.startswith("/") or element == "$ORIGIN" or element.startswith("$ORIGIN/")


class SearchPath(unittest.TestCase):
    def check(self, where, expected):
        files = linked_files(where)
        self.assertLessEqual({where / name for name in expected}, {p for p in files})
        for path in files:
            for element in search_path(path):
                with self.subTest(path):
                    self.assertTrue(is_fixed(element), f"the element {element!r}")

    def names(self, lib):
        return [f"{lib}/lib{name}.so.1" for name in LIBRARIES] + ["bin/vkcim"]

    def test_of_what_is_built(self):
        self.check(BUILD, self.names("lib"))

    def test_of_what_is_installed(self):
        prefix = directory() / "installed"
        install(prefix)
        self.check(prefix, self.names("lib"))
        for name in LIBRARIES:
            self.assertEqual(search_path(prefix / f"lib/lib{name}.so.1"), ["$ORIGIN", f"{prefix}/lib"])

    def test_of_what_is_installed_for_the_whole_system(self):
        stage = directory()
        install(Path("/usr"), destdir=stage)
        self.check(stage / "usr", self.names("lib"))
        for name in LIBRARIES:
            self.assertEqual(search_path(stage / f"usr/lib/lib{name}.so.1"), [])

    def test_is_read_from_the_file_itself(self):
        self.assertEqual([is_fixed(e) for e in ("$ORIGIN", "$ORIGIN/../lib", "/usr/lib", "", ".", "lib", "../lib",
                                                "$ORIGINAL", "$LIB")], [True] * 3 + [False] * 6)


if __name__ == "__main__":
    unittest.main()
