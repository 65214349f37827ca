"""The output options of a design."""

from __future__ import annotations

from typing import TYPE_CHECKING, Any, Generic, List, Optional, Type, TypeVar, overload

from ._kinds import COMPONENT, INSTANCE, SIGNAL

if TYPE_CHECKING:
    from ._orn_hdl import Model

T = TypeVar("T")

DIALECTS = ("QSN", "EXEMPLAR", "SYNPLICITY", "SYNOPSYS", "VERILOG2001", "PRECISION")
LETTER_CASES = ("keep", "upper", "lower")


class _Option(Generic[T]):
    """An option of the library, read and set by its name."""

    def __init__(self, text: str) -> None:
        self.__doc__ = text

    def __set_name__(self, owner: Type[Options], name: str) -> None:
        self._name = name

    @overload
    def __get__(self, options: None, owner: Type[Options]) -> _Option[T]: ...
    @overload
    def __get__(self, options: Options, owner: Type[Options]) -> T: ...
    def __get__(self, options: Optional[Options], owner: Type[Options]) -> Any:
        return self if options is None else options._model.option(self._name)

    def __set__(self, options: Options, value: T) -> None:
        options._model.set_option(self._name, list(value) if isinstance(value, tuple) else value)


class _LetterCase:
    """How names of a kind are written in Verilog."""

    def __init__(self, kind: int, text: str) -> None:
        self._kind = kind
        self.__doc__ = text

    def __get__(self, options: Optional[Options], owner: Type[Options]) -> str:
        if options is None:
            return ""
        return LETTER_CASES[options._model.letter_case(self._kind)]

    def __set__(self, options: Options, value: str) -> None:
        if value not in LETTER_CASES:
            raise ValueError(f"a letter case is one of {', '.join(LETTER_CASES)}")
        options._model.set_letter_case(self._kind, LETTER_CASES.index(value))


class Options:
    """The output options of a design; what is set counts from the next write on.

    A list is a copy: assign one to change it.
    """

    __slots__ = ("_model",)

    def __init__(self, model: Model) -> None:
        self._model = model

    legal = _Option[bool]("Write a netlist that every tool takes, or nothing.")
    escape_names = _Option[bool]("A legal netlist escapes names where that is enough.")
    verify = _Option[bool]("Read each netlist back and compare it with the design before it replaces its file.")
    dont_cares = _Option[bool]('The digit "-" of a constant is a don\'t care, x in Verilog.')
    threads = _Option[int]("How many threads may write a netlist or read a command file; 0 is what the system gives.")
    application = _Option[str]("The application that the header names.")
    command = _Option[str]("The command that the header shows.")
    device = _Option[str]("The device that the header names.")
    purpose = _Option[str]("The purpose that the header shows.")
    reference = _Option[str]("The reference that the header shows.")
    suppress_configuration = _Option[bool]("Omit the configuration from VHDL.")
    suppress_component = _Option[bool]("Omit the component declarations from VHDL.")
    flatten_bus = _Option[bool]("A flag without an effect on the output.")
    use_default_library = _Option[bool]("Write the library and use clauses for IEEE and KESTRA in VHDL.")
    use_attribute_types = _Option[bool]("Write VHDL attributes with their own types instead of strings.")
    open_pins = _Option[bool]("Leave open input pins open in VHDL.")
    libraries = _Option[List[str]]("The libraries of the VHDL netlist.")
    use_clauses = _Option[List[str]]("The use clauses of the VHDL netlist.")
    includes = _Option[List[str]]("The files that the Verilog netlist includes.")

    component_case = _LetterCase(COMPONENT, 'How Verilog writes names of components: "keep", "upper", "lower".')
    instance_case = _LetterCase(INSTANCE, 'How Verilog writes names of instances: "keep", "upper", "lower".')
    net_case = _LetterCase(SIGNAL, 'How Verilog writes names of nets: "keep", "upper", "lower".')

    @property
    def synthesis(self) -> str:
        """The dialect of synthesis attributes in Verilog, one of `DIALECTS`."""
        return DIALECTS[self._model.synthesis()]

    @synthesis.setter
    def synthesis(self, dialect: str) -> None:
        if dialect.upper() not in DIALECTS:
            raise ValueError(f"a dialect is one of {', '.join(DIALECTS)}")
        self._model.set_synthesis(dialect)
