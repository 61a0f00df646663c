"""What the documents say of the sources: files, programs and tests that they name, and which room includes which."""

import re
import unittest
from pathlib import Path

SOURCE = Path(__file__).resolve().parents[2]


def documents():
    return [*SOURCE.glob("*.md"), *(SOURCE / "docs").glob("**/*.md")]


class Names(unittest.TestCase):
    def test_links_lead_to_files(self):
        for document in documents():
            for link in re.findall(r"\]\(([^)#]+)", document.read_text(encoding="utf-8")):
                if "://" not in link:
                    self.assertTrue((document.parent / link).exists(), f"{document.name}: {link}")

    def test_programs_of_the_tests_are_built_and_hold_the_tests_named(self):
        lists = {path.parent: path.read_text(encoding="utf-8") for path in (SOURCE / "tests").glob("**/CMakeLists.txt")}
        found = [(document.name, *names) for document in documents() for names in re.findall(
            r"build/tests/([\w-]+)(?: --gtest_filter='\*(\w+)\*')?", document.read_text(encoding="utf-8"))]
        self.assertTrue(any(test for _, _, test in found))
        for document, program, test in found:
            directories = [where for where, text in lists.items() if re.search(rf"(?<![\w-]){program}(?![\w-])", text)]
            self.assertTrue(directories, f"{document}: {program}")
            sources = "".join(path.read_text(encoding="utf-8") for where in directories for path in where.glob("*.cpp"))
            self.assertIn(test, sources, f"{document}: {program}")


class Words(unittest.TestCase):
    def test_that_made_readers_stop_stay_away(self):
        stumbling = re.compile(r"deliver\w* indications again|nothing current|installed twice|(?:does not|cannot|could not) tell\b|"
                               r"\bis so already|floors? of this house|same one by the same")
        texts = [*documents(), *SOURCE.glob("docs/**/*.in"), *SOURCE.glob("docs/json/*"), *SOURCE.glob("schema/*.mof"),
                 *SOURCE.glob("tools/**/*"), *SOURCE.glob("objectmanager/vkcim/*"), *SOURCE.glob("platform/**/*Notes.cpp")]
        for text in filter(Path.is_file, texts):
            found = stumbling.search(" ".join(text.read_text(encoding="utf-8").split()))
            self.assertIsNone(found, text)

    def test_on_the_licence_are_the_same_wherever_they_must_be(self):
        for name in ("README.md", "packaging/debian/copyright"):
            text = " ".join((SOURCE / name).read_text(encoding="utf-8").split())
            self.assertRegex(text, r"No licence is granted yet.*: the owner decides", name)


class Classes(unittest.TestCase):
    def test_each_has_a_row_in_the_readme(self):
        text = (SOURCE / "README.md").read_text(encoding="utf-8")
        classes = {file.stem for file in (SOURCE / "schema").glob("*.mof")}
        self.assertEqual(classes - set(re.findall(r"^\| (\w+) \| ", text, re.M)), set())


class Rooms(unittest.TestCase):
    def test_include_what_the_architecture_says(self):
        text = (SOURCE / "docs/architecture.md").read_text(encoding="utf-8")
        rows = re.findall(r"^\| `platform/(\w+)` \|[^|]*\| ([^|]*) \|$", text, re.M)
        allowed = {room: set(re.findall(r"`(\w+)`", others)) for room, others in rows}
        rooms = {room.name for room in (SOURCE / "platform").iterdir() if [*room.glob("*.cpp")]}
        self.assertEqual(set(allowed), rooms)
        for room, others in allowed.items():
            for path in (SOURCE / "platform" / room).glob("*.*"):
                included = set(re.findall(r'^#include "(\w+)/', path.read_text(encoding="utf-8"), re.M)) & rooms
                self.assertLessEqual(included - {room}, others, path)


if __name__ == "__main__":
    unittest.main()
