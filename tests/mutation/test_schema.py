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

    def test_what_is_computed_when_compiling_can_be_chosen_where_nothing_needs_it_then(self):
        answers, usual = self.answers("""#include <cstdio>
constexpr int limit = 4;
constexpr int size = 6;
constexpr int twice(int a) { return 2 * a; }
struct Named {
    static constexpr int names[] = {10, 20};
};
struct Row {
    const char* name;
    int number;
};
constexpr Row rows[] = {{"a", 7}, {"b", twice(7)}};
int main() {
    static_assert(size);
    std::printf("%d %d %s%d %s%d", limit, Named::names[0], rows[0].name, rows[0].number, rows[1].name, rows[1].number);
}
""")
        self.assertEqual(usual, "4 10 a7 b14")
        self.assertEqual(answers["4 -> 5"], "5 10 a7 b14")
        self.assertEqual(answers["2 -> 3"], "4 10 a7 b21")
        self.assertEqual(answers["10, 20 -> 20, 10"], "4 20 a7 b14")
        self.assertEqual(answers['{"a", 7}, {"b", twice(7)} -> {"b", twice(7)}, {"a", 7}'], "4 10 b14 a7")
        self.assertNotIn("6 -> 7", answers)

    def test_rows_of_objects_can_be_chosen(self):
        answers, usual = self.answers("""#include <cstdio>
#include <variant>
struct Row {
    const char* name;
    std::variant<int, const char*> value;
};
constexpr Row rows[] = {{"a", 7}, {"b", 8}};
int main() { std::printf("%s%d", rows[0].name, std::get<0>(rows[1].value)); }
""")
        self.assertEqual(usual, "a8")
        self.assertEqual(answers['{"a", 7}, {"b", 8} -> {"b", 8}, {"a", 7}'], "b7")

    def test_an_object_can_be_left_out(self):
        answers, usual = self.answers("""#include <cstdio>
struct Noted {
    Noted(const char* text, int) { std::printf("<%s", text); }
    ~Noted() { std::printf(">"); }
};
int main() {
    const Noted noted("in", 5);
    std::printf(".");
}
""")
        self.assertEqual(usual, "<in.>")
        self.assertEqual(answers['const Noted noted("in", 5) -> nothing'], ".")

    def test_what_the_compiler_has_to_know_cannot_be_chosen_and_the_rest_can(self):
        answers, usual = self.answers("""#include <cstdio>
constexpr int limit = 4;
static_assert(limit == 4);
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
        self.assertEqual(answers["10, 20 -> 20, 10"], "20")
        self.assertEqual(answers["10 -> 11"], "11")

    def test_what_the_end_of_a_function_needs_cannot_be_chosen(self):
        answers, usual = self.answers("""#include <cstdio>
#include <cstdlib>
[[noreturn]] void end() {
    std::exit(5);
}
int main() {
    std::printf("%d", 6);
    end();
}
""")
        self.assertEqual(usual, "6")
        self.assertEqual(answers["6 -> 7"], "7")
        self.assertNotIn("5 -> 6", answers)

    def test_a_single_mutant_can_be_built(self):
        built = self.built("constexpr int limit = 4;\nint main() {\n    enum { same = limit };\n    return same - 4;\n}\n")
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

    def test_a_library_can_be_unloaded_and_loaded_again_and_leaves_no_map_each_time(self):
        built = self.built("struct Limits {\n    static constexpr int most = 1;\n};\n\n"
                           "int ask(int count) {\n    return count > Limits::most;\n}\n\nint main() {}\n")
        self.assertIn("1 -> 0", {mutant.change() for mutant in built.numbers})
        built.copy.reached.write_bytes(bytes(built.size))
        for name in ("first.so", "second.so"):
            subprocess.run(["g++", "-shared", "-fPIC", "-o", name, "main.cpp"], cwd=self.root, check=True)
        load = (f"import _ctypes, ctypes\nfor name in ('first.so', 'second.so'):\n    library = ctypes.CDLL('{self.root}/' + name)\n"
                "    library['_Z3aski'](2)\n    _ctypes.dlclose(library._handle)\n"
                "print([line.split('/')[-1] for line in open('/proc/self/maps') if '/first.so' in line or '/reached' in line])")
        asked = subprocess.run(["prlimit", "--rss=0:", sys.executable, "-c", load], check=True, stdout=subprocess.PIPE)
        self.assertEqual(asked.stdout, b"['reached\\n']\n")


if __name__ == "__main__":
    unittest.main()
