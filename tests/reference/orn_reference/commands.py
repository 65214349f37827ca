"""The command language: sixty-one phrases, the words that follow them, and what they do."""

from __future__ import annotations

from typing import Callable, Optional

from . import model as operations
from .attributes import HdlObject
from .model import HdlError, Model
from .objects import INVALID, polarity_of
from .options import Case, Options
from .streams import OutStream
from .text import equal_ignoring_case
from .tokenizer import split_command
from .verilog import VerilogNetlister
from .vhdl import VhdlNetlister

Words = list[bytes]
Action = Callable[[Model, Words], None]


class InvalidArguments(Exception):
    """The words behind a phrase are too few or of the wrong form."""


_ACTIONS: dict[bytes, Action] = {}  # the phrase as messages spell it
_PHRASES: dict[bytes, bytes] = {}  # the phrase in capitals to its own spelling


def _register(phrase: bytes, action: Action) -> None:
    _ACTIONS[phrase] = action
    _PHRASES[phrase.upper()] = phrase


def _command(phrase: bytes) -> Callable[[Action], Action]:
    def register(action: Action) -> Action:
        _register(phrase, action)
        return action

    return register


def phrases() -> list[bytes]:
    return list(_ACTIONS)


def find_phrase(words: Words) -> Optional[bytes]:
    """The longest phrase that the leading words spell, whatever their letter case."""
    longest = max(map(len, _PHRASES))
    found = None
    key = b""
    for index, word in enumerate(words):
        key = key + b" " + word.upper() if index else word.upper()
        found = _PHRASES.get(key, found)
        if len(key) > longest:
            break
    return found


def execute(model: Model, line: bytes) -> None:
    """Runs one line on the model; a failure is an HdlError."""
    words = split_command(line)
    if not words:
        return
    phrase = find_phrase(words)
    if phrase is None:
        raise HdlError(b"Command not find.\n")
    try:
        _ACTIONS[phrase](model, words)
    except InvalidArguments:
        raise HdlError(phrase + b": Invalid Arguments.\n") from None


# Reading words


def _at(words: Words, position: int) -> bytes:
    return words[position] if position < len(words) else b""


def _need(condition: bool) -> None:
    if not condition:
        raise InvalidArguments


def _need_words(words: Words, count: int) -> None:
    _need(len(words) >= count)


def _non_empty(words: Words, position: int) -> bytes:
    _need(_at(words, position) != b"")
    return words[position]


def _joined(words: Words, position: int) -> bytes:
    return b" ".join(words[position:])


def _polarity(word: bytes) -> int:
    value = polarity_of(word)
    _need(value != INVALID)
    return value


def _flag(words: Words, position: int) -> bool:
    return not equal_ignoring_case(_at(words, position), b"false")


def _owner_and_pin(word: bytes) -> tuple[bytes, bytes]:
    _need(b"." in word)
    owner, pin = word.split(b".", 1)
    return owner, pin


def _option_value(word: bytes, prefix: bytes) -> Optional[bytes]:
    """The text behind the prefix, which may stand in any letter case."""
    return word[len(prefix) :] if word.upper().startswith(prefix) else None


# Commands that build the design


@_command(b"NOOP")
def _noop(model: Model, words: Words) -> None:
    pass


@_command(b"SET NETLIST NAME")
def _set_netlist_name(model: Model, words: Words) -> None:
    model.netlist.name = _non_empty(words, 3)


@_command(b"SET SOURCE FILE")
def _set_source_file(model: Model, words: Words) -> None:
    model.source_file_name = _non_empty(words, 3)


@_command(b"ADD COMPONENT")
def _add_component(model: Model, words: Words) -> None:
    model.add_component(_non_empty(words, 2))


@_command(b"ADD PIN")
def _add_pin(model: Model, words: Words) -> None:
    _need_words(words, 5)
    model.add_pin(words[2], words[3], _polarity(words[4]))


@_command(b"ADD INSTANCE")
def _add_instance(model: Model, words: Words) -> None:
    _need_words(words, 4)
    model.add_instance(words[3], words[2])


@_command(b"ADD PORT")
def _add_port(model: Model, words: Words) -> None:
    _need_words(words, 4)
    model.add_port(words[2], _polarity(words[3]))


@_command(b"ADD SIGNAL")
def _add_signal(model: Model, words: Words) -> None:
    _need_words(words, 3)
    if len(words) > 3:
        _polarity(words[3])
    model.add_signal(words[2])


@_command(b"CONNECT SIGNAL")
def _connect_signal(model: Model, words: Words) -> None:
    _need_words(words, 4)
    if b"." in words[3]:
        model.connect_signal_to_pin(words[2], *_owner_and_pin(words[3]))
    else:
        model.connect_signals(words[2], words[3])


