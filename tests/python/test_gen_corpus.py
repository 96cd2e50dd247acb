import io
import os
import re
import sys
import unittest

import fixref

ROOT = os.path.dirname(os.path.dirname(os.path.dirname(os.path.abspath(__file__))))
sys.path.insert(0, os.path.join(ROOT, "bench"))
sys.path.insert(0, os.path.join(ROOT, "examples"))

import gen_corpus  # noqa: E402
import make_examples  # noqa: E402

SCHEMA = fixref.load_schema(os.path.join(ROOT, "schemas", "FIX44.xml"))


def corpus(**options):
    out = io.BytesIO()
    gen_corpus.generate(out, **options)
    return out.getvalue()


class GeneratorTest(unittest.TestCase):
    def test_corpus_validates_clean_against_the_shipped_schema(self):
        data = corpus(count=3000, seed=7)
        self.assertEqual(fixref.check(data, SCHEMA), [])
        self.assertNotIn(b"\n", data)
        types = re.findall(rb"\x0135=(\w+)\x01", data)
        self.assertEqual(set(types), {b"D", b"8", b"F", b"0"})
        counts = set(re.findall(rb"\x01453=(\d+)\x01", data))
        self.assertEqual(counts, {b"1", b"2", b"3"})
        seqs = [int(s) for s in re.findall(rb"\x0134=(\d+)\x01", data)]
        self.assertEqual(seqs, list(range(1, 3001)))
        stamps = re.findall(rb"\x0152=([^\x01]*)\x01", data)
        self.assertTrue(all(re.fullmatch(rb"\d{8}-\d\d:\d\d:\d\d\.\d{3}", s) for s in stamps))

    def test_reference_walk_sees_faults(self):
        good = gen_corpus.frame("D", "11=A\x0154=1\x01", 1, "20261206-10:15:30.123")
        cases = [  # edit of a clean message, finding expected
            (lambda m: m.replace(b"54=1", b"54=Z"), "Field 54 failed to match specified value"),
            (lambda m: m.replace(b"11=A", b"11=B"), "The Checksum is incorrect"),
            (lambda m: m.replace(b"\x019=", b"\x019=1"), "BodyLength 9=1"),
            (lambda m: m.replace(b"11=A", b"448=A"), "Failed to match tag=448 in schema file"),
            (lambda m: m.replace(b"\x0134=1", b""), "Field 34 is missing"),
        ]
        for edit, finding in cases:
            with self.subTest(finding):
                self.assertTrue(any(f.startswith(finding)
                                    for f in fixref.check(edit(good), SCHEMA)))

    def test_same_seed_same_bytes(self):
        self.assertEqual(corpus(count=500, seed=3), corpus(count=500, seed=3))
        self.assertNotEqual(corpus(count=500, seed=3), corpus(count=500, seed=4))

    def test_size_stops_after_the_message_that_reaches_it(self):
        data = corpus(size=100000, seed=5, chunk=1000)
        last = data.rindex(b"8=FIX.4.4\x01")
        self.assertGreaterEqual(len(data), 100000)
        self.assertLess(last, 100000)
        self.assertEqual(data, corpus(size=100000, seed=5))


class ExamplesTest(unittest.TestCase):
    def test_examples_are_reproducible_and_check_as_documented(self):
        expected = {
            "orders": [],
            "executions": [],
            "faults": ["Field 54 failed to match specified value", "The Checksum is incorrect",
                       "The Checksum length is incorrect", "The Checksum is incorrect",
                       "Field 448 is missing", "Failed to match tag=9999 in schema file"],
        }
        for name, findings in expected.items():
            with self.subTest(name):
                with open(os.path.join(ROOT, "examples", name + ".fix"), "rb") as f:
                    data = f.read()
                self.assertEqual(data, b"".join(getattr(make_examples, name)()))
                self.assertTrue(data.startswith(b"8=FIX.4.4\x019="))
                self.assertEqual(fixref.check(data, SCHEMA), findings)


if __name__ == "__main__":
    unittest.main()
