#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Prints the results of the benchmarks as a table: subjects beside baselines, and what grows with
the count of ports. The name of a case is its group, a slash, and its role:

    send, WinMM/subject
    send, WinMM/baseline: midiOutShortMsg
    queue/for comparison: ...
    reconcile, unchanged/ports/1000

Exit code 1 if a figure misses its aim.
"""

import json
import sys

# The largest ratio of subject to baseline.
SUBJECT_AIMS = {
    "send, WinMM": 2.0,
    "send, WinMM, stamped": 2.0,
    "send, DirectMusic": 2.0,
    "queue": 1.0,
    "setup file, load": 4.0,
    "names, a document read": 2.5,
    "names catalog of 1,000, start": 1.0 / 50,
    "autodetect, a byte matched": 3.0,
}
# The largest ratio of the cost of ten thousand ports to that of a thousand.
GROWTH_AIM = 12.0

UNITS = {"ns": 1.0, "us": 1e3, "ms": 1e6, "s": 1e9}


def nanoseconds(run):
    """What one item of the run costs."""
    if "items_per_second" in run:
        return 1e9 / run["items_per_second"]
    time = "real_time" if run["name"].endswith("/real_time") else "cpu_time"
    return run[time] * UNITS[run["time_unit"]]


def read_groups(path):
    """{group: {role: the cost of the best run}}, in the order of the file."""
    with open(path, encoding="utf-8") as file:
        results = json.load(file)
    groups = {}
    for run in results["benchmarks"]:
        if run.get("error_occurred"):
            sys.exit(f"{run['name']}: {run['error_message']}")
        if run["run_type"] != "iteration":
            continue
        group, role, *arguments = run["name"].removesuffix("/real_time").split("/")
        if role == "ports":
            role = int(arguments[0])
        costs = groups.setdefault(group, {})
        costs[role] = min(costs.get(role, float("inf")), nanoseconds(run))
    return groups


def text_of(cost):
    return f"{cost:.1f} ns" if cost < 1e5 else f"{cost / 1e6:.2f} ms"


def rows_of(group, costs):
    """(case, cost, against what, its cost, ratio, aim or None)"""
    aim = SUBJECT_AIMS.get(group)
    if "subject" in costs:
        for role in sorted(role for role in costs if role != "subject"):
            kind, _, name = role.partition(": ")
            ratio = costs["subject"] / costs[role]
            yield (group, costs["subject"], name, costs[role], ratio,
                   aim if kind == "baseline" else None)
    elif 1000 in costs and 10000 in costs:
        yield (f"{group}, 10,000 ports", costs[10000], "1,000 ports", costs[1000],
               costs[10000] / costs[1000], GROWTH_AIM)


def main():
    missed = 0
    print("| Case | Cost | Against | Cost | Ratio | Aim |")
    print("|---|---:|---|---:|---:|---:|")
    for group, costs in sorted(read_groups(sys.argv[1]).items()):
        for case, cost, against, other, ratio, aim in rows_of(group, costs):
            aim_text = "" if aim is None else f"{aim:g}"
            if aim is not None and ratio > aim:
                missed += 1
                aim_text += ", missed"
            print(f"| {case} | {text_of(cost)} | {against} | {text_of(other)} | {ratio:.2f} "
                  f"| {aim_text} |")
    return 1 if missed else 0


if __name__ == "__main__":
    sys.exit(main())
