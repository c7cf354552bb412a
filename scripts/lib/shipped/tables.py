# SPDX-License-Identifier: MIT
"""The tables in data/tables: tab-separated, comment lines with #, then one line of headings.

What they mean stands in data/tables/README.md. A cell of "?" or nothing says nothing.
"""

import re

UNKNOWN_BYTE = "??"


class Tables:
    """Each table is read once: a list of {heading: cell}."""

    def __init__(self, folder):
        self._folder = folder
        self._tables = {}

    def rows(self, name):
        if name not in self._tables:
            self._tables[name] = read_table(self._folder / f"{name}.tsv")
        return self._tables[name]

    def models(self, row):
        """The models that a row speaks of: its own, or those of the group that it names."""
        return self._groups().get((row["Manufacturer"], row["Model"]), [row["Model"]])

    def device_ids(self):
        """{(maker, model): (first, last)}: the device IDs of a model as they go over the wire."""
        found = {}
        for row in self.rows("device_ids"):
            for model in self.models(row):
                found.setdefault((row["Manufacturer"], model),
                                 (int(row["First"], 16), int(row["Last"], 16)))
        return found

    def also_answers(self):
        """{(maker, model cell of a row of detect): other (maker, model) that answer it as well}."""
        return {(row["Manufacturer"], row["Row"]):
                [(row["Manufacturer"], model) for model in row["Models"].split("|")]
                for row in self.rows("also_answers")}

    @staticmethod
    def identity(row):
        """What a row of inquiry tells: maker's bytes, family and member, as texts."""
        return (row["ManufacturerID"], row["Family (wire order)"], row["Member (wire order)"])

    def identities(self):
        """{(maker, model): (maker's bytes, family, member)}, texts as in an inquiry's reply. The
        first row of a model counts; rows with unknown bytes do not."""
        found = {}
        for row in self.rows("inquiry"):
            identity = self.identity(row)
            if not any(UNKNOWN_BYTE in part for part in identity):
                for model in self.models(row):
                    found.setdefault((row["Manufacturer"], model), identity)
        return found

    def shared_identities(self):
        """The identities that more than one model answers with, whatever its revision."""
        makers = {}
        for row in self.rows("inquiry"):
            identity = self.identity(row)
            makers.setdefault(identity, set()).update(
                (row["Manufacturer"], model) for model in self.models(row))
        return {identity for identity, models in makers.items() if len(models) > 1}

    def _groups(self):
        return {(row["Manufacturer"], row["Row"]): row["Models"].split("|")
                for row in self.rows("model_groups")}


def read_table(path):
    with open(path, encoding="utf-8") as text:
        lines = [line.rstrip("\n").split("\t") for line in text
                 if line.strip() and not line.startswith("#")]
    headings, rows = lines[0], lines[1:]
    for number, row in enumerate(rows, 1):
        if len(row) != len(headings):
            raise SystemExit(f"{path.name}: row {number} ({row[0]}) has {len(row)} cells, "
                             f"not {len(headings)}")
    return [dict(zip(headings, (cell.strip() for cell in row))) for row in rows]


def catalog_key(manufacturer, model):
    """What the catalog takes for one model: case and white space do not count."""
    return tuple(re.sub(r"\s+", "", text).casefold() for text in (manufacturer, model))
