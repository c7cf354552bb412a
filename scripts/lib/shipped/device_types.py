# SPDX-License-Identifier: MIT
"""The device type files: one for each maker, with each model that any table names."""

import re

from .tables import catalog_key
from .xml_text import Element, document

OWNS = ["midi-devices/*.middev"]
AUTHOR = "Ostinet"

# What a kind of instrument says about it. The other kinds say nothing that a type can state.
KINDS = {
    "sampler": "IsSampler",
    "drum machine": "IsDrumMachine",
    "mixer": "IsMixer",
    "effect": "IsEffectUnit",
}
# Attribute of Receives and Transmits, and the column that tells it.
MESSAGES = {
    "ProgramChanges": "Program change",
    "BankSelectMSB": "Bank select MSB",
    "BankSelectLSB": "Bank select LSB",
}
WORDS = {"yes": "true", "no": "false"}


class Model:
    """What the tables tell of one model, by column; the first cell that says something counts."""

    def __init__(self, manufacturer, name):
        self.manufacturer = manufacturer
        self.name = name
        self.cells = {}

    def learn(self, row):
        for heading, cell in row.items():
            if cell not in ("", "?", "n/a"):
                self.cells.setdefault(heading, cell)

    def cell(self, heading):
        return self.cells.get(heading, "")


def collect(tables):
    """{key: Model}. A model is spelled as in the first table that has it."""
    models = {}
    for table in ("inquiry", "ports", "detect"):
        for row in tables.rows(table):
            for name in tables.models(row):
                key = catalog_key(row["Manufacturer"], name)
                model = models.setdefault(key, Model(row["Manufacturer"], name))
                if table == "ports":
                    model.learn(row)
    return models


def by_key(table):
    return {catalog_key(*names): value for names, value in table.items()}


def capabilities(model):
    kinds = [kind.strip() for kind in model.cell("Kind").split(",")]
    attributes = {"SupportsGeneralMIDI": WORDS.get(model.cell("GM"))}
    for kind, attribute in KINDS.items():
        attributes[attribute] = "true" if kind in kinds else None
    return attributes


def inquiry_response(identity):
    manufacturer, family, member = identity
    return Element("InquiryResponse",
                   {"Manufacturer": manufacturer, "Family": family, "Member": member})


def device_id(first, last):
    """The numbers of the wire: what panels show is in no table."""
    return Element("DeviceID", {"Default": first, "Min": first, "Max": last, "Base": 0})


def port_groups(model):
    """A group for each pair of ports. Unless both counts are known there is none."""
    counts = model.cell("MIDI In"), model.cell("MIDI Out")
    if not all(count.isdigit() for count in counts):
        return
    ins, outs = map(int, counts)
    for index in range(max(ins, outs)):
        ports = [Element("MIDIIn")] * (index < ins) + [Element("MIDIOut")] * (index < outs)
        yield Element("MIDIPortGroup", content=ports)


def traffic(model, element, side):
    """Receives ("rx") or Transmits ("tx"), or None if nothing is known."""
    attributes = {}
    if side == "rx" and re.match(r"16\b|32 \(2 x 16\)", model.cell("Receive channels")):
        attributes["MaxChannels"] = 16
    for attribute, heading in MESSAGES.items():
        said = re.search(rf"\b{side} (yes|no)\b", model.cell(heading))
        if said:
            attributes[attribute] = WORDS[said[1]]
    return Element(element, attributes) if attributes else None


def device_type(model, identity, ids):
    children = [
        inquiry_response(identity) if identity else None,
        device_id(*ids) if ids else None,
        *port_groups(model),
        traffic(model, "Receives", "rx"),
        traffic(model, "Transmits", "tx"),
    ]
    attributes = {"Manufacturer": model.manufacturer, "Model": model.name, **capabilities(model)}
    return Element("MIDIDeviceType", attributes, [child for child in children if child])


def files(tables):
    shared = tables.shared_identities()
    # An identity that several models share names none of them.
    identities = by_key({names: identity for names, identity in tables.identities().items()
                         if identity not in shared})
    ids = by_key(tables.device_ids())
    makers = {}
    for key, model in sorted(collect(tables).items()):
        element = device_type(model, identities.get(key), ids.get(key))
        makers.setdefault(model.manufacturer, []).append(element)
    return {f"midi-devices/{maker.replace(' ', '-')}.middev":
            document(Element("MIDIDeviceTypes", content=[Element("Author", content=AUTHOR), *types]))
            for maker, types in makers.items()}
