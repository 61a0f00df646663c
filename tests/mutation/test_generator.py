#!/usr/bin/python3
"""Which mutants are made of a source: exactly these. Skipped (77) without Debian's python3-clang, which belongs to the
system's own interpreter."""
import pathlib
import sys
import tempfile
import unittest

sys.path.insert(0, str(pathlib.Path(__file__).parent))
try:
    import generator
except ImportError as missing:
    print(missing)
    sys.exit(77)


class MutantsTest(unittest.TestCase):
    def mutants(self, text, suffix=".cpp", arguments=("-std=c++17",)):
        with tempfile.TemporaryDirectory() as directory:
            path = pathlib.Path(directory) / f"sample{suffix}"
            path.write_text(text, encoding="utf-8")
            return generator.mutants_of(path, list(arguments), "sample")

    def expect(self, text, *expected, **options):
        found = [f"{mutant.line} {mutant.function}: {mutant.kind}: {mutant.change()}" for mutant in
                 self.mutants(text, **options)]
        self.assertEqual(sorted(found), sorted(expected))

    def test_a_comparison_is_turned_round_and_its_boundary_moved(self):
        self.expect("bool less(int a, int b) {\n    return a < b;\n}",
                    "2 less: comparison: < -> >=", "2 less: boundary: < -> <=")
        self.expect("bool same(int a, int b) { return a == b; }", "1 same: comparison: == -> !=")

    def test_a_comparison_of_objects_counts_as_well(self):
        text = "struct Text { bool operator==(const Text&) const; };\nbool same(Text a, Text b) { return a == b; }"
        self.expect(text, "2 same: comparison: == -> !=")
        with_cxx20 = text + "\nbool other(Text a, Text b) { return a != b; }"
        self.expect(with_cxx20, "2 same: comparison: == -> !=", "3 other: comparison: != -> ==",
                    arguments=["-std=c++20"])

    def test_a_comparison_made_of_a_three_way_one_counts_once(self):
        self.expect("#include <compare>\nstruct Time { int at; auto operator<=>(const Time&) const = default; };\n"
                    "int late(Time a, Time b) {\n    if (a >= b) return 2;\n    return 3;\n}",
                    "4 late: comparison: >= -> <", "4 late: boundary: >= -> >", "4 late: removed statement: return 2 -> nothing",
                    "4 late: constant: 2 -> 3", "5 late: constant: 3 -> 4", arguments=["-std=c++20"])

    def test_brackets_of_templates_are_no_comparisons(self):
        self.expect("template <class T> struct Box { T held; };\nBox<Box<int>> twice(Box<Box<int>>&& box) { return box; }")

    def test_what_a_template_does_is_mutated_once(self):
        self.expect("template <class T> bool before(T a, T b) { return a > b; }\n"
                    "bool one = before(3, 4), two = before('a', 'b');",
                    "1 before: comparison: > -> <=", "1 before: boundary: > -> >=",
                    "2 one: constant: 3 -> 4", "2 one: constant: 4 -> 5")

    def test_constants_change(self):
        self.expect("int number() { return 41; }", "1 number: constant: 41 -> 42")
        self.expect("int one() { return 1; }", "1 one: constant: 1 -> 0")
        self.expect("unsigned mask() { return 0xFEU; }", "1 mask: constant: 0xFEU -> 0xFFU")
        self.expect("int mode() { return 0640; }", "1 mode: constant: 0640 -> 0641")
        self.expect("bool yes() { return true; }", "1 yes: constant: true -> false")
        self.expect("constexpr int limit = 0;", "1 limit: constant: 0 -> 1")

    def test_strings_characters_comments_and_directives_stay(self):
        self.expect("#define LIMIT 5\n#if 1 < 2\n#include <cstddef>\n#endif\n// 1 < 2\n"
                    "const char* text() { return \"a < b, 1 == 2\"; /* !x */ }\nchar letter() { return '1'; }\n"
                    "int limit() { return LIMIT; }")

    def test_what_declares_stays(self):
        self.expect("enum class Kind { One = 1, Two = 2 };\nint run(int times = 3);\n"
                    "template <int N = 4> struct Row { char bytes[5]; int count = 6; };\nstatic_assert(7 < 8, \"\");\n"
                    "Row<9> rows[10];\nint run(int times) { char buffer[11]; return times + sizeof buffer; }")

    def test_a_condition_is_negated(self):
        self.expect("bool ready();\nint run() {\n    if (ready()) return 5;\n    return ready() ? 6 : 7;\n}",
                    "3 run: negation: ready() -> !(ready())", "3 run: removed statement: return 5 -> nothing",
                    "3 run: constant: 5 -> 6", "4 run: negation: ready() -> !(ready())",
                    "4 run: constant: 6 -> 7", "4 run: constant: 7 -> 8")
        self.expect("bool ready();\nvoid wait() { while (!ready()) ; }", "2 wait: negation: ! -> nothing")

    def test_the_parts_of_a_condition_are_negated_one_by_one(self):
        self.expect("bool all(bool a, int b, bool c) { return a && (b == 2 || !c); }",
                    "1 all: negation: a -> !(a)", "1 all: comparison: == -> !=", "1 all: constant: 2 -> 3",
                    "1 all: negation: ! -> nothing")

    def test_a_loop_s_head_is_mutated_but_not_removed(self):
        self.expect("void step(int);\nvoid run(int n) {\n    for (int i = 0; i < n; ++i) step(i);\n}",
                    "3 run: constant: 0 -> 1", "3 run: comparison: < -> >=", "3 run: boundary: < -> <=",
                    "3 run: removed statement: step(i) -> nothing")

    def test_statements_are_removed(self):
        self.expect("void step(int&);\nint run(int a) {\n    step(a);\n    a = a + a;\n    ++a;\n"
                    "    for (;;) {\n        if (a) break; else continue;\n    }\n    return a;\n}",
                    "3 run: removed statement: step(a) -> nothing", "4 run: removed statement: a = a + a -> nothing",
                    "5 run: removed statement: ++a -> nothing", "7 run: negation: a -> !(a)",
                    "7 run: removed statement: break -> nothing", "7 run: removed statement: continue -> nothing")

    def test_an_object_that_nothing_names_is_removed(self):
        self.expect("struct Lock { Lock(int&); ~Lock(); };\n"
                    "int run(int& a) {\n    Lock lock(a);\n    int b = a;\n    return b;\n}",
                    "3 run: removed statement: Lock lock(a) -> nothing")

    def test_what_a_macro_declares_stays(self):
        self.expect("#define PLACE() []() -> int& { static int place; return place; }()\nint run() {\n    return PLACE();\n}")

    def test_what_members_begin_with_is_mutated(self):
        self.expect("struct Point {\n    Point() : x(4) {}\n    int x;\n};", "2 Point::Point: constant: 4 -> 5")

    def test_neighbouring_rows_are_swapped(self):
        self.expect("namespace rooms {\nconst char* const names[] = {\"a\", \"b\", \"c\"};\n}",
                    '2 rooms::names: swapped rows: "a", "b" -> "b", "a"',
                    '2 rooms::names: swapped rows: "b", "c" -> "c", "b"')
        self.expect("struct Row { int a; const char* b; };\nRow table[] = {{'1', \"x\"}, {'2', \"y\"}, {'2', \"y\"}};",
                    "2 table: swapped rows: {'1', \"x\"}, {'2', \"y\"} -> {'2', \"y\"}, {'1', \"x\"}")

    def test_what_is_included_within_a_table_stays(self):
        with tempfile.NamedTemporaryFile("w", suffix=".inc") as included:
            included.write("{1, true},\n{2, false},\n{3, true},\n")
            included.flush()
            self.expect("// 0,1,2,3,4,5,6,7,8,9,10,11,12,13,14,15,16\nstruct Row { int a; bool b; };\nconst Row table[] = {\n"
                        f"#include \"{included.name}\"\n}};")

    def test_a_function_is_named_with_its_namespaces_and_classes(self):
        self.expect("namespace a { namespace {\ntemplate <class T> struct B { bool c(T x) const { return x != x; } };\n}}",
                    "2 a::B::c: comparison: != -> ==", suffix=".h")

    def test_a_mutant_replaces_its_own_text_alone(self):
        text = "// naïve\nbool f(int a) { return a == a; }\n"
        mutant, = self.mutants(text)
        changed = mutant.apply(text.encode().decode("latin-1")).encode("latin-1").decode()
        self.assertEqual(changed, "// naïve\nbool f(int a) { return a != a; }\n")

    def test_a_source_that_cannot_be_read_whole_is_refused(self):
        with self.assertRaises(generator.CannotRead):
            self.mutants("#include \"missing.h\"\nbool f(int a) { return a == a; }\n")


if __name__ == "__main__":
    unittest.main()
