#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Tells what a CTest run came to, from its JUnit file: failures with their output, why tests were
skipped, and last the counts. The exit code is 1 when a test failed or nothing ran."""

import collections
import os
import re
import sys
import xml.etree.ElementTree as ElementTree

LONGEST_OUTPUT = 4000


def reason_of_skip(output):
    """The text that the test gave to GTEST_SKIP, which follows the line that names the place."""
    lines = [line.strip() for line in output.splitlines()]
    for number, line in enumerate(lines):
        if re.search(r"(: Skipped$|^\[  SKIPPED \]$|\(\d+\): Skipped)", line):
            for reason in lines[number + 1:]:
                if reason and not reason.startswith("["):
                    return reason
    return "no reason given"


def main():
    junit, log = sys.argv[1:3]
    if not os.path.exists(junit):
        with open(log, encoding="utf-8", errors="replace") as text:
            sys.stderr.write(text.read()[-LONGEST_OUTPUT:])
        print("0 passed, 1 failed, 0 skipped")
        return 1

    passed, failed, skips = 0, [], collections.defaultdict(list)
    for case in ElementTree.parse(junit).getroot().iter("testcase"):
        output = case.findtext("system-out") or ""
        if case.get("status") == "run":
            passed += 1
        elif case.get("status") == "notrun" and case.find("skipped") is not None:
            skips[reason_of_skip(output)].append(case.get("name"))
        else:
            failed.append((case.get("name"), output))

    for name, output in failed:
        print(f"FAILED {name}\n{output.strip()[-LONGEST_OUTPUT:]}\n")
    for reason, names in sorted(skips.items()):
        shown = ", ".join(names[:3]) + (f" and {len(names) - 3} more" if len(names) > 3 else "")
        print(f"skipped: {reason} ({shown})")
    print(f"{passed} passed, {len(failed)} failed, {sum(map(len, skips.values()))} skipped")
    return 1 if failed or not passed else 0


sys.exit(main())
