#!/usr/bin/env python3
"""Write a deterministic corpus of FIX 4.4 messages for the benchmarks.

    python3 bench/gen_corpus.py --size 209715200 --seed 1 -o corpus.fix

The mix follows a small order book: NewOrderSingle (35=D) with 1 to 3 parties, the
ExecutionReports (35=8) that acknowledge, fill and cancel those orders,
OrderCancelRequests (35=F) and the odd Heartbeat (35=0). Every field is one that
schemas/FIX44.xml defines at the top level, or a member of the Parties group in its
member order, and every value agrees with the schema's allowed values. BodyLength and
CheckSum are correct. Messages follow one another with no line break, since the
validator reads the whole file as one stream of fields.
"""

import argparse
import random
import sys
import time

SOH = "\x01"
BEGIN = "8=FIX.4.4" + SOH
DEFAULT_SIZE = 200 * 1024 * 1024
# 2026-12-06 10:15:30.123 UTC, in milliseconds.
START_MS = 1796552130123
SYMBOLS = ("ACME", "BOLT", "CRUX", "DYNA", "EMBR", "FLUX", "GRID", "HALO", "IRIS", "JADE")
ACCOUNTS = tuple(f"ACC{i:04d}" for i in range(1, 41))
# Party roles: executing firm, client, clearing firm, order origination trader,
# executing trader, entering trader.
ROLES = ("1", "3", "4", "11", "12", "36")
PARTY_SOURCES = ("D", "D", "D", "C", "B")
LIVE_LIMIT = 2000


def checksum(data):
    """The FIX CheckSum of a message's bytes up to and including the SOH before 10=."""
    return f"{sum(data) % 256:03d}"


def frame(msg_type, body, seq, sending_time, sender="KXBUY", target="KXSELL"):
    """A whole message around body, the SOH-terminated fields after the header."""
    text = (f"35={msg_type}{SOH}49={sender}{SOH}56={target}{SOH}34={seq}{SOH}"
            f"52={sending_time}{SOH}{body}")
    raw = f"{BEGIN}9={len(text)}{SOH}{text}".encode("ascii")
    return raw + f"10={checksum(raw)}{SOH}".encode("ascii")


def fields(pairs):
    """SOH-terminated tag=value text for (tag, value) pairs."""
    return "".join(f"{tag}={value}{SOH}" for tag, value in pairs)


class Order:
    __slots__ = ("clordid", "orderid", "side", "symbol", "qty", "price", "cum", "value", "acked")

    def __init__(self, clordid, orderid, side, symbol, qty, price):
        self.clordid = clordid
        self.orderid = orderid
        self.side = side
        self.symbol = symbol
        self.qty = qty
        self.price = price  # in cents; 0 for a market order
        self.cum = 0
        self.value = 0  # sum of fill quantity times price, in cents
        self.acked = False


