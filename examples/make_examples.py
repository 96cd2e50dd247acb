#!/usr/bin/env python3
"""Rewrite the example files from the corpus generator: python3 examples/make_examples.py"""

import os
import re
import sys

HERE = os.path.dirname(os.path.abspath(__file__))
sys.path.insert(0, os.path.join(HERE, "..", "bench"))

import gen_corpus  # noqa: E402


def orders():
    corpus = gen_corpus.Corpus(seed=44)
    out = [corpus.new_order() for _ in range(5)]
    out += [corpus.cancel_request(1), corpus.new_order(), corpus.cancel_request(3)]
    return out


def executions():
    corpus = gen_corpus.Corpus(seed=8)
    out = []
    for parties in (1, 2, 3):
        out.append(corpus.new_order(parties))
        order = len(corpus.live) - 1
        out.append(corpus.execution(order, with_parties=True))  # acknowledged
        out.append(corpus.execution(order))  # filled, at least in part
    out.append(corpus.heartbeat())
    out.append(corpus.cancel_request(0))
    out.append(corpus.execution(0, cancel=True))
    return out


def faults():
    """One fault per message, each in known tags, so a validator walks to the end."""
    corpus = gen_corpus.Corpus(seed=10)
    out = [corpus.new_order(2)]
    # Side Z is not among the allowed values.
    out.append(reframe(re.sub(rb"\x0154=[12]\x01", b"\x0154=Z\x01", corpus.new_order(1))))
    # CheckSum off by one.
    msg = corpus.heartbeat()
    good = int(msg[-4:-1])
    out.append(msg[:-4] + f"{(good + 1) % 256:03d}\x01".encode())
    # CheckSum of two digits.
    msg = corpus.execution(0)
    out.append(msg[: msg.rindex(b"\x0110=") + 4] + b"17\x01")
    # The second party lacks its PartyID, the required first member of the group.
    msg = corpus.new_order(2)
    start = msg.index(b"\x01448=", msg.index(b"\x01448=") + 1)
    out.append(reframe(msg[:start] + msg[msg.index(b"\x01", start + 1):]))
    # Last, as it stops the walk: a tag the schema does not define.
    msg = corpus.heartbeat()
    out.append(reframe(msg[: msg.rindex(b"\x0110=") + 1] + b"9999=X\x01"))
    return out


def reframe(msg):
    """msg with its BodyLength and CheckSum made right again for its edited body."""
    body_start = msg.index(b"\x01", msg.index(b"\x019=") + 1) + 1
    end = msg.rindex(b"\x0110=") + 1 if b"\x0110=" in msg else len(msg)
    body = msg[body_start:end]
    raw = b"8=FIX.4.4\x019=" + str(len(body)).encode() + b"\x01" + body
    return raw + b"10=" + gen_corpus.checksum(raw).encode() + b"\x01"


def main():
    for name, make in (("orders", orders), ("executions", executions), ("faults", faults)):
        with open(os.path.join(HERE, name + ".fix"), "wb") as f:
            f.write(b"".join(make()))


if __name__ == "__main__":
    main()
