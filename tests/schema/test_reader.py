"""What the compiler of the MOF files takes, refuses and writes. The command that runs it is this program's arguments."""

import json
import subprocess
import sys
import tempfile
import unittest
from pathlib import Path

COMPILER = sys.argv[1:]

STUB = """
CIM_Top
    string Caption
CIM_Keyed < CIM_Top
    key string Name
    uint16 States[]
    uint32 Do(in boolean Really, in out datetime When, in CIM_Top ref What)
CIM_Link association
    key CIM_Top ref From
    key CIM_Keyed ref To
"""
GOOD = """
// A comment, /* and another */
[Version("1.0.0"), Description("A " "joined " // in between
 "text")]
class VESKA_Thing : CIM_Keyed {
    [Override("Name"), Description("n")] string Name;
    [Override("States"), Description("s"), ValueMap {"0", "2..7", "9.."}, Values {"a", "b", "c"}] uint16 States[];
    [Read, Write, Description("w")] sint8 Small = -128;
    [Description("d")] real32 Height = 1.5;
    [Override("Do"), Description("m")] uint32 Do([In, Description("p")] boolean Really,
        [In, Out, Description("p")] datetime When, [In, Description("p")] CIM_Top REF What);
};
[Association, Version("1.0.0"), Description("d")]
class VESKA_Link : CIM_Link {
    [Override("To"), Description("narrower")] VESKA_Thing REF To;
};
"""


class Compiler(unittest.TestCase):
    """Runs the compiler on files of its own."""

    def setUp(self):
        directory = tempfile.TemporaryDirectory()
        self.addCleanup(directory.cleanup)
        self.directory = Path(directory.name)

    def file(self, name, text):
        (self.directory / name).write_text(text, encoding="utf-8")
        return self.directory / name

    def run_it(self, *arguments):
        return subprocess.run([*COMPILER, *map(str, arguments)], capture_output=True, text=True, check=False, cwd=self.directory)

    def compiled(self, text, *arguments):
        """The complaints about a text over the stub, each a line that begins with t.mof and a number."""
        self.file("facts", STUB)
        self.file("t.mof", text)
        done = self.run_it("--facts", "facts", *arguments, "t.mof")
        self.assertEqual(done.returncode, 1 if done.stderr else 0, done.stderr)
        return done.stderr.splitlines()

    def output(self, option, text, *arguments):
        """What is made of a text without mistakes."""
        self.assertEqual(self.compiled(text, option, "out", *arguments), [])
        return (self.directory / "out").read_text(encoding="utf-8")


def thing(body, head='Version("1.0.0"), Description("d")', above=" : CIM_Keyed", name="VESKA_Thing"):
    return f"[{head}]\nclass {name}{above} {{\n{body}\n}};\n"


