#!/usr/bin/python3
"""Which mutants are chosen in a checkout, and how the list of equivalent ones is read. Skipped (77) without Debian's
python3-clang."""
import json
import pathlib
import shutil
import subprocess
import sys
import tempfile
import unittest

sys.dont_write_bytecode = True
sys.path.insert(0, str(pathlib.Path(__file__).parent))
try:
    import choice
    import equivalents
    import schema
    import workspace
except ImportError as missing:
    print(missing)
    sys.exit(77)

FIRST = "bool first(int a) {\n    return a == 4;\n}\n"
SECOND = "#include \"Limit.h\"\nbool second(int a) {\n    return a == limit;\n}\n"
LIMIT = "constexpr int limit = LIMIT + 2;\n"


class Checkout(unittest.TestCase):
    def setUp(self):
        directory = tempfile.TemporaryDirectory()
        self.addCleanup(directory.cleanup)
        self.root = pathlib.Path(directory.name) / "checkout"
        self.write("provider/First.cpp", FIRST)
        self.write("platform/zone/Second.cpp", SECOND)
        self.write("platform/include/Limit.h", LIMIT)
        self.write("tests/provider/FirstTest.cpp", "int test() { return 1; }\n")
        commands = [{"file": str(self.root / "provider/First.cpp"), "command": "g++ -c First.cpp"},
                    {"file": str(self.root / "platform/zone/Second.cpp"),
                     "command": f"g++ -DLIMIT=5 -Wall -I {self.root}/platform/include -std=c++17 -c Second.cpp"}]
        self.write("build/compile_commands.json", json.dumps(commands))
        self.write(".gitignore", "/build/\n")
        self.git("init", "-q")
        self.git("add", ".")
        self.git("-c", "user.name=A", "-c", "user.email=a@b", "commit", "-q", "-m", "Begin")
        self.choice = choice.Choice(self.root, self.root / "build")

    def write(self, name, text):
        path = self.root / name
        path.parent.mkdir(parents=True, exist_ok=True)
        path.write_text(text, encoding="utf-8")

    def git(self, *arguments):
        subprocess.run(["git", *arguments], cwd=self.root, check=True)


class ChoiceTest(Checkout):
    def test_the_product_s_sources_are_mutated_and_nothing_else(self):
        self.assertEqual(self.choice.files(), ["provider/First.cpp", "platform/include/Limit.h", "platform/zone/Second.cpp"])

    def test_a_source_is_read_as_it_is_compiled_and_a_header_as_the_nearest_source(self):
        found = [str(mutant) for mutant in self.choice.all_of(self.choice.files())]
        self.assertEqual(found, ["provider/First.cpp:2: first: comparison: == -> !=",
                                 "provider/First.cpp:2: first: constant: 4 -> 5",
                                 "platform/include/Limit.h:1: limit: constant: 2 -> 3",
                                 "platform/zone/Second.cpp:3: second: comparison: == -> !="])

    def test_unchanged_lines_have_no_mutants(self):
        self.assertEqual(self.choice.changed_since("HEAD"), [])

    def test_the_lines_that_differ_from_a_commit_have_mutants(self):
        self.write("provider/First.cpp", FIRST + "bool third(int a) { return a != 6; }\n")
        self.git("rm", "-q", "--cached", "platform/zone/Second.cpp")
        self.git("-c", "user.name=A", "-c", "user.email=a@b", "commit", "-q", "-m", "Forget")
        found = [str(mutant) for mutant in self.choice.changed_since("HEAD")]
        self.assertEqual(found, ["provider/First.cpp:4: third: comparison: != -> ==",
                                 "provider/First.cpp:4: third: constant: 6 -> 7",
                                 "platform/zone/Second.cpp:3: second: comparison: == -> !="])

    def test_a_seed_chooses_the_same_mutants_again_each_once(self):
        files = self.choice.files()
        once, = self.choice.at_random(7, files)
        self.assertEqual(sorted(once), sorted(self.choice.all_of(files)))
        self.assertEqual(list(self.choice.at_random(7, files)), [once])
        self.assertEqual(list(self.choice.at_random(7, files, 2)), [once[:2]])


