"""Attributes, and what has attributes and comments."""

from __future__ import annotations

from typing import TYPE_CHECKING, Iterator, MutableMapping, Optional, Tuple, Union

from ._errors import DeletedError, NotFoundError

if TYPE_CHECKING:
    from ._design import Design
    from ._orn_hdl import Model

Value = Union[str, int, float, bool]


def key_of(name: str) -> str:
    """What names are compared by: letter case does not count, and neither does the form of brackets."""
    name = name.translate(_BRACKETS)
    return name.upper() if name.isascii() else name


_BRACKETS = str.maketrans("[{<]}>", "((()))")


def spell(value: Value) -> str:
    """A value as the commands spell it."""
    return str(value).lower() if isinstance(value, bool) else str(value)


def type_of(value: Value) -> str:
    """The type that an attribute gets whose type is not given."""
    if isinstance(value, bool):
        return "Boolean"
    if isinstance(value, int):
        return "Integer"
    return "Float" if isinstance(value, float) else "String"


class Holder:
    """Something with a comment and attributes: the design, a component, an instance, a net or a pin.

    A holder is a name in its design. Every use looks the name up, so an object that has been removed raises
    a `DeletedError`, also when another one has got its name since.
    """

    __slots__ = ("_design", "_born", "__weakref__")

    _design: Design
    _born: int

    def __init__(self, design: Design) -> None:
        self._design = design
        self._born = design._removals

    def _address(self) -> Tuple[int, str, str]:
        """Kind, name, and name of a pin, as the extension wants them."""
        raise NotImplementedError

    def _key(self) -> Tuple[object, ...]:
        """What tells the object from all others of the design."""
        kind, name, pin = self._address()
        return (kind, key_of(name), key_of(pin))

    def _model(self) -> Model:
        """The design's model. Raises DeletedError if the object has been removed."""
        design = self._design
        if self._born != design._removals:
            if design._is_removed(self._key(), self._born):
                raise DeletedError(f"{self!r} has been removed from its design")
            self._born = design._removals
        return design._native

    @property
    def design(self) -> Design:
        """The design that the object belongs to."""
        return self._design

    @property
    def comment(self) -> str:
        """The lines of the comment, each with its line feed; empty for none."""
        return self._model().comment(*self._address())

    def add_comment(self, text: str) -> None:
        """Adds a line to the comment, which the writers write in front of the object."""
        self._model().add_comment(*self._address(), text)

    @property
    def attributes(self) -> Attributes:
        """The attributes by name, as a mapping: `u.attributes["INIT"] = "8:H:A5"`."""
        return Attributes(self)

    def set_attribute(self, name: str, value: Value, type: Optional[str] = None, *,
                      generic: Optional[str] = None, synthesis: Optional[str] = None) -> Attribute:
        """Adds an attribute, or gives it another value.

        `type` is one of "String", "Integer", "Float", "Boolean", "Bit", "BitVector" and "User"; by default the
        value tells. It does not change the type of an attribute that exists. `generic` is "NONE", "SYN" or
        "NOSYN", `synthesis` is "NONE", "ASSIGN" or "ASSIGNNODEC"; each stays as it is when it is not given.
        Raises InvalidValueError for any other type or option.
        """
        self._model().add_attribute(*self._address(), name, spell(value), type or type_of(value))
        attribute = Attribute(self, name)
        if generic is not None:
            attribute.generic = generic
        if synthesis is not None:
            attribute.synthesis = synthesis
        return attribute

    def __eq__(self, other: object) -> bool:
        return (isinstance(other, Holder) and self._design is other._design
                and self._key() == other._key())

    def __hash__(self) -> int:
        return hash((id(self._design), self._key()))


class Attribute:
    """An attribute of an object. Using one that has been removed raises a DeletedError."""

    __slots__ = ("_holder", "_name", "_born")

    def __init__(self, holder: Holder, name: str) -> None:
        self._holder = holder
        self._name = name
        self._born = holder._design._removals

    def _key(self) -> Tuple[object, ...]:
        return (*self._holder._key(), "attribute", key_of(self._name))

    def _get(self) -> Tuple[str, str, str, str, str, str]:
        model = self._holder._model()
        found = model.attribute(*self._holder._address(), self._name)
        if found is None or self._holder._design._is_removed(self._key(), self._born):
            raise DeletedError(f'the attribute "{self._name}" has been removed')
        return found

    @property
    def holder(self) -> Holder:
        """What has the attribute."""
        return self._holder

    @property
    def name(self) -> str:
        """The name."""
        return self._get()[0]

    @property
    def type(self) -> str:
        """The type, such as "BitVector"."""
        return self._get()[1]

    @property
    def value(self) -> str:
        """The value as the type spells it."""
        return self._get()[2]

    @value.setter
    def value(self, value: Value) -> None:
        self._get()
        self._holder._model().set_attribute_value(*self._holder._address(), self._name, spell(value))

    @property
    def generic(self) -> str:
        """Whether it is a generic or parameter: "NONE", "SYN" or "NOSYN"."""
        return self._get()[3]

    @generic.setter
    def generic(self, value: str) -> None:
        self._get()
        self._holder._model().set_attribute_generic(*self._holder._address(), self._name, value)

    @property
    def synthesis(self) -> str:
        """Whether it is written for synthesis: "NONE", "ASSIGN" or "ASSIGNNODEC"."""
        return self._get()[4]

    @synthesis.setter
    def synthesis(self, value: str) -> None:
        self._get()
        self._holder._model().set_attribute_synthesis(*self._holder._address(), self._name, value)

    @property
    def user_type(self) -> str:
        """The name of the type of an attribute of type "User"."""
        return self._get()[5]

    @user_type.setter
    def user_type(self, value: str) -> None:
        self._get()
        self._holder._model().set_attribute_user_type(*self._holder._address(), self._name, value)

    def __repr__(self) -> str:
        return f"<Attribute {self._name} of {self._holder!r}>"


class Attributes(MutableMapping[str, Attribute]):
    """The attributes of an object by name; letter case does not count.

    An item is an `Attribute`. What is assigned may be a value: `attributes["INIT"] = "1"` adds the attribute,
    or gives it another value. `del attributes["INIT"]` removes it.
    """

    __slots__ = ("_holder",)

    def __init__(self, holder: Holder) -> None:
        self._holder = holder

    def __getitem__(self, name: str) -> Attribute:
        found = self._holder._model().attribute(*self._holder._address(), name)
        if found is None:
            raise NotFoundError(f'{self._holder!r} has no attribute "{name}"')
        return Attribute(self._holder, found[0])

    def __setitem__(self, name: str, value: Union[Value, Attribute]) -> None:
        if isinstance(value, Attribute):
            self._holder.set_attribute(name, value.value, value.type, generic=value.generic,
                                       synthesis=value.synthesis)
        else:
            self._holder.set_attribute(name, value)

    def __delitem__(self, name: str) -> None:
        attribute = self[name]
        self._holder._model().remove_attribute(*self._holder._address(), name)
        self._holder._design._note_removal(attribute._key())

    def __iter__(self) -> Iterator[str]:
        return iter(self._holder._model().attributes(*self._holder._address()))

    def __len__(self) -> int:
        return len(self._holder._model().attributes(*self._holder._address()))

    def __repr__(self) -> str:
        return f"<{len(self)} attributes of {self._holder!r}>"
