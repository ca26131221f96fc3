#!/usr/bin/env python3
"""The JSON Schema of style files agrees with the reader.

    schema_test.py VORELPAINT SCHEMA PAGE REFUSED STYLES...

VORELPAINT is the program, whose reader is asked; PAGE is the page that lists the keys; REFUSED is a list
of bad styles, each with what its refusal begins with; STYLES are directories of style files, all of them
good.
"""
import copy
import json
import pathlib
import re
import subprocess
import sys
import tempfile
import unittest

import jsonschema

program, schema_path, page_path, refused_path, *style_dirs = sys.argv[1:]
sys.argv[1:] = []


def read(path):
    return pathlib.Path(path).read_text(encoding="utf-8")


SCHEMA = json.loads(read(schema_path))
VALIDATOR = jsonschema.Draft202012Validator(SCHEMA)
STYLES = {path.name: json.loads(read(path))
          for directory in style_dirs for path in sorted(pathlib.Path(directory).glob("*.json"))}
REFUSED = json.loads(read(refused_path))
STOPS = [{"color": "#000000", "location": 0}, {"color": "#FFFFFF", "location": 1}]


def run_program(arguments, text=""):
    return subprocess.run([program, *arguments], input=text, capture_output=True, text=True, check=False)


def reader_faults(styles):
    """What the reader says against each of the styles; an empty string for one that it takes.

    The styles are the jobs of one batch. Its text has no ink, so that every job fails: those whose style
    was taken only afterwards.
    """
    jobs = ({"text": " ", "output": f"never{number}.png", "style": style}
            for number, style in enumerate(styles))
    run = run_program(["--batch", "-"], "".join(json.dumps(job) + "\n" for job in jobs))
    faults = {}
    for line, fault in re.findall(r"line (\d+): (?!note: )(.*)", run.stderr):
        # A missing image is no fault of the style.
        taken = fault.startswith("nothing to paint: ") or re.match(r"(looks\[\d+\]\.)?pattern\.image: '", fault)
        faults[int(line)] = "" if taken else fault
    return [faults[number] for number in range(1, len(styles) + 1)]


def resolved(schema):
    """The schema with what its $ref says."""
    if "$ref" not in schema:
        return schema
    target = SCHEMA
    for name in schema["$ref"].removeprefix("#/").split("/"):
        target = target[name]
    properties = {**target.get("properties", {}), **schema.get("properties", {})}
    return {**target, **schema, "properties": properties}


def smallest(schema):
    """A value that the schema takes, with the required members only."""
    schema = resolved(schema)
    if "enum" in schema:
        return schema["enum"][-1]
    if "minimum" in schema:
        return schema["minimum"]
    kind = schema["type"]
    if kind == "object":
        names = schema.get("required", []) + schema.get("anyOf", [{"required": []}])[0]["required"]
        return {name: smallest(schema["properties"][name]) for name in names}
    if kind == "array":
        return copy.deepcopy(STOPS) if "required" in schema["items"] else [{}]
    if kind == "boolean":
        return True
    return "#123456" if schema.get("pattern", "").startswith("^#") else "tiles.png"


FILE = resolved(SCHEMA)
LOOK = resolved(SCHEMA["$defs"]["look"])


def objects():
    """Path and schema of each object of a style file: the file, its parts, and parts of one in a list."""
    yield (), FILE
    for name, member in LOOK["properties"].items():
        if resolved(member).get("type") == "object":
            yield (name,), resolved(member)
    yield ("outerGlow", "gradient", 0), resolved(SCHEMA["$defs"]["stops"])["items"]
    yield ("looks", 0), LOOK
    yield ("looks", 0, "stroke"), resolved(LOOK["properties"]["stroke"])


def style_with(path, value, version=2):
    """A style that holds `value` at the path, and beside it no more than it has to."""
    if not path:
        return {"version": version, **value} if isinstance(value, dict) else value
    style = {"version": version}
    place, schema = style, FILE
    for name in path[:-1]:
        if isinstance(name, str):
            schema = resolved(schema["properties"][name])
            place = place.setdefault(name, smallest(schema) if name != "gradient" else copy.deepcopy(STOPS))
        else:
            schema, place = resolved(schema["items"]), place[name]
    place[path[-1]] = value
    return style


LENGTHS = ["4px", "4%", "0px", "0%", "0.000%", "-0px", "-4px", "-4%", "100%", "100.000px", "100.001%", "4.5%",
           "4.125%", "4.1255%", "0.001px", "99.999%", "1000px", "1000%", "1000.001px", "-1000px", "-100%", "-101%",
           "999.999px", "4em", "4", "px", "%", "-px", "1e9%", "1e1px", "04px", "00px", "4 px", " 4px", "4px ", "+4px",
           ".5px", "4.px", "4,5px", "4PX", "4pt", "4p", "4%%", "infpx", "nan%", "0x4px", "\u0664px", "9" * 60 + "px"]


def variants(schema):
    """Values around the limits of a member, and of every other type."""
    schema = resolved(schema)
    yield from (None, True, False, 0, 0.5, 1.5, 2.0, -1, 1e9, "", "x", "a\0b", "#12345", "#1234567", "#12345G",
                "#aBcDeF", "#aB9", "#12", "#1234", "#12G", [], {}, [[]], STOPS, STOPS[:1] * 256, STOPS[:1] * 257, [{}],
                [{}] * 32, [{}] * 33, {"x": 1}, {"y": "-3%"}, {"z": 1})
    for limit in (schema.get("minimum"), schema.get("maximum")):
        if limit is not None:
            yield from (limit, limit - 1, limit + 1, limit - 0.001, limit + 0.001)
    yield from schema.get("enum", [])
    if schema.get("type") == ["number", "string"]:
        yield from LENGTHS
    else:
        yield from LENGTHS[:2]


