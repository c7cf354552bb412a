# SPDX-License-Identifier: MIT
"""The list of instruments with a driver of their own, on whose ports nothing else can hang."""

from .xml_text import Element, document

OWNS = ["resources/StandaloneDevices.xml"]


def is_standalone(row):
    """One port over USB, each way, is the instrument itself. Where there are more, one of them leads
    to jacks, and on those things can hang; an interface is nothing but jacks."""
    is_single = (row["MIDI In"], row["MIDI Out"]) == ("1", "1")
    return is_single and row["Count basis"] == "USB ports" and "interface" not in row["Kind"]


def files(tables):
    devices = sorted({(row["Manufacturer"], model) for row in tables.rows("ports")
                      if is_standalone(row) for model in tables.models(row)})
    root = Element("StandaloneDevices", content=[
        Element("Device", {"Mfr": maker, "Model": model}) for maker, model in devices])
    return {"resources/StandaloneDevices.xml": document(root)}
