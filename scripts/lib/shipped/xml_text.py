# SPDX-License-Identifier: MIT
"""XML as the shipped files have it: two blanks a level, attributes in the order given."""

ESCAPES = {"&": "&amp;", "<": "&lt;", ">": "&gt;", '"': "&quot;"}


def escape(text):
    return "".join(ESCAPES.get(character, character) for character in text)


class Element:
    """Attributes whose value is None are left out. The content is a text, or elements."""

    def __init__(self, name, attributes=None, content=()):
        self.name = name
        self.attributes = attributes or {}
        self.content = content if isinstance(content, str) else list(content)

    def lines(self, indent=""):
        attributes = "".join(f' {name}="{escape(str(value))}"'
                             for name, value in self.attributes.items() if value is not None)
        start = f"{indent}<{self.name}{attributes}"
        if not self.content:
            yield f"{start}/>"
        elif isinstance(self.content, str):
            yield f"{start}>{escape(self.content)}</{self.name}>"
        else:
            yield f"{start}>"
            for child in self.content:
                yield from child.lines(indent + "  ")
            yield f"{indent}</{self.name}>"


class Mixed:
    """An element of words and elements without content, on one line."""

    def __init__(self, name, content):
        self.name = name
        self.content = list(content)

    def lines(self, indent=""):
        words = " ".join(escape(each) if isinstance(each, str) else "".join(each.lines())
                         for each in self.content)
        yield f"{indent}<{self.name}>{words}</{self.name}>"


def document(root, prolog=()):
    """The whole file. `prolog`: lines of its own, as a DOCTYPE."""
    lines = ['<?xml version="1.0" encoding="UTF-8"?>', "<!-- SPDX-License-Identifier: MIT -->",
             "<!-- Made by scripts/make-data from data/tables. -->", *prolog, *root.lines()]
    return "\n".join(lines) + "\n"
