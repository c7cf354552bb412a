# SPDX-License-Identifier: MIT
"""The documents of the two standard modes that the library falls back on.

"General MIDI": each group of programs is a bank, which is how the format groups patches; channel 10
has the percussion keys. "Default Names": patches by number, pitches by name, for any device.
"""

from .xml_text import Element, document

OWNS = ["midi-devices/General-MIDI.midnam", "midi-devices/Default-Names.midnam"]
AUTHOR = "Ostinet"

DOCTYPE = ('<!DOCTYPE MIDINameDocument PUBLIC '
           '"-//MIDI Manufacturers Association//DTD MIDINameDocument 1.0//EN" '
           '"http://www.midi.org/dtds/MIDINameDocument10.dtd">')

CHANNELS = range(1, 17)
PERCUSSION_CHANNEL = 10
CONTROLLERS = "Controllers"
NOTES = ["C", "C#", "D", "D#", "E", "F", "F#", "G", "G#", "A", "A#", "B"]
FIRST_OCTAVE = -1  # pitch 60 is C4
BANK_SELECT = "Bank Select"


def files(tables):
    rows = tables.rows("gm")
    return {OWNS[0]: standard_mode("General MIDI", general_midi_sets(rows), rows),
            OWNS[1]: standard_mode("Default Names", default_sets(), rows)}


def standard_mode(name, name_sets, rows):
    """`name_sets`: pairs of an element and the channels that it is for."""
    assignments = {channel: name_set.attributes["Name"]
                   for name_set, channels in name_sets for channel in channels}
    mode = Element("StandardDeviceMode", {"Name": name}, [
        Element("ChannelNameSetAssignments", content=[
            Element("ChannelNameSetAssign", {"Channel": channel, "NameSet": assignments[channel]})
            for channel in CHANNELS]),
        *(name_set for name_set, _ in name_sets),
        Element("ControlNameList", {"Name": CONTROLLERS}, controls(rows))])
    root = Element("MIDINameDocument", content=[Element("Author", content=AUTHOR), mode])
    return document(root, [DOCTYPE])


def name_set(name, channels, notes, banks):
    available = [Element("AvailableChannel", {"Channel": channel, "Available": "true"})
                 for channel in channels]
    note_list = [Element("NoteNameList", {"Name": f"{name} Notes"}, notes)] if notes else []
    return (Element("ChannelNameSet", {"Name": name}, [
        Element("AvailableForChannels", content=available), *note_list,
        Element("UsesControlNameList", {"Name": CONTROLLERS}), *banks]), channels)


def bank(name, patches):
    return Element("PatchBank", {"Name": name}, [Element("PatchNameList", content=patches)])


def patch(program, name):
    """`program` counts from 1, as tables and people do."""
    return Element("Patch", {"Number": program, "Name": name, "ProgramChange": program - 1})


def note(pitch, name):
    return Element("Note", {"Number": pitch, "Name": name})


def general_midi_sets(rows):
    groups = {}
    for row in rows:
        if row["Kind"] == "GM1 program":
            groups.setdefault(row["Group"], []).append(patch(int(row["Number"]), row["Name"]))
    keys = [note(int(row["Number"]), row["Name"])
            for row in rows if row["Kind"] == "GM1 percussion key"]
    melodic = [channel for channel in CHANNELS if channel != PERCUSSION_CHANNEL]
    return [name_set("Instruments", melodic, [],
                     [bank(group, patches) for group, patches in groups.items()]),
            name_set("Percussion", [PERCUSSION_CHANNEL], keys,
                     [bank("Percussion", [patch(1, "Percussion")])])]


def default_sets():
    pitches = [note(pitch, f"{NOTES[pitch % 12]}{pitch // 12 + FIRST_OCTAVE}")
               for pitch in range(128)]
    patches = [patch(program, f"Patch {program}") for program in range(1, 129)]
    return [name_set("Default", list(CHANNELS), pitches, [bank("Patches", patches)])]


def controls(rows):
    """Each controller with 7 bits, each pair of them also with 14, and the registered parameters."""
    coarse, fine, parameters = [], [], []
    for row in rows:
        number = int(row["Number"])
        if row["Kind"] == "Controller" and not row["Name"].startswith("Undefined"):
            name = row["Name"]
            if name.endswith(" MSB") and number < 32 and not name.startswith(BANK_SELECT):
                name = name.removesuffix(" MSB")
                fine.append(control("14bit", number, name, 16383))
            coarse.append(control("7bit", number, name, 127))
        elif row["Kind"] == "RPN (MSB 0)":
            parameters.append(control("RPN", number, row["Name"], 16383))
    return coarse + fine + parameters


def control(kind, number, name, maximum):
    return Element("Control", {"Type": kind, "Number": number, "Name": name},
                   [Element("Values", {"Min": 0, "Max": maximum})])