@_command(b"ASSIGN CONSTANT")
def _assign_constant(model: Model, words: Words) -> None:
    _need_words(words, 4)
    if b"." in words[2]:
        model.assign_constant_to_pin(*_owner_and_pin(words[2]), words[3])
    else:
        model.assign_constant_to_signal(words[2], words[3])


# Comments


@_command(b"ADD NOTES")
def _add_notes(model: Model, words: Words) -> None:
    _need_words(words, 3)
    model.add_notes(_joined(words, 2))


@_command(b"ADD MODULE COMMENT")
def _add_module_comment(model: Model, words: Words) -> None:
    _need_words(words, 4)
    model.add_notes(_joined(words, 3))


@_command(b"ADD COMPONENT COMMENT")
def _add_component_comment(model: Model, words: Words) -> None:
    _need_words(words, 5)
    model.add_component_comment(words[3], _joined(words, 4))


@_command(b"ADD INSTANCE COMMENT")
def _add_instance_comment(model: Model, words: Words) -> None:
    _need_words(words, 5)
    model.add_instance_comment(words[3], _joined(words, 4))


@_command(b"ADD SIGNAL COMMENT")
def _add_signal_comment(model: Model, words: Words) -> None:
    _need_words(words, 5)
    model.add_signal_comment(words[3], _joined(words, 4))


@_command(b"ADD COMPONENT PIN COMMENT")
def _add_component_pin_comment(model: Model, words: Words) -> None:
    _need_words(words, 6)
    model.component_pin_holder(*_owner_and_pin(words[4])).add_comment(_joined(words, 5))


@_command(b"ADD INSTANCE PIN COMMENT")
def _add_instance_pin_comment(model: Model, words: Words) -> None:
    _need_words(words, 6)
    model.instance_pin_holder(*_owner_and_pin(words[4])).add_comment(_joined(words, 5))


# Attributes: the same four commands for each kind of object


class _Holder:
    """A kind of object that carries attributes: how it is named and found."""

    def __init__(self, words: bytes, kind: str) -> None:
        self.words = words
        self._kind = kind

    def position_after(self, phrase: bytes) -> int:
        """The position of the attribute's words behind the object's name."""
        return len(phrase.split()) + (0 if self._kind == "module" else 1)

    def find(self, phrase: bytes, words: Words) -> Callable[[Model], HdlObject]:
        """Checks the form of the object's name; the look-up itself comes later."""
        names: tuple[bytes, ...] = ()
        if self._kind != "module":
            word = words[len(phrase.split())]
            names = _owner_and_pin(word) if self._kind.endswith("_pin") else (word,)
        return lambda model: getattr(model, self._kind + "_holder")(*names)


_HOLDERS = (
    _Holder(b"MODULE", "module"),
    _Holder(b"COMPONENT", "component"),
    _Holder(b"INSTANCE", "instance"),
    _Holder(b"SIGNAL", "signal"),
    _Holder(b"COMPONENT PIN", "component_pin"),
    _Holder(b"INSTANCE PIN", "instance_pin"),
)


def _add_attribute_action(phrase: bytes, holder: _Holder) -> Action:
    first = holder.position_after(phrase)

    def action(model: Model, words: Words) -> None:
        _need_words(words, first + 1)
        find = holder.find(phrase, words)
        type_name = _option_value(words[first], b"-TYPE=")
        name_position = first
        if type_name is not None:
            _need_words(words, first + 2)
            name_position += 1
        name = words[name_position]
        value = _at(words, name_position + 1)
        kind = b"String" if type_name is None else type_name
        operations.add_attribute(find(model), name, value, kind)

    return action


def _set_attribute_action(
    phrase: bytes, holder: _Holder, operation: Callable[[HdlObject, bytes, bytes], None]
) -> Action:
    first = holder.position_after(phrase)

    def action(model: Model, words: Words) -> None:
        _need_words(words, first + 2)
        find = holder.find(phrase, words)
        operation(find(model), words[first], words[first + 1])

    return action


def _attribute_option_action(phrase: bytes, holder: _Holder) -> Action:
    first = holder.position_after(phrase)

    def action(model: Model, words: Words) -> None:
        _need_words(words, first + 2)
        find = holder.find(phrase, words)
        generic = synthesis = None
        for word in words[first + 1 : first + 3]:
            generic_value = _option_value(word, b"-GENERIC=")
            synthesis_value = _option_value(word, b"-SYNATTR=")
            _need(generic_value is not None or synthesis_value is not None)
            generic = generic if generic_value is None else generic_value
            synthesis = synthesis if synthesis_value is None else synthesis_value
        if generic is not None:
            operations.set_generic_option(find(model), words[first], generic)
        if synthesis is not None:
            operations.set_synthesis_option(find(model), words[first], synthesis)

    return action


