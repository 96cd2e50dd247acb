#!/usr/bin/env python3
"""Convert a FIX data dictionary (XML) into a kxvfix schema specification.

    python3 tools/dict2schema.py tools/dictionaries/FIX44.xml -o schemas/FIX44.xml

The validator checks a whole file against one field map, so the dictionary's messages
are folded into a single Transaction:

* Top-level Fields: every field that stands outside any repeating group in the header,
  the trailer, a message or a component (components are flattened, so a component's
  direct fields count as top-level wherever the component is used). Each tag once.
* Groups: one definition per counter tag. The validator registers every group, nested
  or not, under its counter tag and the last one read wins, so the converter builds one
  definition per counter tag and writes that same definition wherever the group occurs:
  at the top level (if the group stands outside any group somewhere) and nested inside
  the Sequence of each group that contains it.
* Conflicting definitions: when a counter tag has different members in different
  places, the members are merged into an ordered union. The first occurrence (in the
  order header, trailer, messages, components, each in dictionary order) gives the
  order; a member missing from it is inserted right after the member that precedes it
  in its own occurrence (after the first member when nothing precedes it). So the first
  member is always that of the first occurrence. This works because the validator
  walks the members in order and passes over absent optional members in silence. A
  member listed twice in one group is kept once.
* Requirement: R for the fields that the header and trailer mark required (8, 9, 35,
  49, 56, 34, 52, 10 in the shipped dictionaries) and for the first member of each
  group, the delimiter of its repetitions; O otherwise. When the occurrences of a group
  do not agree on their first member (FIX 4.4 NoMDEntries starts with 269 in snapshots
  and with 279 in incremental refreshes), no member is R, as either start is right.
  A group counter is always O, also as the first member: the validator reports a
  required group as missing at the end of any file whose top level lacks its counter,
  nested groups included.
* A tag that counts a group anywhere is written only as that Group.
* Value: the field's enumerated values joined with "|", in dictionary order; left out
  when the field has none, or when a value is empty or holds "|" (the pattern could not
  express it; a warning goes to standard error). BeginString gets the dictionary's own
  version, e.g. FIX.4.4.
* Order: header fields in dictionary order, then the other fields by tag, then the
  top-level groups by counter tag. Header elements are fixed texts, so the same
  dictionary always gives the same bytes.
"""

import argparse
import sys
import xml.etree.ElementTree as ET
from xml.sax.saxutils import escape

CREATION_DATE = "2026-12-06"


class DictionaryError(Exception):
    pass


