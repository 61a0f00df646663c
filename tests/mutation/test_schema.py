#!/usr/bin/python3
"""A program built with all of its mutants does as each of them when it is chosen. Skipped (77) without Debian's
python3-clang."""
import pathlib
import subprocess
import sys
import tempfile
import unittest

sys.dont_write_bytecode = True
sys.path.insert(0, str(pathlib.Path(__file__).parent))
try:
    import generator
    import schema
except ImportError as missing:
    print(missing)
    sys.exit(77)


class Copy:
    """Stands for the workspace: the checkout is its own copy."""

    def __init__(self, root):
        self.root = self.tree = root
        self.reached = root / "build/reached"
        self.log = root / "log"

    def build(self, *_):
        built = subprocess.run(["g++", "-std=c++20", "-Wall", "-Werror", "-o", "program", self.root / "main.cpp"],
                               cwd=self.root, stderr=subprocess.PIPE, check=False)
        self.log.write_bytes(built.stderr)
        return built.returncode


class SchemaTest(unittest.TestCase):
    def setUp(self):
        directory = tempfile.TemporaryDirectory()
        self.addCleanup(directory.cleanup)
        self.root = pathlib.Path(directory.name)
        (self.root / "build").mkdir()

    def built(self, text):
        path = self.root / "main.cpp"
        path.write_text(text, encoding="utf-8")
        built = schema.Schema(Copy(self.root), generator.mutants_of(path, ["-std=c++20"], "main.cpp"))
        self.enterContext(built)
        return built

    def said(self, number):
        return subprocess.run(["prlimit", f"--rss={number}:", self.root / "program"], env={}, check=False,
                              stdout=subprocess.PIPE, text=True).stdout.strip()

    def answers(self, text):
        """What the program says as each mutant, by the change."""
        numbers = self.built(text).numbers
        return {mutant.change(): self.said(number) for mutant, number in numbers.items()}, self.said("unlimited")

    def test_each_mutant_can_be_chosen(self):
        answers, usual = self.answers("""#include <cstdio>
bool ready(int a) { return a == 1 || !a; }
int main() {
    int count = 3;
    for (int i = 0; i < 2; ++i)
        if (ready(i)) count += 10; else count += 100;
    std::printf("%d", count);
}
""")
        self.assertEqual(usual, "23")
        self.assertEqual(answers["3 -> 4"], "24")
        self.assertEqual(answers["2 -> 3"], "123")
        self.assertEqual(answers["< -> <="], "123")
        self.assertEqual(answers["ready(i) -> !(ready(i))"], "203")
        self.assertEqual(answers["count += 10 -> nothing"], "3")
        self.assertEqual(answers["count += 100 -> nothing"], "23")
        self.assertEqual(answers["== -> !="], "113")
        self.assertEqual(answers["! -> nothing"], "113")
        self.assertEqual(answers["10 -> 11"], "25")

    def test_what_the_compiler_has_to_know_cannot_be_chosen_and_the_rest_can(self):
        answers, usual = self.answers("""#include <cstdio>
constexpr int limit = 4;
int main(int count, char**) {
    int a[] = {10, 20};
    switch (count) {
    case 1: std::printf("%d", a[0]);
    }
    return limit <= 3;
}
""")
        self.assertEqual(usual, "10")
        self.assertNotIn("4 -> 5", answers)  # the limit
        self.assertNotIn("1 -> 0", answers)  # the case
        self.assertNotIn("10, 20 -> 20, 10", answers)
        self.assertEqual(answers["10 -> 11"], "11")

    def test_a_single_mutant_can_be_built(self):
        built = self.built("constexpr int limit = 4;\nint main() { return limit - 4; }\n")
        limit, = (mutant for mutant in built.mutants if mutant not in built.numbers)
        with built.edited(limit):
            built.copy.build()
            self.assertEqual(subprocess.run([self.root / "program"], check=False).returncode, 1)

    def test_the_places_that_a_process_reaches_are_noted(self):
        built = self.built("int main(int count, char**) {\n    if (count > 1)\n        return 5;\n    return 0;\n}\n")
        built.copy.reached.write_bytes(bytes(built.size))
        self.said(0)
        reached = built.copy.reached.read_bytes()
        self.assertEqual({mutant.line for mutant, number in built.numbers.items() if reached[number]}, {2, 4})


if __name__ == "__main__":
    unittest.main()
