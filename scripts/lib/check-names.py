#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Holds `ostinet names check` against xmllint and the published definition of name documents.

    check-names.py TOOL STANDARD [FOLDER...]

TOOL is the built program, STANDARD the folder of MIDINameDocument10.dtd. Every document of the
folders, and variants of it with one thing changed, must be valid to both or to neither.
"""

import copy
import json
import pathlib
import random
import re
import subprocess
import sys
import tempfile
import xml.etree.ElementTree as ElementTree

VARIANTS = 12
LARGEST = 60_000  # bytes; variants of longer documents teach nothing new
FILES_A_RUN = 100


def change(root, dice):
    """One change somewhere: of an element, its place, its text or its attributes."""
    parent = dice.choice([element for element in root.iter() if len(element)])
    child = dice.choice(list(parent))
    what = dice.randrange(7)
    if what == 0:
        parent.remove(child)
    elif what == 1:
        parent.insert(dice.randrange(len(parent) + 1), copy.deepcopy(child))
    elif what == 2:
        parent.remove(child)
        parent.insert(dice.randrange(len(parent) + 1), child)
    elif what == 3:
        child.tag = dice.choice([element.tag for element in root.iter()])
    elif what == 4 and child.attrib:
        del child.attrib[dice.choice(sorted(child.attrib))]
    elif what == 5:
        names = sorted({name for element in root.iter() for name in element.attrib})
        child.set(dice.choice(names), dice.choice(["1", "two words", "", "true", "-1.5", "a/b"]))
    else:
        child.text = (child.text or "") + dice.choice(["x", " "])


def variants(document, dice):
    for _ in range(VARIANTS if document.stat().st_size <= LARGEST else 0):
        tree = ElementTree.parse(document)
        for _ in range(dice.choice([1, 1, 2])):
            change(tree.getroot(), dice)
        yield tree


def gather(folders, target):
    """Copies without a DOCTYPE, so that nobody looks for the definition where it says."""
    dice = random.Random(1)
    count = 0
    for folder in folders:
        for document in sorted(pathlib.Path(folder).rglob("*.midnam")):
            for tree in [ElementTree.parse(document), *variants(document, dice)]:
                tree.write(target / f"{count:05}-{document.name}", encoding="utf-8",
                           xml_declaration=True)
                count += 1
    return sorted(target.iterdir())


def verdicts_of_tool(tool, files):
    verdicts = {}
    for start in range(0, len(files), FILES_A_RUN):
        run = subprocess.run([tool, "names", "check", "--json", *files[start:start + FILES_A_RUN]],
                             capture_output=True, text=True, check=False)
        verdicts.update((entry["file"], entry["valid"]) for entry in json.loads(run.stdout))
    return verdicts


def verdicts_of_xmllint(definition, files):
    """It says of each file that does not validate that it does not, and nothing of others."""
    verdicts = dict.fromkeys(map(str, files), True)
    for start in range(0, len(files), FILES_A_RUN):
        run = subprocess.run(["xmllint", "--noout", "--nonet", "--dtdvalid", definition,
                              *files[start:start + FILES_A_RUN]],
                             capture_output=True, text=True, check=False)
        for name in re.findall(r"^Document (.*) does not validate against", run.stderr, re.M):
            verdicts[name] = False
    return verdicts


def main():
    tool, standard, *folders = sys.argv[1:]
    definition = pathlib.Path(standard) / "MIDINameDocument10.dtd"
    with tempfile.TemporaryDirectory() as folder:
        files = gather(folders, pathlib.Path(folder))
        verdicts = verdicts_of_tool(tool, files)
        others = verdicts_of_xmllint(definition, files)
        differing = [file for file in files if verdicts[str(file)] != others[str(file)]]
        for file in differing:
            print(f"{file.name}: the tool says {verdicts[str(file)]}, xmllint does not")
        valid = sum(verdicts.values())
        print(f"{len(files)} documents and variants, {valid} of them valid, "
              f"{len(differing)} judged differently")
        return 1 if differing else 0


sys.exit(main())