# What is wrong, the text, what the complaint says. The class's own line is 2, its first property's 3.
REFUSED = [
    ("an undeclared superclass", thing("", above=" : CIM_Gone"), "t.mof:2: superclass CIM_Gone of VESKA_Thing is not"),
    ("a class twice", GOOD + thing(""), "class VESKA_Thing is declared already at t.mof:5"),
    ("a superclass redefined", thing("", name="CIM_Keyed", above=" : CIM_Top"),
     "class CIM_Keyed is declared already at stub of facts:"),
    ("a class of the standard's", thing("", name="CIM_New"), "class CIM_New is one of the standard's"),
    ("a name without prefix", thing("", name="Thing"), "class name Thing lacks a schema's prefix"),
    ("a property type", thing('[Description("d")] uint17 A;'), "t.mof:3: 'uint17' is no type"),
    ("a class as type", thing('[Description("d")] CIM_Top A;'), "t.mof:3: 'CIM_Top' is no type"),
    ("a reference class", thing('[Description("d")] CIM_Gone REF A;'),
     "t.mof:3: VESKA_Thing.A refers to CIM_Gone, which is not declared"),
    ("references outside associations", thing('[Description("d")] CIM_Top REF A;'),
     "class VESKA_Thing has references and is no association"),
    ("an unknown qualifier", thing('[Colour("red"), Description("d")] string A;'),
     "t.mof:3: unknown qualifier Colour on VESKA_Thing.A"),
    ("a qualifier out of place", thing('[Association, Description("d")] string A;'),
     "Association may not stand on a property"),
    ("a qualifier's value", thing('[MaxLen("x"), Description("d")] string A;'), "MaxLen of VESKA_Thing.A takes a integer"),
    ("a qualifier twice", thing('[Read, READ, Description("d")] string A;'), "qualifier READ stands here twice"),
    ("a property twice", thing('[Description("d")] string A;\n[Description("d")] uint8 a;'),
     "t.mof:4: VESKA_Thing.a is declared already at t.mof:3"),
    ("an inherited property again", thing('[Description("d")] string Caption;'),
     "VESKA_Thing.Caption is inherited and declared again without Override"),
    ("an override of nothing", thing('[Override("A"), Description("d")] string A;'),
     "VESKA_Thing.A overrides what no superclass declares"),
    ("an override of another name", thing('[Override("Name"), Description("d")] string Caption;'),
     "VESKA_Thing.Caption overrides Name, which is named otherwise"),
    ("another type", thing('[Override("States"), Description("d")] uint16 States;'),
     "VESKA_Thing.States is uint16, but uint16[] in a superclass"),
    ("a wider reference", thing('[Override("To"), Description("d")] CIM_Top REF To;', above=" : CIM_Link",
                                head='Association, Version("1.0.0"), Description("d")'),
     "VESKA_Thing.To is CIM_Top ref, but CIM_Keyed ref in a superclass"),
    ("an inherited key again", thing('[Key, Override("Name"), Description("d")] string Name;'),
     "VESKA_Thing.Name redefines an inherited key"),
    ("a further key", thing('[Key, Description("d")] string A;'), "VESKA_Thing.A adds a key to those of CIM_Keyed"),
    ("an array as key", thing('[Key, Description("d")] string A[];', above=" : CIM_Top"), "key VESKA_Thing.A is an array"),
    ("no key", thing('[Description("d")] string A;', above=" : CIM_Top"), "class VESKA_Thing has no key"),
    ("an association below none", thing("", head='Association, Version("1.0.0"), Description("d")'),
     "VESKA_Thing and its superclass CIM_Keyed are not both associations"),
    ("Association not first", thing("", head='Version("1.0.0"), Association, Description("d")', above=" : CIM_Link"),
     "Association is not the first qualifier of VESKA_Thing"),
    ("one reference", thing('[Key, Description("d")] CIM_Top REF A;', above="",
                            head='Association, Version("1.0.0"), Description("d")'),
     "association VESKA_Thing has fewer than two references"),
    ("a method's other signature", thing('[Override("Do"), Description("d")] uint32 Do();'),
     "VESKA_Thing.Do differs from the method that it overrides"),
    ("a parameter of no direction", thing('[Description("d")] uint32 F([Description("d")] string A);'),
     "VESKA_Thing.F(A) is neither In nor Out"),
    ("a parameter twice",
     thing('[Description("d")] uint32 F([In, Description("d")] string A, [In, Description("d")] string a);'),
     "parameter VESKA_Thing.F(a) stands there twice"),
    ("unpaired values", thing('[Description("d"), ValueMap {"1"}, Values {"a", "b"}] uint8 A;'),
     "ValueMap and Values of VESKA_Thing.A do not pair"),
    ("a value out of range", thing('[Description("d"), ValueMap {"256"}, Values {"a"}] uint8 A;'),
     "'256' in the ValueMap of VESKA_Thing.A is no uint8"),
    ("a value twice", thing('[Description("d"), ValueMap {"1", "1"}, Values {"a", "b"}] uint8 A;'),
     "a value stands twice in the ValueMap of VESKA_Thing.A"),
    ("a default of another type", thing('[Description("d")] boolean A = 1;'), "the default of VESKA_Thing.A is no boolean"),
    ("a default out of range", thing('[Description("d")] uint8 A = 256;'), "the default of VESKA_Thing.A is no uint8"),
    ("no description", thing("string A;"), "VESKA_Thing.A has no description"),
    ("no version", thing("", head='Description("d")'), "class VESKA_Thing has no version of three numbers"),
    ("a pragma", '#pragma include ("a.mof")', "t.mof:1: #pragma is refused"),
    ("an instance", "instance of CIM_Top { };", "t.mof:1: expected a class, found 'instance'"),
    ("a missing semicolon", thing('[Description("d")] string A'), "t.mof:4: expected ';', found '}'"),
    ("an open string", thing('[Description("d)] string A;'), "t.mof:3: the string does not end on its line"),
    ("an open comment", "/* ...", "t.mof:1: the comment does not end"),
    ("an unknown escape", thing('[Description("\\q")] string A;'), "t.mof:3: unknown escape"),
    ("a stray character", "class % {};", "t.mof:1: unexpected character '%'"),
    ("an open class", "[Description(\"d\")]\nclass VESKA_A {", "t.mof:2: expected a type, found the file's end"),
]