for _holder in _HOLDERS:
    _add = b"ADD " + _holder.words + b" ATTRIBUTE"
    _register(_add, _add_attribute_action(_add, _holder))
    _set = b"SET " + _holder.words + b" ATTRIBUTE "
    _register(
        _set + b"VALUE",
        _set_attribute_action(_set + b"VALUE", _holder, operations.set_attribute_value),
    )
    _register(
        _set + b"USERTYPE",
        _set_attribute_action(_set + b"USERTYPE", _holder, operations.set_user_type),
    )
    _register(_set + b"OPTION", _attribute_option_action(_set + b"OPTION", _holder))


# Output options


def _append_action(position: int, list_name: str) -> Action:
    def action(model: Model, words: Words) -> None:
        getattr(model.options, list_name).append(_non_empty(words, position))

    return action


_register(b"ADD INCLUDE", _append_action(2, "includes"))
_register(b"ADD LIBRARY", _append_action(2, "libraries"))
_register(b"ADD USE LIBRARY", _append_action(3, "use_clauses"))


def _flag_action(position: int, field: str) -> Action:
    def action(model: Model, words: Words) -> None:
        setattr(model.options, field, _flag(words, position))

    return action


_register(b"FLATTEN BUS", _flag_action(2, "flatten_bus"))
_register(b"SUPPRESS CONFIGURATION", _flag_action(2, "suppress_configuration"))
_register(b"SUPPRESS COMPONENT", _flag_action(2, "suppress_component"))
_register(b"USE DEFAULT LIBRARY", _flag_action(3, "use_default_library"))
_register(b"Set Open Pin", _flag_action(3, "open_pin"))


def _header_word_action(field: str) -> Action:
    def action(model: Model, words: Words) -> None:
        setattr(model.options, field, _non_empty(words, 2))

    return action


_register(b"Set Application", _header_word_action("application"))
_register(b"Set Device", _header_word_action("device"))


def _header_text_action(field: str) -> Action:
    def action(model: Model, words: Words) -> None:
        _need_words(words, 3)
        setattr(model.options, field, _joined(words, 2))

    return action


_register(b"Set Command", _header_text_action("command"))
_register(b"Set Purpose", _header_text_action("purpose"))
_register(b"Set Reference", _header_text_action("reference"))


@_command(b"SET SYNTHESIS")
def _set_synthesis(model: Model, words: Words) -> None:
    model.options.set_synthesis_type(_non_empty(words, 2))


@_command(b"SET PORT ONEPERLINE")
def _set_port_one_per_line(model: Model, words: Words) -> None:
    model.options.one_port_per_line = True


@_command(b"Use AttrType")
def _use_attr_type(model: Model, words: Words) -> None:
    model.options.typed_attributes = True


def _case_action(case: Case, signal_word: bytes) -> Action:
    fields = {
        b"INSTANCE": "instance_case",
        signal_word: "signal_case",
        b"COMPONENT": "component_case",
    }

    def action(model: Model, words: Words) -> None:
        field = fields.get(_at(words, 1).upper())
        _need(field is not None)
        setattr(model.options, field, case)

    return action


_register(b"UPPERCASE", _case_action(Case.UPPER, b"SIGANL"))  # the word is spelled so
_register(b"LOWERCASE", _case_action(Case.LOWER, b"SIGNAL"))


# Writing


def write_target(words: Words) -> tuple[bytes, bool, bool]:
    """File name, append flag and header flag of a write command."""
    name_position = len(words) - 1 if len(words) in (4, 5) else 2
    options = [word.upper() for word in words[2:name_position]]
    return _at(words, name_position), b"-APPEND" in options, b"-NOHEADER" not in options


def write_netlist(
    model: Model, language: str, file_name: bytes, append: bool, header: bool
) -> None:
    """Writes the netlist; a file that cannot be written is noted in the model."""
    model.options.write_header = header
    stream = OutStream(file_name)
    writers: dict[str, Callable[[OutStream, Options], object]] = {
        "verilog": lambda out, options: VerilogNetlister(out, options).write(model.netlist),
        "vhdl": lambda out, options: VhdlNetlister(out, options).write(model.netlist),
    }
    writers[language](stream, model.options)
    try:
        with open(file_name, "ab" if append else "wb") as file:
            file.write(stream.close())
    except OSError as error:
        model.file_errors.append((file_name, error))


def _write_action(language: str) -> Action:
    def action(model: Model, words: Words) -> None:
        file_name, append, header = write_target(words)
        _need(file_name != b"")
        write_netlist(model, language, file_name, append, header)

    return action


_register(b"WRITE VERILOG", _write_action("verilog"))
_register(b"WRITE VHDL", _write_action("vhdl"))
