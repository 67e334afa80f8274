#!/usr/bin/python3
"""Independent audit of the 2D files: ezdxf opens every DXF the sample program writes, audits it
and compares its content with what the program says it wrote; every SVG must be well-formed XML.
Any audit error or fix, any difference, any failure to open fails the test."""

import pathlib
import subprocess
import sys
import tempfile
import xml.etree.ElementTree as ElementTree

import ezdxf


def audit_dxf(path, expected):
    problems = []
    doc = ezdxf.readfile(str(path))
    auditor = doc.audit()
    problems += [f"audit error: {entry.message}" for entry in auditor.errors]
    problems += [f"audit fix: {entry.message}" for entry in auditor.fixes]
    if doc.dxfversion != "AC1009":
        problems.append(f"version {doc.dxfversion}")
    lines, texts, layers = expected
    modelspace = doc.modelspace()
    found_lines = len(modelspace.query("LINE"))
    found_texts = len(modelspace.query("TEXT"))
    if (found_lines, found_texts) != (lines, texts):
        problems.append(f"{found_lines} lines and {found_texts} texts, expected {lines} and {texts}")
    table = {layer.dxf.name for layer in doc.layers}
    missing = [name for name in layers if name not in table]
    if missing:
        problems.append(f"layers missing from the table: {missing[:5]}")
    used = {entity.dxf.layer for entity in modelspace}
    if not used <= table:
        problems.append(f"entities on layers outside the table: {sorted(used - table)[:5]}")
    return problems


def main():
    if len(sys.argv) != 2:
        print("usage: audit_dxf.py SAMPLE_PROGRAM", file=sys.stderr)
        return 2
    failures = 0
    with tempfile.TemporaryDirectory(prefix="pandex-dxf-audit-") as folder:
        subprocess.run([sys.argv[1], folder], check=True)
        expected = {}
        for row in pathlib.Path(folder, "expected.txt").read_text(encoding="utf-8").splitlines():
            name, lines, texts, *layers = row.split("\t")
            expected[name] = (int(lines), int(texts), layers)
        dxf_files = sorted(pathlib.Path(folder).glob("*.dxf"))
        if sorted(path.name for path in dxf_files) != sorted(expected):
            print(f"files {[path.name for path in dxf_files]} but expected {sorted(expected)}")
            failures += 1
        for path in dxf_files:
            try:
                problems = audit_dxf(path, expected.get(path.name, (0, 0, [])))
            except Exception as error:  # any refusal by the reader is a finding
                problems = [f"cannot be read: {error}"]
            print(f"{path.name}: {len(problems)} errors")
            for problem in problems:
                print(f"  {problem}")
            failures += len(problems)
        svg_files = sorted(pathlib.Path(folder).glob("*.svg"))
        for path in svg_files:
            try:
                root = ElementTree.parse(path).getroot()
                if root.tag != "{http://www.w3.org/2000/svg}svg":
                    raise ValueError(f"root element {root.tag}")
            except Exception as error:
                print(f"{path.name}: not a well-formed SVG: {error}")
                failures += 1
        print(f"{len(dxf_files)} files, {failures} errors ({len(svg_files)} SVG previews checked)")
    return 0 if failures == 0 and dxf_files else 1


if __name__ == "__main__":
    sys.exit(main())
