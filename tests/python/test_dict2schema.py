import contextlib
import io
import os
import sys
import unittest
import xml.etree.ElementTree as ET

ROOT = os.path.dirname(os.path.dirname(os.path.dirname(os.path.abspath(__file__))))
sys.path.insert(0, os.path.join(ROOT, "tools"))

import dict2schema  # noqa: E402

FIELDS = """<fields>
 <field number='8' name='BeginString' type='STRING'/>
 <field number='9' name='BodyLength' type='LENGTH'/>
 <field number='35' name='MsgType' type='STRING'><value enum='D'/><value enum='8'/></field>
 <field number='10' name='CheckSum' type='STRING'/>
 <field number='49' name='Sender' type='STRING'/>
 <field number='1' name='A' type='STRING'/>
 <field number='2' name='B' type='STRING'/>
 <field number='3' name='C' type='STRING'/>
 <field number='4' name='D' type='STRING'/>
 <field number='5' name='E' type='STRING'/>
 <field number='6' name='Odd' type='CHAR'><value enum='a&amp;b'/><value enum='&lt;'/><value enum='a&amp;b'/></field>
 <field number='7' name='Piped' type='CHAR'><value enum='x|y'/></field>
 <field number='70' name='NoX' type='NUMINGROUP'/>
 <field number='71' name='NoY' type='NUMINGROUP'/>
</fields>"""


def dictionary(messages, components="", header="", trailer=""):
    return (f"<fix type='FIX' major='4' minor='4'><header>{header}</header>"
            f"<messages>{messages}</messages><trailer>{trailer}</trailer>"
            f"<components>{components}</components>{FIELDS}</fix>")


def shape(text):
    """The Transaction as nested tuples: (tag, requirement, value) or (tag, req, [members])."""
    def node(e):
        if e.tag == "Group":
            f = e.find("Field")
            return (f.findtext("Tag"), f.findtext("Requirement"),
                    [node(c) for c in e.find("Sequence")])
        return (e.findtext("Tag"), e.findtext("Requirement"), e.findtext("Value"))
    return [node(c) for c in ET.fromstring(text).find("Transaction")]


def msg(body, name="M"):
    return f"<message name='{name}' msgtype='D'>{body}</message>"


class ConverterTest(unittest.TestCase):
    def test_shipped_schemas_are_what_the_converter_makes(self):
        for version in ("FIX42", "FIX44"):
            with self.subTest(version):
                source = os.path.join(ROOT, "tools", "dictionaries", version + ".xml")
                with open(os.path.join(ROOT, "schemas", version + ".xml"), encoding="utf-8") as f:
                    self.assertEqual(dict2schema.convert(source), f.read())

    def test_shipped_schema_defines_each_top_level_tag_once(self):
        tags = [n[0] for n in shape(dict2schema.convert(
            os.path.join(ROOT, "tools", "dictionaries", "FIX44.xml")))]
        self.assertEqual(len(tags), len(set(tags)))

    def test_shapes(self):
        g = "<group name='NoX' required='N'>{}</group>"
        f = "<field name='{}' required='Y'/>"
        cases = [
            ("components flattened, nested ones too",
             dictionary(msg("<component name='P'/>"),
                        "<component name='P'><field name='B'/><component name='Q'/></component>"
                        "<component name='Q'><field name='A'/></component>"),
             [("1", "O", None), ("2", "O", None)]),
            ("group inside a group, members from a component",
             dictionary(msg(g.format("<field name='A'/><group name='NoY'><component name='P'/>"
                                     "</group>")),
                        "<component name='P'><field name='C'/><field name='D'/></component>"),
             [("3", "O", None), ("4", "O", None),
              ("70", "O", [("1", "R", None), ("71", "O", [("3", "R", None), ("4", "O", None)])])]),
            ("conflicting members merge after their predecessor",
             dictionary(msg(g.format("<field name='A'/><field name='B'/>"), "M1")
                        + msg(g.format("<field name='A'/><field name='C'/><field name='B'/>"
                                       "<field name='D'/>"), "M2")),
             [("70", "O", [("1", "R", None), ("3", "O", None), ("2", "O", None),
                           ("4", "O", None)])]),
            ("disagreeing delimiters leave no member required",
             dictionary(msg(g.format("<field name='A'/><field name='B'/>"), "M1")
                        + msg(g.format("<field name='E'/><field name='B'/>"), "M2")),
             [("70", "O", [("1", "O", None), ("5", "O", None), ("2", "O", None)])]),
            ("header R rule and order: header, other tags by number, groups",
             dictionary(msg(f.format("E") + f.format("A") + g.format("<field name='B'/>")),
                        header=f.format("BeginString") + f.format("MsgType")
                        + "<field name='Sender' required='N'/>",
                        trailer=f.format("CheckSum")),
             [("8", "R", "FIX.4.4"), ("35", "R", "D|8"), ("49", "O", None), ("1", "O", None),
              ("5", "O", None), ("10", "R", None), ("70", "O", [("2", "R", None)])]),
            ("enum values joined, duplicates dropped, unusable sets left out",
             dictionary(msg("<field name='Odd'/><field name='Piped'/>")),
             [("6", "O", "a&b|<"), ("7", "O", None)]),
        ]
        for name, source, expected in cases:
            with self.subTest(name), contextlib.redirect_stderr(io.StringIO()):
                self.assertEqual(shape(dict2schema.convert(source)), expected)

    def test_value_is_escaped_in_the_text(self):
        text = dict2schema.convert(dictionary(msg("<field name='Odd'/>")))
        self.assertIn("<Value>a&amp;b|&lt;</Value>", text)

    def test_merge_table(self):
        cases = [  # merged so far, another occurrence, result
            ([1, 2], [1, 3, 2, 4], [1, 3, 2, 4]),
            ([1, 2], [5, 2], [1, 5, 2]),
            ([1, 2, 3], [3, 6, 7], [1, 2, 3, 6, 7]),
            ([1, 2, 3], [3, 1], [1, 2, 3]),
        ]
        for merged, other, expected in cases:
            dict2schema.merge(merged, other)
            self.assertEqual(merged, expected)

    def test_broken_dictionaries_are_refused(self):
        cases = [
            dictionary(msg("<field name='Nope'/>")),
            dictionary(msg("<component name='P'/>"), "<component name='P'><component name='P'/>"
                       "</component>"),
            dictionary(msg("<group name='NoX'><component name='P'/></group>"),
                       "<component name='P'><group name='NoX'><field name='A'/></group>"
                       "</component>"),
        ]
        for source in cases:
            with self.assertRaises(dict2schema.DictionaryError):
                dict2schema.convert(source)


if __name__ == "__main__":
    unittest.main()