class WorkspaceTest(Checkout):
    def setUp(self):
        super().setUp()
        self.copy = workspace.Workspace(self.root, self.root.parent / "work", 1)
        self.addCleanup(self.copy.lock.close)
        self.copy.take_over()
        self.mutant, = self.choice.mutants_of("platform/include/Limit.h")

    def schema(self):
        made = schema.Schema(self.copy, [self.mutant])
        made.give_up(f"{self.root}/{self.mutant.file}:1:15: note: not initialized with a constant expression")
        return made

    def test_the_copy_alone_is_mutated_and_put_right_again_whatever_happens(self):
        mutated = self.copy.tree / self.mutant.file
        with self.assertRaises(KeyboardInterrupt), self.schema().edited(self.mutant):
            self.assertIn("LIMIT + 3;", mutated.read_text())
            self.assertEqual((self.root / self.mutant.file).read_text(), LIMIT)
            raise KeyboardInterrupt
        self.assertEqual(mutated.read_text(), LIMIT)

    def test_what_a_killed_run_left_behind_is_put_right_by_the_next(self):
        self.schema().edited(self.mutant).__enter__()
        self.copy.take_over()
        self.assertEqual((self.copy.tree / self.mutant.file).read_text(), LIMIT)

    def test_what_is_gone_from_the_checkout_goes_from_the_copy(self):
        (self.root / "provider/First.cpp").unlink()
        self.copy.take_over()
        self.assertFalse((self.copy.tree / "provider/First.cpp").exists())
        self.assertTrue((self.copy.tree / "platform/zone/Second.cpp").exists())

    @unittest.skipUnless(shutil.which("bwrap"), "bubblewrap is missing")
    def test_what_a_mutant_writes_lands_nowhere(self):
        outside = self.root.parent / "outside"
        (self.copy.tree / "build/Testing").mkdir(parents=True)
        status, said = self.copy.run(["sh", "-c", f"echo outside > {outside}; ! test -w /etc && ! test -w provider"], 60)
        self.assertEqual(status, 0, said)
        self.assertFalse(outside.exists())

    def test_two_runs_do_not_share_a_copy(self):
        with self.assertRaises(workspace.Failure):
            workspace.Workspace(self.root, self.root.parent / "work", 1)


class EquivalentsTest(Checkout):
    def setUp(self):
        super().setUp()
        self.comparison, self.constant = self.choice.mutants_of("provider/First.cpp")

    def test_a_function_s_mutants_of_a_kind_are_equivalent_for_a_reason(self):
        listed = equivalents.Equivalents("# Head\n\nfirst: constant\n  It is never\n  asked.\n")
        self.assertEqual(listed.reason(self.constant), "It is never asked.")
        self.assertIsNone(listed.reason(self.comparison))

    def test_a_single_change_may_be_named(self):
        listed = equivalents.Equivalents("first: constant: 4 -> 5\n  Nobody counts.\nfirst: comparison: < -> <=\n  Nor here.\n")
        self.assertEqual(listed.reason(self.constant), "Nobody counts.")
        self.assertIsNone(listed.reason(self.comparison))

    def test_changes_may_be_named_by_an_expression(self):
        listed = equivalents.Equivalents("first: constant: /^4 -> [0-9]$/\n  Nobody counts.\nfirst: constant: /7/\n  Nor here.\n")
        self.assertEqual(listed.reason(self.constant), "Nobody counts.")
        self.assertEqual(listed.stale([self.constant]), ["first: constant: /7/"])

    def test_an_expression_that_cannot_be_read_is_named(self):
        with self.assertRaisesRegex(ValueError, r"^1: /\(/: "):
            equivalents.Equivalents("first: constant: /(/\n  So.\n")

    def test_an_entry_without_mutants_is_stale(self):
        listed = equivalents.Equivalents("first: constant\n  So.\nfirst: boundary\n  So.\nfirst: constant: 4 -> 6\n  So.\n")
        self.assertEqual(listed.stale([self.comparison, self.constant]), ["first: boundary", "first: constant: 4 -> 6"])

    def test_an_entry_needs_a_reason(self):
        with self.assertRaisesRegex(ValueError, "first: constant"):
            equivalents.Equivalents("first: constant\n\nfirst: comparison\n  So.\n")

    def test_the_list_of_this_product_can_be_read(self):
        equivalents.read()


if __name__ == "__main__":
    unittest.main()