class Reader(Compiler):
    def test_takes_what_a_compiler_takes(self):
        declared, link = json.loads(self.output("--json", GOOD))["classes"]
        self.assertEqual([(p["name"], p["type"]) for p in declared["properties"]],
                         [("Name", "string"), ("States", "uint16[]"), ("Small", "sint8"), ("Height", "real32")])
        self.assertEqual(declared["keys"], ["Name"])
        self.assertEqual(link["keys"], ["From", "To"])
        self.assertIn('{"Description", qualifierValue("A joined text")}', self.output("--cpp", GOOD))

    def test_refuses_with_file_and_line(self):
        for what, text, complaint in REFUSED:
            with self.subTest(what):
                errors = self.compiled(text)
                self.assertTrue(any(complaint in e for e in errors), f"expected: {complaint}\ncame: {errors}")

    def test_names_every_complaint_of_a_file(self):
        errors = self.compiled(thing('[Colour, Description("d")] string A;\nstring B;'))
        self.assertEqual(len(errors), 2, errors)


class Facts(Compiler):
    def stub(self, text):
        done = self.run_it("--facts", self.file("f", text), "--list", self.file("none", ""), "--stub", "stub")
        self.assertEqual((done.returncode, done.stderr), (0, ""))
        return (self.directory / "stub").read_text(encoding="utf-8")

    def test_become_a_stub_with_keys_overrides_and_methods(self):
        stub = self.stub("CIM_A\n  string Name\nCIM_B < CIM_A\n  key string Name # c\n  uint8 F(in out string S[])\n")
        self.assertIn('[Override("Name"), Key] string Name;', stub)
        self.assertIn("uint8 F([In, Out] string S[]);", stub)

    def test_carry_default_values(self):
        stub = self.stub("CIM_A\n  uint16 State = 12\n  uint16 Other=2 # c\n")
        self.assertIn("uint16 State = 12;", stub)
        self.assertIn("uint16 Other = 2;", stub)

    def test_refuse_what_is_no_fact(self):
        for text, complaint in [("  string A", "f:1: a property before the first class"),
                                ("CIM_A ! CIM_B", "f:1: 'CIM_A ! CIM_B' is not a class"),
                                ("CIM_A\n  key key string A", "f:2: 'key key string A' is not a property"),
                                ("CIM_A\n  string A = ", "f:2: 'string A =' is not a property"),
                                ("CIM_A\n  uint8 F(in)", "f:2: 'in' is not a parameter")]:
            with self.subTest(text):
                done = self.run_it("--facts", self.file("f", text), "--list", self.file("none", ""))
                self.assertEqual(done.returncode, 1)
                self.assertIn(complaint, done.stderr)


