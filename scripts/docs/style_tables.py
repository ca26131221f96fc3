#!/usr/bin/env python3
"""The tables of keys of docs/style-files.md are those of the schema: style_tables.py [--check]

A table stands between the lines "<!-- keys of NAME -->" and "<!-- end of keys -->". NAME is `file` for the
top level, or a definition of the schema (look, shadow, ...), or a key of a look. The script writes the tables
anew; with --check it fails instead when one is behind.
"""

import json
import re
import sys

from pages import HEADING, ROOT, slug

PAGE = ROOT / "docs" / "style-files.md"
SCHEMA = json.loads((ROOT / "style" / "vorelpaint-style.schema.json").read_text(encoding="utf-8"))
TABLE = re.compile(r"(<!-- keys of (\w+) -->\n).*?(<!-- end of keys -->)", re.DOTALL)
HEAD = "| key | type | range | default | meaning |\n|---|---|---|---|---|\n"
LENGTH = ["number", "string"]
OPTION = re.compile(r"--[a-z][a-z-]*")
PERCENTS = (-100, 0, 100, 1000)


def resolved(schema):
    """The schema with what its $ref says."""
    if "$ref" not in schema:
        return schema
    target = SCHEMA
    for name in schema["$ref"].removeprefix("#/").split("/"):
        target = target[name]
    return {**resolved(target), **schema}


def object_named(name):
    """The schema of the object that a table is of."""
    if name == "file":
        return SCHEMA
    if name == "stop":
        return SCHEMA["$defs"]["stops"]["items"]
    return SCHEMA["$defs"].get(name) or SCHEMA["$defs"]["look"]["properties"][name]


def sections():
    """The anchor of each section whose heading names keys, by the key."""
    headings = [HEADING.match(line) for line in PAGE.read_text(encoding="utf-8").split("\n")]
    return {key: slug(heading[2]) for heading in headings if heading
            for key in re.findall(r"`(\w+)`", heading[2])}


def type_name(key, member, schema, anchors):
    if key in anchors and schema["type"] == "object":
        return f"[effect](#{anchors[key]})"
    if member.get("$ref") == "#/$defs/stops":
        return "[stops](#stops)"
    if member.get("$ref") == "#/$defs/colour":
        return "[colour](#colours)"
    if schema.get("type") == LENGTH:
        return "[length](#lengths)"
    if "enum" in schema and "type" not in schema:
        return "choice"
    return {"integer": "whole number", "array": "list"}.get(schema["type"], schema["type"])


def percents(pattern):
    """The least and the most that a length in percent may be."""
    taken = [number for number in PERCENTS if re.match(pattern, f"{number}%")]
    return (taken[0] if taken[0] <= 0 else 0), taken[-1]


def length_range(schema):
    low, high = schema["minimum"], schema["maximum"]
    if 0 < low < 1:
        return f"above 0, to {high} px or {percents(schema['pattern'])[1]}%"
    least, most = percents(schema["pattern"])
    return f"{low} to {high} px, {least}% to {most}%"


def range_text(schema):
    if "enum" in schema:
        return ", ".join(f"`{json.dumps(value)}`" for value in schema["enum"])
    if schema.get("type") == LENGTH:
        return length_range(schema)
    if "minimum" in schema:
        return f"{schema['minimum']} to {schema['maximum']}"
    return f"{schema['minItems']} to {schema['maxItems']}" if "minItems" in schema else ""


def default_text(key, schema, parent):
    if key in parent.get("required", []):
        return "required"
    return f"`{json.dumps(schema['default'])}`" if "default" in schema else "none"


def meaning(schema):
    """The description, its options as code."""
    return OPTION.sub(r"`\g<0>`", schema["description"].replace("|", "\\|"))


def rows(parent, prefix, anchors):
    """A row for each key; those of an object without a section of its own behind a dot."""
    for key, member in parent["properties"].items():
        schema = resolved(member)
        if schema.get("type") == "object" and key not in anchors:
            yield from rows(schema, f"{prefix}{key}.", anchors)
            continue
        yield (f"`{prefix}{key}`", type_name(key, member, schema, anchors), range_text(schema),
               default_text(key, schema, parent), meaning(schema))


def table(name, anchors):
    return HEAD + "".join("| " + " | ".join(row) + " |\n" for row in rows(object_named(name), "", anchors))


def written(text):
    """The page with its tables as the schema has them."""
    anchors = sections()
    return TABLE.sub(lambda match: match[1] + table(match[2], anchors) + match[3], text)


def table_faults():
    """One line when the page is behind the schema, else none."""
    text = PAGE.read_text(encoding="utf-8")
    if not TABLE.search(text):
        return [f"{PAGE.name}: no table of keys"]
    if text == written(text):
        return []
    return ["docs/style-files.md: the tables are behind the schema; scripts/docs/style_tables.py writes them"]


def main(check):
    if not check:
        PAGE.write_text(written(PAGE.read_text(encoding="utf-8")), encoding="utf-8")
        return 0
    faults = table_faults()
    print("\n".join(faults), end="\n" if faults else "", file=sys.stderr)
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:] == ["--check"]))
