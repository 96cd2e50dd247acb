"""End-to-end tests of kxvalidate on real files, through the real program and plug-in."""

import io
import json
import os
import re
import shlex
import subprocess
import sys
import tempfile
import unittest

ROOT = os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "..")
sys.path.insert(0, os.path.join(ROOT, "bench"))
import gen_corpus  # noqa: E402

KXVALIDATE = os.environ.get("KXVALIDATE", "kxvalidate")
# What runs the program, if it does not run by itself: "wine" for a Windows build.
RUNNER = shlex.split(os.environ.get("KXVALIDATE_RUNNER", ""))
# What the program writes in: UTF-8, or the ANSI code page of a Windows build.
ENCODING = os.environ.get("KXVALIDATE_ENCODING", "utf-8")
# A Windows program run from here (under wine) sees this file system as drive Z:.
WINDOWS = KXVALIDATE.lower().endswith(".exe") and os.name == "posix"
NULL_DEVICE = "NUL" if WINDOWS else os.devnull
SOH = "\x01"

SCHEMA = """<?xml version="1.0"?>
<Specification>
  <Title>test</Title>
  <Transaction>
    <Field><Tag>8</Tag><Requirement>R</Requirement><Value>FIX.4.2|FIX.4.4</Value></Field>
    <Field><Tag>9</Tag><Requirement>R</Requirement></Field>
    <Field><Tag>35</Tag><Requirement>R</Requirement><Value>D|F</Value></Field>
    <Field><Tag>11</Tag><Requirement>R</Requirement></Field>
    <Field><Tag>10</Tag><Requirement>R</Requirement></Field>
    <Group>
      <Field><Tag>78</Tag><Requirement>O</Requirement></Field>
      <Sequence>
        <Field><Tag>79</Tag><Requirement>R</Requirement></Field>
        <Field><Tag>80</Tag><Requirement>O</Requirement></Field>
      </Sequence>
    </Group>
  </Transaction>
</Specification>
"""


def program_path(path):
    """The name the program under test gives the file at path."""
    return "Z:" + path.replace("/", "\\") if WINDOWS else path


def message(*fields):
    """A message of tag=value pairs with correct BodyLength and CheckSum."""
    body = "".join(f"{t}={v}{SOH}" for t, v in fields)
    head = f"8=FIX.4.4{SOH}9={len(body.encode())}{SOH}"
    total = sum((head + body).encode()) % 256
    return f"{head}{body}10={total:03d}{SOH}"


ORDER = message(("35", "D"), ("11", "ABC"), ("78", "2"), ("79", "X"), ("80", "Y"), ("79", "Z"))


