"""A small reference walk of FIX files against a schema, written apart from the validator.

It follows the validator's rules: one field map for the whole file, groups walked member
by member in schema order, the walk stops at the first tag the map lacks. It also checks
the framing that the validator leaves alone (BodyLength).
"""

import re
import xml.etree.ElementTree as ET

FIELD = re.compile(rb"([^=\x01]*)=([^\x01]*)\x01")


def _node(field, kind, members=None):
    return {"tag": field.findtext("Tag"), "kind": kind, "members": members,
            "required": field.findtext("Requirement") == "R", "value": field.findtext("Value")}


def _group(element):
    members = [_group(c) if c.tag == "Group" else _node(c, "F")
               for c in element.find("Sequence")]
    return _node(element.find("Field"), "G", members)


def load_schema(path):
    """Tag -> node for the top level of the schema's transactions."""
    top = {}
    for transaction in ET.parse(path).getroot().iter("Transaction"):
        for child in transaction:
            node = _group(child) if child.tag == "Group" else _node(child, "F")
            top[node["tag"]] = node
    return top


def check(data, schema):
    """The findings for data (bytes), in the validator's wording where it has one."""
    fields = [(m.group(1).decode(), m.group(2).decode(), m.start(), m.end())
              for m in FIELD.finditer(data)]
    findings, seen, pos = [], set(), 0
    if sum(end - at for _, _, at, end in fields) != len(data):
        findings.append("Bytes outside any tag=value field")
    start = body = 0

    def read(node):
        nonlocal pos
        tag, value = fields[pos][:2]
        pos += 1
        if node["value"] and value not in node["value"].split("|"):
            findings.append(f"Field {tag} failed to match specified value")
        if node["kind"] == "G":
            count = int(value) if value.isdigit() else 0
            for _ in range(count):
                for member in node["members"]:
                    if pos < len(fields) and fields[pos][0] == member["tag"]:
                        read(member)
                    elif member["required"]:
                        findings.append(f"Field {member['tag']} is missing")

    while pos < len(fields):
        tag, value, at, end = fields[pos]
        if tag not in schema:
            findings.append(f"Failed to match tag={tag} in schema file")
            return findings
        seen.add(tag)
        if tag == "8":
            start = at
        elif tag == "9":
            body = end
        elif tag == "10":
            if len(value) != 3:
                findings.append("The Checksum length is incorrect")
            if not value.isdigit() or int(value) != sum(data[start:at]) % 256:
                findings.append("The Checksum is incorrect")
            length = data[start:at].split(b"\x01", 2)[1]
            if length != b"9=%d" % (at - body):
                findings.append(f"BodyLength {length.decode()} is wrong")
        read(schema[tag])
    findings += [f"Field {t} is missing" for t, n in sorted(schema.items())
                 if n["required"] and t not in seen]
    return findings
