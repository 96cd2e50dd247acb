import io
import os
import re
import sys
import unittest

ROOT = os.path.dirname(os.path.dirname(os.path.dirname(os.path.abspath(__file__))))
sys.path.insert(0, os.path.join(ROOT, "bench"))
sys.path.insert(0, os.path.join(ROOT, "examples"))

import gen_corpus  # noqa: E402
import make_examples  # noqa: E402

MESSAGE = re.compile(rb"8=FIX\.4\.4\x019=(\d+)\x01(.*?)10=(\d{3})\x01", re.S)


def corpus(**options):
    out = io.BytesIO()
    gen_corpus.generate(out, **options)
    return out.getvalue()


class GeneratorTest(unittest.TestCase):
    def test_messages_are_framed_and_follow_one_another(self):
        data = corpus(count=3000, seed=7)
        messages = list(MESSAGE.finditer(data))
        self.assertEqual(b"".join(m.group(0) for m in messages), data)  # nothing between
        for m in messages:
            self.assertEqual(int(m.group(1)), len(m.group(2)))
            self.assertEqual(int(m.group(3)), sum(data[m.start():m.start(3) - 3]) % 256)
        self.assertEqual(set(re.findall(rb"\x0135=(\w+)\x01", data)), {b"D", b"8", b"F", b"0"})
        self.assertEqual(set(re.findall(rb"\x01453=(\d+)\x01", data)), {b"1", b"2", b"3"})
        seqs = [int(s) for s in re.findall(rb"\x0134=(\d+)\x01", data)]
        self.assertEqual(seqs, list(range(1, 3001)))

    def test_same_seed_same_bytes_and_size_stops_after_the_message_reaching_it(self):
        self.assertEqual(corpus(count=500, seed=3), corpus(count=500, seed=3))
        self.assertNotEqual(corpus(count=500, seed=3), corpus(count=500, seed=4))
        data = corpus(size=100000, seed=5, chunk=1000)
        self.assertGreaterEqual(len(data), 100000)
        self.assertLess(data.rindex(b"8=FIX.4.4\x01"), 100000)
        self.assertEqual(data, corpus(size=100000, seed=5))

    def test_examples_are_what_their_script_makes(self):
        # What each example draws from the validator is checked end to end.
        for name in ("orders", "executions", "faults"):
            with self.subTest(name), open(os.path.join(ROOT, "examples", name + ".fix"), "rb") as f:
                self.assertEqual(f.read(), b"".join(getattr(make_examples, name)()))


if __name__ == "__main__":
    unittest.main()