class Converter:
    def __init__(self, root):
        if root.tag != "fix":
            raise DictionaryError(f"root element is <{root.tag}>, not <fix>")
        self.root = root
        self.fields = {}  # name -> (tag, type, enum values)
        for f in root.iterfind("fields/field"):
            try:
                tag = int(f.get("number", ""))
            except ValueError:
                raise DictionaryError(f"field {f.get('name')!r} has no numeric number")
            values = [v.get("enum", "") for v in f.iterfind("value")]
            self.fields[f.get("name")] = (tag, f.get("type", ""), values)
        self.names = {tag: name for name, (tag, _, _) in self.fields.items()}
        self.components = {c.get("name"): c for c in root.iterfind("components/component")}
        self.header_tags = []  # direct header fields, dictionary order
        self.required = set()
        self.top_fields = set()
        self.top_groups = set()
        self.groups = {}  # counter tag -> ordered members: ("F", tag) or ("G", counter)
        self.delimiters = {}  # counter tag -> first members seen across occurrences
        self._collect()

    def tag_of(self, name):
        if name not in self.fields:
            raise DictionaryError(f"unknown field {name!r}")
        return self.fields[name][0]

    def flatten(self, element, components=()):
        """The field and group elements of element, components expanded in place."""
        for child in element:
            if child.tag in ("field", "group"):
                yield child
            elif child.tag == "component":
                name = child.get("name")
                if name in components:
                    raise DictionaryError(f"component {name!r} contains itself")
                if name not in self.components:
                    raise DictionaryError(f"unknown component {name!r}")
                yield from self.flatten(self.components[name], components + (name,))

    def add_group(self, element, open_groups):
        counter = self.tag_of(element.get("name"))
        if counter in open_groups:
            raise DictionaryError(f"group {element.get('name')!r} contains itself")
        members = []
        for child in self.flatten(element):
            if child.tag == "group":
                member = ("G", self.add_group(child, open_groups + (counter,)))
            else:
                member = ("F", self.tag_of(child.get("name")))
            if member not in members:
                members.append(member)
        if members:
            self.delimiters.setdefault(counter, set()).add(members[0])
        if counter in self.groups:
            merge(self.groups[counter], members)
        else:
            self.groups[counter] = members
        return counter

    def add_top(self, element, section=None):
        for child in self.flatten(element):
            if child.tag == "group":
                self.top_groups.add(self.add_group(child, ()))
                continue
            tag = self.tag_of(child.get("name"))
            self.top_fields.add(tag)
            if section is None:
                continue
            if section == "header" and tag not in self.header_tags:
                self.header_tags.append(tag)
            if child.get("required") == "Y":
                self.required.add(tag)

    def _collect(self):
        for section in ("header", "trailer"):
            for element in self.root.iterfind(section):
                self.add_top(element, section)
        for element in self.root.iterfind("messages/message"):
            self.add_top(element)
        for element in self.components.values():
            self.add_top(element)
        # A tag that counts a group is read as that group; a plain Field would be dead.
        for counter in self.groups:
            if counter in self.top_fields:
                self.top_fields.discard(counter)
                self.top_groups.add(counter)
        self.header_tags = [t for t in self.header_tags if t in self.top_fields]

    def version(self):
        r = self.root
        return f"{r.get('major', '')}.{r.get('minor', '')}"

    def field_xml(self, tag, requirement):
        name = self.names[tag]
        _, ftype, values = self.fields[name]
        parts = [
            f"<Tag>{tag}</Tag>",
            f"<Name>{escape(name)}</Name>",
            f"<Format>{escape(ftype)}</Format>",
            f"<Requirement>{requirement}</Requirement>",
        ]
        if tag == 8 and not values:
            values = [f"{self.root.get('type', 'FIX')}.{self.version()}"]
        if any(v == "" or "|" in v for v in values):
            print(f"dict2schema: warning: {name} has a value that no pattern can express;"
                  " its values are not checked", file=sys.stderr)
            values = []
        seen = []
        for v in values:
            if v not in seen:
                seen.append(v)
        if seen:
            parts.append(f"<Value>{escape('|'.join(seen))}</Value>")
        return "<Field>" + "".join(parts) + "</Field>"

    def group_xml(self, counter, indent, out, open_groups=()):
        if counter in open_groups:
            raise DictionaryError(f"group {self.names[counter]!r} contains itself")
        pad = "  " * indent
        out.append(f"{pad}<Group>")
        out.append(f"{pad}  {self.field_xml(counter, 'O')}")
        out.append(f"{pad}  <Sequence>")
        agreed = len(self.delimiters.get(counter, ())) == 1
        for i, (kind, tag) in enumerate(self.groups[counter]):
            if kind == "G":
                self.group_xml(tag, indent + 2, out, open_groups + (counter,))
            else:
                required = i == 0 and agreed
                out.append(f"{pad}    {self.field_xml(tag, 'R' if required else 'O')}")
        out.append(f"{pad}  </Sequence>")
        out.append(f"{pad}</Group>")

    def schema(self):
        r = self.root
        title = f"{r.get('type', 'FIX')} {self.version()}"
        if r.get("servicepack", "0") not in ("", "0"):
            title += f" SP{r.get('servicepack')}"
        out = ['<?xml version="1.0" encoding="UTF-8"?>', "<Specification>"]
        for element, text in (
            ("Title", title),
            ("Subject", f"{title} messages, all in one transaction"),
            ("AuthorName", "dict2schema"),
            ("Version", "1"),
            ("CreationDate", CREATION_DATE),
            ("LastModified", CREATION_DATE),
            ("IndustryType", "Finance"),
            ("Standard", r.get("type", "FIX")),
            ("StdVersion", self.version()),
        ):
            out.append(f"  <{element}>{escape(text)}</{element}>")
        out.append("  <Transaction>")
        others = sorted(self.top_fields - set(self.header_tags))
        for tag in self.header_tags + others:
            out.append("    " + self.field_xml(tag, "R" if tag in self.required else "O"))
        for counter in sorted(self.top_groups):
            self.group_xml(counter, 2, out)
        out.append("  </Transaction>")
        out.append("</Specification>")
        return "\n".join(out) + "\n"


def merge(merged, members):
    """Adds to merged the members it lacks, each after its predecessor in members."""
    at = None
    for member in members:
        if member in merged:
            at = merged.index(member)
        else:
            at = min(1, len(merged)) if at is None else at + 1
            merged.insert(at, member)


def convert(source):
    """The schema text for a dictionary given as a path, file object or XML text."""
    if isinstance(source, str) and source.lstrip().startswith("<"):
        root = ET.fromstring(source)
    else:
        root = ET.parse(source).getroot()
    return Converter(root).schema()


def main(argv=None):
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("dictionary", help="data dictionary XML file")
    parser.add_argument("-o", "--output", help="schema file to write (default: stdout)")
    args = parser.parse_args(argv)
    try:
        text = convert(args.dictionary)
    except (OSError, ET.ParseError, DictionaryError) as e:
        print(f"dict2schema: {args.dictionary}: {e}", file=sys.stderr)
        return 1
    if args.output:
        with open(args.output, "w", encoding="utf-8", newline="\n") as f:
            f.write(text)
    else:
        sys.stdout.write(text)
    return 0


if __name__ == "__main__":
    sys.exit(main())