class Corpus:
    """Messages of one session; the same seed gives the same messages."""

    def __init__(self, seed=1, sender="KXBUY", target="KXSELL"):
        self.rng = random.Random(seed)
        self.sender = sender
        self.target = target
        self.seq = 0
        self.clock = START_MS
        self.second = -1
        self.stamp = ""
        self.orders = 0
        self.execs = 0
        self.live = []

    def now(self):
        self.clock += self.rng.randrange(0, 40)
        second, ms = divmod(self.clock, 1000)
        if second != self.second:
            self.second = second
            self.stamp = time.strftime("%Y%m%d-%H:%M:%S", time.gmtime(second))
        return f"{self.stamp}.{ms:03d}"

    def message(self, msg_type, body):
        self.seq += 1
        sending_time = self.now()
        return frame(msg_type, body, self.seq, sending_time, self.sender, self.target)

    def parties(self, count=None):
        rng = self.rng
        count = count or rng.randint(1, 3)
        out = [("453", count)]
        for role in rng.sample(ROLES, count):
            out += [("448", f"P{rng.randrange(1, 500):03d}"), ("447", rng.choice(PARTY_SOURCES)),
                    ("452", role)]
        return out

    def new_order(self, parties=None):
        rng = self.rng
        self.orders += 1
        market = rng.random() < 0.2
        order = Order(f"C{self.orders:09d}", f"O{self.orders:09d}", rng.choice("12"),
                      rng.choice(SYMBOLS), rng.randrange(1, 100) * 100,
                      0 if market else rng.randrange(1000, 50000))
        pairs = [("11", order.clordid)] + self.parties(parties)
        pairs += [("1", rng.choice(ACCOUNTS)), ("21", "1"), ("55", order.symbol),
                  ("54", order.side), ("60", self.now()), ("38", order.qty)]
        if market:
            pairs += [("40", "1"), ("59", "3")]
        else:
            pairs += [("40", "2"), ("44", cents(order.price)), ("59", rng.choice("01"))]
        if len(self.live) >= LIVE_LIMIT:
            self.drop(rng.randrange(len(self.live)))
        self.live.append(order)
        return self.message("D", fields(pairs))

    def drop(self, index):
        self.live[index] = self.live[-1]
        self.live.pop()

    def execution(self, index, cancel=False, with_parties=False):
        """The next report on live order index: ack, fill, or cancel."""
        rng = self.rng
        order = self.live[index]
        self.execs += 1
        last_qty = last_px = 0
        if cancel:
            exec_type = status = "4"
            self.drop(index)
        elif not order.acked:
            order.acked = True
            exec_type = status = "0"
        else:
            left = order.qty - order.cum
            last_qty = left if rng.random() < 0.4 else rng.randrange(1, left // 100 + 1) * 100
            last_px = order.price or rng.randrange(1000, 50000)
            order.cum += last_qty
            order.value += last_qty * last_px
            exec_type = "F"
            status = "2" if order.cum == order.qty else "1"
            if status == "2":
                self.drop(index)
        pairs = [("37", order.orderid), ("11", order.clordid)]
        if with_parties:
            pairs += self.parties()
        pairs += [("17", f"E{self.execs:010d}"), ("150", exec_type), ("39", status),
                  ("55", order.symbol), ("54", order.side), ("38", order.qty)]
        if order.price:
            pairs.append(("44", cents(order.price)))
        if last_qty:
            pairs += [("32", last_qty), ("31", cents(last_px))]
        leaves = 0 if status in "24" else order.qty - order.cum
        avg = order.value // order.cum if order.cum else 0
        pairs += [("151", leaves), ("14", order.cum), ("6", cents(avg)), ("60", self.now())]
        return self.message("8", fields(pairs))

    def cancel_request(self, index):
        order = self.live[index]
        self.orders += 1
        pairs = [("41", order.clordid), ("37", order.orderid), ("11", f"C{self.orders:09d}"),
                 ("55", order.symbol), ("54", order.side), ("60", self.now()),
                 ("38", order.qty)]
        return self.message("F", fields(pairs))

    def heartbeat(self):
        return self.message("0", "")

    def next(self):
        rng = self.rng
        pick = rng.random()
        if pick < 0.03:
            return self.heartbeat()
        if pick < 0.4 or not self.live:
            return self.new_order()
        index = rng.randrange(len(self.live))
        if pick < 0.9:
            return self.execution(index, with_parties=rng.random() < 0.25)
        if pick < 0.95:
            return self.cancel_request(index)
        return self.execution(index, cancel=True)


def cents(value):
    return f"{value // 100}.{value % 100:02d}"


def generate(out, size=DEFAULT_SIZE, count=None, seed=1, chunk=1 << 22):
    """Writes messages to the binary stream out; returns (messages, bytes) written."""
    corpus = Corpus(seed)
    written = messages = pending = 0
    buffer = []
    while (messages < count) if count is not None else (written < size):
        msg = corpus.next()
        buffer.append(msg)
        messages += 1
        written += len(msg)
        pending += len(msg)
        if pending >= chunk:
            out.write(b"".join(buffer))
            buffer.clear()
            pending = 0
    out.write(b"".join(buffer))
    return messages, written


def main(argv=None):
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    amount = parser.add_mutually_exclusive_group()
    amount.add_argument("--size", type=int, default=DEFAULT_SIZE,
                        help="stop after the message that reaches BYTES (default 200 MiB)")
    amount.add_argument("--count", type=int, help="write N messages instead")
    parser.add_argument("--seed", type=int, default=1)
    parser.add_argument("-o", "--output", help="file to write (default: stdout)")
    args = parser.parse_args(argv)
    if args.output:
        with open(args.output, "wb") as out:
            generate(out, args.size, args.count, args.seed)
    else:
        generate(sys.stdout.buffer, args.size, args.count, args.seed)
        sys.stdout.buffer.flush()
    return 0


if __name__ == "__main__":
    sys.exit(main())
