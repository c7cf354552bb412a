# SPDX-License-Identifier: MIT
"""The autodetect file: what to ask, and which answers mean which models.

The library asks the universal inquiry by itself and knows the identities of the device types. The
file adds the identities that no type can hold (shared by several models that differ in their
revision, known in part, or a second one of a model), and the requests of the makers' own.
"""

from .tables import UNKNOWN_BYTE
from .xml_text import Element, Mixed, document

OWNS = ["resources/AutoDetect.xml"]

# The catalog merges requests up to so many answers.
MOST_ANSWERS = 10
ANY_BYTE = "F8"
INQUIRY = "F0 7E ID 06 01 F7"
INQUIRY_REPLY = "F0 7E ID 06 02"
# A request is one message, and these want more of them.
LEFT_OUT = {
    ("Roland", "MKS-80"): "it waits for a second handshake once it has answered",
}


def template(name, text, ids):
    """The bytes of a table's cell. The types' device IDs are those of the wire, so an offset that
    such a device ID holds already goes out of it."""
    content = []
    for word in text.split():
        place, _, offset = word.partition("+")
        if place == "ID":
            offset = int(offset or "0", 16)
            first = ids[0] if ids else 0
            offset -= first if offset >= first else 0
            content.append(Element("DeviceID", {"Offset": offset or None}))
        else:
            content.append(ANY_BYTE if word == UNKNOWN_BYTE else word)
    return Mixed(name, content)


def request(message, ids, responses):
    return Element("Request", content=[template("RequestMIDI", message, ids), *responses])


def response(reply, ids, devices):
    return Element("Response", content=[
        template("ResponseMIDI", reply, ids),
        *(Element("Device", {"Manufacturer": maker, "Model": model}) for maker, model in devices)])


def telling_bytes(revisions):
    """The places of the revision that tell the models of a group apart: one, if one is enough."""
    length = min(map(len, revisions))
    for place in range(length):
        if len({revision[place] for revision in revisions}) == len(revisions):
            return [place]
    return list(range(length))


def loosened(revision, places):
    """The bytes at these places, and whatever stands between them."""
    return [revision[place] if place in places else UNKNOWN_BYTE
            for place in range(max(places) + 1)]


def identity_replies(tables):
    """Pairs of a reply and the models that it means, for the identities that types do not hold."""
    held = {names: identity for names, identity in tables.identities().items()
            if identity not in tables.shared_identities()}
    groups = {}
    for row in tables.rows("inquiry"):
        identity = tables.identity(row)
        models = [(row["Manufacturer"], model) for model in tables.models(row)]
        if any(held.get(model) != identity for model in models):
            revision = tuple(row["Revision bytes as read"].split())
            means = groups.setdefault(identity, {}).setdefault(revision, [])
            means += [model for model in models if model not in means]
    for identity, revisions in sorted(groups.items()):
        known = [revision for revision in revisions if revision]
        places = telling_bytes(known) if len(known) > 1 else []
        for revision, models in revisions.items():
            tail = loosened(revision, places) if revision and places else []
            yield " ".join([INQUIRY_REPLY, *identity, *tail]), models


def identity_requests(tables):
    # What is known of more bytes comes first: the reply of a table that ends earlier fits more.
    replies = sorted(identity_replies(tables), key=lambda reply: -len(reply[0].split()))
    responses = [response(reply, None, models) for reply, models in replies]
    for start in range(0, len(responses), MOST_ANSWERS):
        yield request(INQUIRY, None, responses[start:start + MOST_ANSWERS])


def maker_requests(tables):
    all_ids = tables.device_ids()
    also = tables.also_answers()
    for row in sorted(tables.rows("detect"), key=lambda row: place(row, also, all_ids, tables)):
        names = (row["Manufacturer"], row["Model"])
        if names in LEFT_OUT:
            continue
        models = [(row["Manufacturer"], model) for model in tables.models(row)]
        ids = all_ids.get(models[0])
        models += also.get(names, [])
        yield request(row["Request"], ids, [response(row["Reply prefix"], ids, models)])


def place(row, also, all_ids, tables):
    """Questions that relatives answer too come last, behind those that tell them apart; a wide range
    of device IDs before them, for the catalog merges neighbours and sweeps the range of both."""
    names = (row["Manufacturer"], row["Model"])
    first, last = all_ids.get((row["Manufacturer"], tables.models(row)[0]), (0, 0))
    return names in also, last - first > 0x1F, -len(row["Reply prefix"].split())


def files(tables):
    root = Element("MIDIAutoDetect", content=[*identity_requests(tables), *maker_requests(tables)])
    return {"resources/AutoDetect.xml": document(root)}