class StyleSchema(unittest.TestCase):
    maxDiff = None

    def assert_agreement(self, styles):
        """Schema and reader take the same of these styles, and refuse the same."""
        for style, fault in zip(styles, reader_faults(styles)):
            errors = [error.message for error in VALIDATOR.iter_errors(style)]
            with self.subTest(json.dumps(style)[:200]):
                self.assertEqual(not errors, not fault, f"schema: {errors}, reader: {fault}")

    def test_is_a_valid_schema(self):
        jsonschema.Draft202012Validator.check_schema(SCHEMA)

    def test_every_good_style_is_valid(self):
        self.assertGreaterEqual(len(STYLES), 14)
        for name, style in STYLES.items():
            with self.subTest(name):
                self.assertEqual([error.message for error in VALIDATOR.iter_errors(style)], [])

    def test_the_keys_are_the_readers(self):
        paths, schemas = zip(*objects())
        self.assertEqual(len(paths), 16)
        faults = reader_faults([style_with(path, {"?": 1}) for path in paths])
        for path, schema, fault in zip(paths, schemas, faults):
            known = re.search(r"\?: unknown key; known are (.*)", fault)
            self.assertEqual(set(known[1].split(", ")), set(schema["properties"]), path)

    def test_the_required_keys_are_the_readers(self):
        styles = []
        for path, schema in objects():
            whole = {name: smallest(member) for name, member in schema["properties"].items()}
            for excluded in {(): ("text", "looks"), ("looks", 0): ("text",), ("pattern",): ("scale",)}.get(path, ()):
                del whole[excluded]
            styles.append(style_with(path, whole))
            self.assertTrue(VALIDATOR.is_valid(styles[-1]), path)
            styles += [style_with(path, {key: value for key, value in whole.items() if key != name})
                       for name in whole]
        self.assert_agreement(styles)

    def test_both_take_and_refuse_the_same_values(self):
        styles = []
        for path, schema in objects():
            base = smallest(schema)
            for name, member in schema["properties"].items():
                styles += [style_with(path, {**base, name: value}, version)
                           for value in variants(member) for version in (1, 2)]
        self.assertGreater(len(styles), 8000)
        self.assert_agreement(styles)

    def test_the_version_is_taken_as_the_first_where_there_is_none(self):
        self.assert_agreement([{"offset": {"x": 1}}, {"stroke": {"size": "4%", "color": "#000000", "position": "inside"}},
                               {"looks": [{}]}, {"color": "#000000"}])

    def test_bad_styles_are_refused_by_both(self):
        styles = [case["style"] for case in REFUSED]
        for case, fault in zip(REFUSED, reader_faults(styles)):
            with self.subTest(case["refused"]):
                self.assertEqual(fault.removeprefix("style.")[:len(case["refused"])], case["refused"])
                self.assertFalse(VALIDATOR.is_valid(case["style"]))

    def test_a_thousand_looks_are_refused_by_both(self):
        style = {"version": 2, "looks": [{}] * 1000}
        self.assertEqual(reader_faults([style]), ["style.looks: has 1000 elements, 1 to 32 are allowed"])
        self.assertFalse(VALIDATOR.is_valid(style))

    def test_keys_of_a_look_stand_not_beside_looks(self):
        for name, member in LOOK["properties"].items():
            style = {"version": 2, "looks": [{}], name: smallest(member)}
            self.assertEqual(VALIDATOR.is_valid(style), name == "description", name)
            self.assert_agreement([style])

    def test_a_look_without_fill_has_no_colour(self):
        for fill in (True, False):
            for name in ("color", "textOpacity", "text", "description"):
                look = {"fill": fill, name: smallest(LOOK["properties"][name])}
                self.assert_agreement([{"version": 2, **look}, {"version": 2, "looks": [look]}])

    def test_every_key_is_described(self):
        for path, schema in objects():
            for name, member in schema["properties"].items():
                self.assertGreater(len(member.get("description", "")), 8, (path, name))
                known = resolved(member)
                optional = name not in schema.get("required", [])
                limited = "minimum" in known or "enum" in known
                if optional and limited and (path, name) != (("pattern",), "width"):
                    self.assertIn("default", known, (path, name))

    def test_a_glow_needs_a_colour_or_stops(self):
        self.assertFalse(VALIDATOR.is_valid({"innerGlow": {"size": 1}}))
        self.assert_agreement([{"innerGlow": glow} for glow in (
            {"size": 1}, {"size": 1, "color": "#000000"}, {"size": 1, "gradient": STOPS})])

    def test_colour_beside_a_text_fill_is_refused(self):
        style = {"color": "#000000", "text": {"color": "#000000"}}
        self.assertFalse(VALIDATOR.is_valid(style))
        self.assert_agreement([style])

    def test_a_file_that_is_no_object_is_refused(self):
        for value in (None, [], 1, "style"):
            self.assertFalse(VALIDATOR.is_valid(value))
            with tempfile.NamedTemporaryFile("w", suffix=".json") as file:
                json.dump(value, file)
                file.flush()
                self.assertEqual(run_program(["--style", file.name, "--print-key"]).returncode, 2)

    def test_every_key_is_told_in_the_page(self):
        page = read(page_path)
        for path, schema in objects():
            for name in schema["properties"]:
                self.assertTrue(f"`{name}`" in page, (path, name))


if __name__ == "__main__":
    unittest.main(verbosity=0)