class KxvalidateTest(unittest.TestCase):
    def setUp(self):
        self.dir = tempfile.TemporaryDirectory()
        self.schema = self.write("schema.xml", SCHEMA)

    def tearDown(self):
        self.dir.cleanup()

    def local(self, name):
        return os.path.join(self.dir.name, name)

    def write(self, name, content):
        """Writes the file and answers its name for the program."""
        with open(self.local(name), "wb") as f:
            f.write(content.encode() if isinstance(content, str) else content)
        return program_path(self.local(name))

    def run_cli(self, *args, schema=True):
        cmd = RUNNER + [KXVALIDATE] + (["-s", self.schema] if schema else []) + list(args)
        return subprocess.run(cmd, capture_output=True, encoding=ENCODING, timeout=60)

    def json_lines(self, *args, schema=True):
        done = self.run_cli("--format", "json", *args, schema=schema)
        return done, [json.loads(line) for line in done.stdout.splitlines()]

    def test_clean_message_after_a_blank_line(self):
        done = self.run_cli(self.write("clean.fix", "\n" + ORDER))
        self.assertEqual(done.returncode, 0, done.stdout + done.stderr)
        self.assertEqual(done.stdout, "kxvalidate: 1 file, 0 findings, 0 not validated\n")

    def test_set_up_failures(self):
        source = self.write("order.fix", ORDER)
        bad_schema = self.write("bad.xml", "<Specification><Field>")
        not_fix = self.write("nine.fix", "9=5" + SOH + ORDER)
        comments = self.write("comments.fix", "; nothing\n\n")
        missing = program_path(self.local("missing.fix"))
        cases = [
            (["-o", "SchemaFile=", source], "?", "No schema specs file is found!"),
            (["-s", bad_schema, source], bad_schema, "Not a valid schema spec file!"),
            ([missing], missing, "Unable to open source file!"),
            ([not_fix], not_fix, "Source file is not a FIX file!"),
            ([comments], comments, "Source file is not a FIX file!"),
        ]
        for args, file, text in cases:
            with self.subTest(text=text, args=args):
                done = self.run_cli(*args)
                self.assertEqual(done.returncode, 2)
                self.assertEqual(done.stdout.splitlines()[0], f"{file}: error: {text}")
                self.assertIn("1 not validated", done.stdout)

    def test_schema_diagnostics_go_to_standard_error(self):
        bad_schema = self.write("bad.xml", "<Specification>\n<Field></Specification>")
        done = self.run_cli("-s", bad_schema, self.write("o.fix", ORDER))
        self.assertRegex(done.stderr, r"Browser: Fatal: At line 2, column \d+ of file .*bad\.xml: ")
        self.assertNotIn("Browser", done.stdout)

    def test_utf16_in_both_byte_orders(self):
        for name, data in [
            ("lsb", b"\xff\xfe" + ORDER.encode("utf-16-le")),
            ("msb", b"\xfe\xff" + ORDER.encode("utf-16-be")),
        ]:
            with self.subTest(name):
                done = self.run_cli("-u", self.write(name + ".fix", data))
                self.assertEqual(done.returncode, 0, done.stdout)

    def test_structural_stop_and_escaped_line_break(self):
        source = self.write("two.fix", ORDER + "\r\n" + ORDER)
        done = self.run_cli(source)
        self.assertEqual(done.returncode, 1)
        lines = done.stdout.splitlines()
        self.assertEqual(lines[0], f"{source}: error: Failed to match tag=\\r\\n8 in schema file")
        self.assertTrue(lines[1].startswith(f"{source}: note: messages must follow one another"))
        done, objects = self.json_lines(source)
        self.assertEqual(objects[0]["message"], "Failed to match tag=\r\n8 in schema file")
        self.assertEqual(objects[0]["result"], 4)
        self.assertEqual(objects[0]["kind"], 3)
        self.assertIn("note", objects[0])
        self.assertEqual(objects[-1], {"summary": {"files": 1, "findings": 1, "not_validated": 0}})

    def test_json_findings_in_order(self):
        wrong = ORDER.replace("35=D", "35=X").replace(f"{SOH}79=Z", f"{SOH}80=W")
        source = self.write("wrong.fix", wrong)
        done, objects = self.json_lines(source)
        self.assertEqual(done.returncode, 1)
        messages = [(o["kind"], o["kind_name"], o["message"]) for o in objects[:-1]]
        self.assertEqual(messages, [
            (2, "field error", "Field 35 failed to match specified value"),
            (2, "field error", "Field 79 is missing"),
            (3, "error", "The Checksum is incorrect"),
        ])
        self.assertTrue(all(o["source"] == source and o["result"] == 0 for o in objects[:-1]))

    def test_control_characters_and_non_ascii_stay_valid(self):
        # 8-bit source: the byte E9 reads as U+00E9 and is printed as UTF-8.
        source = self.write("odd.fix", ORDER.encode() + b"\t\x7f\xe9\x02=1\x01")
        done, objects = self.json_lines(source)
        self.assertEqual(objects[0]["message"], "Failed to match tag=\t\x7f\u00e9\x02 in schema file")
        text = self.run_cli(source).stdout
        self.assertIn("tag=\\t\\x7f\u00e9\\x02 in", text)

    def test_several_files_and_jobs(self):
        good = self.write("good.fix", ORDER)
        bad = self.write("bad.fix", ORDER.replace("35=D", "35=Q"))
        missing = program_path(self.local("none.fix"))
        files = [good, missing, bad, good]
        one = self.run_cli(*files)
        self.assertEqual(one.returncode, 2)
        self.assertTrue(one.stdout.endswith("4 files, 3 findings, 1 not validated\n"))
        many = self.run_cli("-j", "3", *files)
        self.assertEqual(many.stdout, one.stdout)

    def test_usage_errors(self):
        source = self.write("o.fix", ORDER)
        for args in (["-o", "NoSuchOption=1", source], ["--format", "xml", source], [],
                     ["--bogus", source], ["-j", "0", source]):
            with self.subTest(args=args):
                done = self.run_cli(*args)
                self.assertEqual(done.returncode, 2)
                self.assertIn("usage:", done.stderr)

    def test_options_by_name(self):
        data = b"\xff\xfe" + ORDER.encode("utf-16-le")
        done = self.run_cli("-o", "Unicode=True", "-o", "schemafile=" + self.schema,
                            self.write("u.fix", data), schema=False)
        self.assertEqual(done.returncode, 0, done.stdout)

    def test_examples_with_the_bundled_schema(self):
        examples = os.path.normpath(os.path.join(ROOT, "examples"))
        clean = [program_path(os.path.join(examples, n)) for n in ("orders.fix", "executions.fix")]
        self.assertEqual(self.run_cli(*clean, schema=False).returncode, 0)
        faults = program_path(os.path.join(examples, "faults.fix"))
        done, objects = self.json_lines(faults, schema=False)
        self.assertEqual([o.get("message") for o in objects[:-1]], [
            "Field 54 failed to match specified value", "The Checksum is incorrect",
            "The Checksum length is incorrect", "The Checksum is incorrect",
            "Field 448 is missing", "Failed to match tag=9999 in schema file"])

    def test_long_corpus_across_many_buffers(self):
        # Fields straddle every buffer boundary; each Side edited to Z must be reported.
        out = io.BytesIO()
        gen_corpus.generate(out, size=600_000, seed=7)
        clean = out.getvalue()
        faulty, edits = re.subn(rb"\x0154=1\x01", b"\x0154=Z\x01", clean)
        self.assertGreater(edits, 100)
        side = ["Field 54 failed to match specified value"]
        for name, data, unicode, expected in [
            ("clean", clean, False, []),
            ("faulty", faulty, False, side * edits),
            ("utf16", b"\xff\xfe" + faulty.decode("latin-1").encode("utf-16-le"), True,
             side * edits),
        ]:
            with self.subTest(name):
                done, objects = self.json_lines(
                    *(["-u"] if unicode else []), self.write(name + ".fix", data), schema=False)
                found = [o["message"] for o in objects[:-1]]
                # An edited Side also breaks its message's CheckSum.
                self.assertEqual([m for m in found if "Checksum" not in m], expected)

    def test_hostile_sources_and_schemas(self):
        # Each gets a clear answer, in bounded time and memory; none may crash the program.
        gib = self.write("gib.fix", "8")
        os.truncate(self.local("gib.fix"), 1 << 30)  # sparse: a 1 GiB tag without "=" after "8"
        endless = self.write("endless.fix", "8=")
        os.truncate(self.local("endless.fix"), 16 << 20)  # a BeginString without its separator
        # Not nul.fix: Windows opens any "nul.*" as its null device.
        nuls = self.write("nuls.fix", ORDER.replace("11=ABC", "11=A\x00C"))
        cut = self.write("cut.fix", ORDER[:-3])  # inside the CheckSum value
        odd = self.write("odd.fix", b"\xff\xfe" + ORDER.encode("utf-16-le") + b"8")
        folder = program_path(self.dir.name)
        cases = [  # arguments, exit status, first line of the output
            ([folder], 2, f"{folder}: error: Unable to open source file!"),
            ([NULL_DEVICE], 2, f"{NULL_DEVICE}: error: Source file is not a FIX file!"),
            (["-s", folder, cut], 2, f"{folder}: error: Not a valid schema spec file!"),
            (["-s", NULL_DEVICE, cut], 2, f"{NULL_DEVICE}: error: Not a valid schema spec file!"),
            ([gib], 1, f"{gib}: error: Failed to find BeginString"),
            ([endless], 1, f"{endless}: field error: Field 8 failed to match specified value"),
            ([nuls], 1, f"{nuls}: error: The Checksum is incorrect"),
            ([cut], 1, f"{cut}: error: The Checksum length is incorrect"),
            (["-u", odd], 0, "kxvalidate: 1 file, 0 findings, 0 not validated"),
        ]
        for args, status, first in cases:
            with self.subTest(args=args):
                done = self.run_cli(*args)
                self.assertEqual((done.returncode, done.stdout.splitlines()[0]), (status, first))

    @unittest.skipIf(os.geteuid() == 0, "the superuser reads files without read permission")
    def test_unreadable_source_and_schema(self):
        source = self.write("locked.fix", ORDER)
        os.chmod(self.local("locked.fix"), 0)
        os.chmod(self.local("schema.xml"), 0)
        self.assertEqual(self.run_cli(source).stdout.splitlines()[0],
                         f"{self.schema}: error: Not a valid schema spec file!")
        os.chmod(self.local("schema.xml"), 0o644)
        self.assertEqual(self.run_cli(source).stdout.splitlines()[0],
                         f"{source}: error: Unable to open source file!")

    def test_entity_expansion_is_bounded(self):
        entities = '<!ENTITY a0 "lol">' + "".join(
            f'<!ENTITY a{i} "{f"&a{i - 1};" * 10}">' for i in range(1, 10))
        laughs = self.write("laughs.xml", f"<!DOCTYPE S [{entities}]><S><Transaction><Field>"
                            "<Tag>8</Tag><Value>&a9;</Value></Field></Transaction></S>")
        done = self.run_cli("-s", laughs, self.write("o.fix", ORDER), schema=False)
        self.assertEqual(done.returncode, 2)
        self.assertIn("entity expansions", done.stderr)
        self.assertEqual(done.stdout.splitlines()[0], f"{laughs}: error: Not a valid schema spec file!")


if __name__ == "__main__":
    unittest.main()