class Output(Compiler):
    def test_table_carries_inherited_keys_into_overrides(self):
        table = self.output("--cpp", GOOD)
        self.assertIn('{"Name", CMPI_string, true, "", {', table)
        self.assertIn('{"States", CMPI_uint16A, false, "", {', table)
        self.assertIn('{"To", CMPI_ref, true, "VESKA_Thing", {', table)
        self.assertRegex(table, r'\{\{"When", CMPI_dateTime, false, "", \{.*\}\}, true, true\}')

    def test_table_carries_qualifiers_in_their_order(self):
        table = self.output("--cpp", thing('[Key, Description("a \\"d\\"")] string A; [Write, Description("d"), ValueMap {"1"}, '
                                           'Values {"One"}] uint8 B;', above=" : CIM_Top"))
        self.assertIn(r'{{"Key", qualifierValue(true)}, {"Description", qualifierValue("a \"d\"")}}', table)
        self.assertIn('{"ValueMap", qualifierValue({"1"})}, {"Values", qualifierValue({"One"})}}', table)

    def test_registration_names_each_class_once_with_its_kinds(self):
        provider = ["--module", "M", "--provider", "P", "--location", "loc", "--provider-version", "1.2.3", "--vendor", "V",
                    "--description", "D", "--namespace", "root/x"]
        self.assertEqual(self.output("--reg", GOOD, *provider),
                         "[VESKA_Thing]\n   provider: P\n   location: loc\n   type: instance method\n"
                         "   namespace: root/x\n#\n"
                         "[VESKA_Link]\n   provider: P\n   location: loc\n   type: instance association\n"
                         "   namespace: root/x\n#\n")
        instances = self.output("--module-mof", GOOD, *provider)
        self.assertEqual(instances.count("instance of PG_ProviderCapabilities"), 2)
        self.assertIn('Version = "1.2.3";', instances)
        self.assertIn("ProviderType = {2, 5};", instances)
        self.assertIn("ProviderType = {2, 3};", instances)
        self.assertIn('Namespaces = {"root/x"};', instances)
        self.assertIn("SupportedMethods = NULL;", instances)

    def test_frames_are_filled(self):
        self.file("frame", "@CLASS_LIST@ @ASSOCIATION_WORDS@ @ROLE_WORDS@ @METHOD_WORDS@ @OTHER@\n")
        self.assertEqual(self.compiled(GOOD, "--fill", "frame", "one", "--fill", "frame", "two"), [])
        for name in ("one", "two"):
            self.assertEqual((self.directory / name).read_text(encoding="utf-8"),
                             '["VESKA_Thing"] VESKA_Link To VESKA_Thing=Do @OTHER@\n')

    def test_manual_escapes_what_roff_would_read(self):
        self.file("frame", "@CLASSES@")
        self.compiled(thing('[Description(".a-b\\n\'c\\\\"), Write] uint8 A;'), "--fill", "frame", "out")
        self.assertIn("\\fBA\\fR, uint8 (writable)\n\\&.a\\-b\n\\&'c\\e", (self.directory / "out").read_text(encoding="utf-8"))


class Command(Compiler):
    def test_our_files_compile_silently(self):
        done = self.run_it()
        self.assertEqual((done.returncode, done.stdout, done.stderr), (0, "", ""))

    def test_writes_nothing_after_a_complaint(self):
        bad = self.file("bad.mof", thing('[Colour, Description("d")] string A;', above=" : CIM_System"))
        done = self.run_it("--json", "out.json", bad)
        self.assertEqual(done.returncode, 1)
        self.assertEqual(done.stderr, f"{bad}:3: unknown qualifier Colour on VESKA_Thing.A\n")
        self.assertFalse((self.directory / "out.json").exists())

    def test_names_a_file_that_cannot_be_read_or_written(self):
        self.file("file", "")
        for arguments, complaint in [(["gone.mof"], "gone.mof: No such file or directory\n"),
                                     ([self.directory], f"{self.directory}: Is a directory\n"),
                                     (["--json", "file/out.json"], "file/out.json: Not a directory\n")]:
            done = self.run_it(*arguments)
            self.assertEqual((done.returncode, done.stderr), (1, complaint))

    def test_refuses_options_that_it_does_not_know(self):
        self.assertEqual(self.run_it("--colour").returncode, 2)


if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1])
