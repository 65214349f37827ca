"""Typed attribute values and the objects that hold attributes."""

from __future__ import annotations

from typing import Optional

from .names import normalize
from .text import atof, atoi, equal_ignoring_case
from .tokenizer import split

GENERIC_OPTIONS = (b"NONE", b"SYN", b"NOSYN")
SYNTHESIS_OPTIONS = (b"NONE", b"ASSIGN", b"ASSIGNNODEC")


class BitVectorValue:
    """Digits with a base and a length; both are given only in the form length:base:digits."""

    def __init__(self, text: bytes = b"") -> None:
        self.digits = text
        self.base = 2
        self.length = 1
        self.has_base_and_length = False
        pieces = split(text, b":")
        if len(pieces) >= 3:
            self.length = atoi(pieces[0])
            self.base = {b"O": 8, b"H": 16}.get(pieces[1][:1].upper(), 2)
            self.digits = pieces[2]
            self.has_base_and_length = True


class Attribute:
    """A named value; each subclass keeps it in its own form and gives it back as text."""

    type_name = b""

    def __init__(self, name: bytes, value: bytes) -> None:
        self.name = normalize(name)
        self.generic = b"NONE"
        self.synthesis = b"NONE"
        self.set_value(value)

    def set_value(self, text: bytes) -> None:
        raise NotImplementedError

    def value_text(self) -> bytes:
        raise NotImplementedError

    def set_generic(self, text: bytes) -> bool:
        if text.upper() not in GENERIC_OPTIONS:
            return False
        self.generic = text.upper()
        return True

    def set_synthesis(self, text: bytes) -> bool:
        if text.upper() not in SYNTHESIS_OPTIONS:
            return False
        self.synthesis = text.upper()
        return True

    def equals(self, other: Attribute) -> bool:
        return (
            self.name == other.name
            and self.generic == other.generic
            and self.synthesis == other.synthesis
            and equal_ignoring_case(self.value_text(), other.value_text())
        )


class StringAttribute(Attribute):
    type_name = b"String"

    def set_value(self, text: bytes) -> None:
        self.value = text

    def value_text(self) -> bytes:
        return self.value


class IntegerAttribute(Attribute):
    type_name = b"Integer"

    def set_value(self, text: bytes) -> None:
        self.value = atoi(text)

    def value_text(self) -> bytes:
        return b"%d" % self.value


class FloatAttribute(Attribute):
    """Written with as many digits before and behind the point as its text had."""

    type_name = b"Float"

    def set_value(self, text: bytes) -> None:
        self.width = 3
        self.precision = 1
        self.value = 0.0
        if not text:
            return
        pieces = split(text, b".")
        self.precision = len(pieces[1]) if len(pieces) > 1 else 1
        self.width = max(1, len(pieces[0]) if pieces else 0) + self.precision + 1
        self.value = atof(text)

    def value_text(self) -> bytes:
        return b"%*.*f" % (self.width, self.precision, self.value)


class BooleanAttribute(Attribute):
    type_name = b"Boolean"

    def set_value(self, text: bytes) -> None:
        self.value = equal_ignoring_case(text, b"true")

    def value_text(self) -> bytes:
        return b"TRUE" if self.value else b"FALSE"


class BitAttribute(Attribute):
    type_name = b"Bit"

    def set_value(self, text: bytes) -> None:
        self.value = b"1" if text == b"1" else b"0"

    def value_text(self) -> bytes:
        return self.value


class BitVectorAttribute(Attribute):
    type_name = b"BitVector"

    def set_value(self, text: bytes) -> None:
        self.value = BitVectorValue(text)

    def value_text(self) -> bytes:
        return self.value.digits


class UserAttribute(Attribute):
    type_name = b"User"

    def __init__(self, name: bytes, value: bytes) -> None:
        super().__init__(name, value)
        self.user_type = b""

    def set_value(self, text: bytes) -> None:
        self.value = text

    def value_text(self) -> bytes:
        return self.value


_CLASSES = {
    kind.type_name.upper(): kind
    for kind in (
        StringAttribute,
        IntegerAttribute,
        FloatAttribute,
        BooleanAttribute,
        BitAttribute,
        BitVectorAttribute,
        UserAttribute,
    )
}


def create_attribute(type_name: bytes, name: bytes, value: bytes) -> Optional[Attribute]:
    kind = _CLASSES.get(type_name.upper())
    return kind(name, value) if kind else None


class HdlObject:
    """Something with a name, a comment and attributes."""

    def __init__(self, name: bytes) -> None:
        self.name = normalize(name)
        self.comment = b""
        self.attributes: dict[bytes, Attribute] = {}

    def add_comment(self, text: bytes) -> None:
        self.comment += text + b"\n"

    def comment_lines(self) -> list[bytes]:
        return split(self.comment, b"\n")

    def get_attribute(self, name: bytes) -> Optional[Attribute]:
        return self.attributes.get(normalize(name).upper())

    def add_attribute(self, attribute: Attribute) -> None:
        self.attributes[attribute.name.upper()] = attribute


def attributes_of(holder: HdlObject) -> list[Attribute]:
    """The attributes in the order in which they were added."""
    return list(holder.attributes.values())


def effective_attributes(instance: HdlObject, component: HdlObject) -> list[Attribute]:
    """The instance's attributes, then the component's that it does not hide."""
    inherited = [a for key, a in component.attributes.items() if key not in instance.attributes]
    return attributes_of(instance) + inherited


def split_generics(attributes: list[Attribute]) -> tuple[list[Attribute], list[Attribute]]:
    """The attributes that synthesis sees as generics, and those that it does not."""
    syn = [a for a in attributes if a.generic == b"SYN"]
    nosyn = [a for a in attributes if a.generic == b"NOSYN"]
    return syn, nosyn


def find_init(syn: list[Attribute], nosyn: list[Attribute]) -> Optional[Attribute]:
    return next((a for a in syn + nosyn if a.name == b"INIT"), None)
