"""Engines and designs."""

from __future__ import annotations

import io
import os
import tempfile
import weakref
from typing import (IO, Any, Callable, Dict, Generic, Iterable, Iterator, List, Mapping, NamedTuple, Optional, Sequence,
                    Tuple, TypeVar, Union, overload)

from . import _bulk, _show
from ._attributes import Holder, key_of
from ._bulk import Column, Connections
from ._errors import ClosedError, Difference, NetlistError, NotFoundError
from ._kinds import BUS_SIGNAL, COMPONENT, INSTANCE, MODULE, SIGNAL
from ._objects import (NET_CLASSES, Bus, Component, Connection, Constant, Instance, Net, Pin, Width,
                       ranged_name)
from ._options import Options
from ._orn_hdl import Engine as NativeEngine
from ._orn_hdl import Model
from ._tool import run_tool

StrPath = Union[str, "os.PathLike[str]"]
Target = Union[StrPath, IO[str], IO[bytes]]
ObjectT = TypeVar("ObjectT", Component, Instance, Net)

VERILOG, VHDL = 0, 1


class Counts(NamedTuple):
    """How many there are of what."""

    components: int
    instances: int
    nets: int
    ports: int
    pins: int
    connected_pins: int


class Finding(NamedTuple):
    """Something that `Design.check` has found. `targets` are the standards and tools that mind it."""

    rule: str
    is_error: bool
    message: str
    notes: List[str]
    help: str
    targets: List[str]

    def __str__(self) -> str:
        return f"{'error' if self.is_error else 'warning'}: {self.message} [{self.rule}]"


class Objects(Generic[ObjectT]):
    """The components, instances, nets or ports of a design, in its order, and by name.

    Objects that are added during an iteration are found by it; of those that are removed, some may be left out.
    """

    __slots__ = ("_design", "_kind", "_ports_only")

    def __init__(self, design: Design, kind: int, ports_only: bool = False) -> None:
        self._design = design
        self._kind = kind
        self._ports_only = ports_only

    def __len__(self) -> int:
        return self._design._native.count(self._kind, self._ports_only)

    def __iter__(self) -> Iterator[ObjectT]:
        design = self._design
        for found in design._native.walk(self._kind):
            item: Any
            if self._kind == COMPONENT:
                item = Component(design, found)
            elif self._kind == INSTANCE:
                item = Instance(design, found)
            else:
                item = design._make_net(*found)
                if self._ports_only and not item.is_port:
                    continue
            yield item

    def __getitem__(self, name: str) -> ObjectT:
        """The object of that name, of a bus with or without its range. Raises NotFoundError."""
        found = self.get(name)
        if found is None:
            raise NotFoundError(f'there is no "{name}" among {self!r}')
        return found

    def get(self, name: str) -> Optional[ObjectT]:
        """The object of that name; None if there is none."""
        item: Any = self._design._find(self._kind, name)
        return None if item is None or (self._ports_only and not item.is_port) else item

    def __contains__(self, item: object) -> bool:
        name = item if isinstance(item, str) else getattr(item, "name", None)
        return name is not None and self.get(name) is not None

    def __repr__(self) -> str:
        what = {COMPONENT: "components", INSTANCE: "instances"}.get(
            self._kind, "ports" if self._ports_only else "nets")
        return f"<{len(self)} {what}>"


class Design(Holder):
    """One flat design: components, instances, nets, and the options with which it is written.

    >>> d = Design("half")
    >>> a, b = d.port("A", "in"), d.port("B", "in")
    >>> and2 = d.component("AND2", I0="in", I1="in", O="out")
    >>> u1 = d.instance("U1", and2, I0=a, I1=b, O=d.port("Y", "out"))
    >>> u1["O"].net
    <Net Y>

    A design of its own has an engine of its own, so designs can be worked on in threads of their own. While a
    long call runs, other threads of Python run; a call to the same engine from another thread raises a
    `BusyError`.
    """

    __slots__ = ("_engine", "_native", "_removals", "_removed", "_replaced", "_own_engine")

    def __init__(self, name: str = "top", *, source_file: str = "", engine: Optional[Engine] = None) -> None:
        self._removals = 0
        self._replaced = 0
        self._removed: Dict[Tuple[object, ...], int] = {}
        self._own_engine = engine is None
        self._engine = Engine() if engine is None else engine
        self._native: Model = self._engine._native.create(name, source_file)
        # An engine keeps the designs that it has made. A design with an engine of its own goes with its last
        # reference.
        if engine is None:
            self._engine._designs.append(weakref.ref(self))
        else:
            self._engine._designs.append(self._itself)
        self._born = 0

    def _itself(self) -> Design:
        return self

    @property
    def _design(self) -> Design:  # type: ignore[override]
        return self

    # What objects ask of their design.

    def _address(self) -> Tuple[int, str, str]:
        return (MODULE, "", "")

    def _key(self) -> Tuple[object, ...]:
        return (MODULE, "", "")

    def _model(self) -> Model:
        return self._native

    def _note_removal(self, key: Tuple[object, ...]) -> None:
        self._removals += 1
        self._removed[key] = self._removals

    def _note_replacement(self) -> None:
        self._removals += 1
        self._replaced = self._removals
        self._removed.clear()

    def _is_removed(self, key: Tuple[object, ...], born: int) -> bool:
        """Whether an object that was known `born` removals after the beginning has been removed since."""
        return born < self._replaced or self._removed.get(key, -1) > born

    def _make_net(self, signal_class: int, name: str) -> Net:
        if signal_class == BUS_SIGNAL:
            name = name.partition("(")[0]
        return NET_CLASSES[signal_class](self, name)

    def _bus_range(self, name: str) -> Optional[str]:
        """The range of a bus as it stands in names; None when there is no such bus, or no design."""
        try:
            found = self._native.find(SIGNAL, name)
        except ClosedError:
            return None
        return None if found is None else found[1][len(name):]

    def _find(self, kind: int, name: str) -> Union[Component, Instance, Net, None]:
        found = self._native.find(kind, name)
        if found is None:
            return None
        if kind == COMPONENT:
            return Component(self, found[1])
        return Instance(self, found[1]) if kind == INSTANCE else self._make_net(*found)

    def _name_of(self, net: Union[Net, str, Sequence[Union[Net, str]]]) -> str:
        """The name by which the library knows a net, or a concatenation."""
        if isinstance(net, str):
            found = None if net[-1:] == ")" else self._native.find(SIGNAL, net)
            return net if found is None else found[1]
        if isinstance(net, Net):
            if net._design is not self:
                raise ValueError(f"{net!r} belongs to another design")
            net._model()
            return net.full_name if isinstance(net, Bus) else net._name
        return ",".join(self._name_of(member) for member in net)

    # The design itself.

    @property
    def engine(self) -> Engine:
        """The engine that the design belongs to."""
        return self._engine

    @property
    def name(self) -> str:
        """The name of the module or entity."""
        return self._native.name()

    @name.setter
    def name(self, name: str) -> None:
        self._native.set_name(name)

    @property
    def source_file(self) -> str:
        """The file from which the design comes; empty when it is not known."""
        return self._native.source_file()

    @source_file.setter
    def source_file(self, name: str) -> None:
        self._native.set_source_file(name)

    @property
    def options(self) -> Options:
        """The output options."""
        return Options(self._native)

    @property
    def components(self) -> Objects[Component]:
        """The components."""
        return Objects(self, COMPONENT)

    @property
    def instances(self) -> Objects[Instance]:
        """The instances."""
        return Objects(self, INSTANCE)

    @property
    def nets(self) -> Objects[Net]:
        """The nets and buses, ports among them; without slices, bits and concatenations."""
        return Objects(self, SIGNAL)

    @property
    def ports(self) -> Objects[Net]:
        """The nets and buses that are ports."""
        return Objects(self, SIGNAL, ports_only=True)

    def counts(self) -> Counts:
        """How many components, instances, nets, ports and pins there are."""
        return Counts(*self._native.counts())

    def get(self, name: str) -> Union[Component, Instance, Net, None]:
        """The component, instance or net of that name; None if there is none."""
        return self._find(SIGNAL, name) or self._find(INSTANCE, name) or self._find(COMPONENT, name)

    def __getitem__(self, name: str) -> Any:
        """The component, instance or net of that name, a bus with or without its range; they share one name
        space. Raises NotFoundError, which is a KeyError."""
        found = self.get(name)
        if found is None:
            raise NotFoundError(f'the design "{self.name}" has no "{name}"')
        return found

    def __contains__(self, name: str) -> bool:
        return self.get(name) is not None

    def close(self) -> None:
        """Destroys the design. Whatever is done with it or its objects then raises a ClosedError."""
        if self._own_engine:
            self._engine.close()
        else:
            self._engine.remove(self)

    def __enter__(self) -> Design:
        return self

    def __exit__(self, *exception: object) -> None:
        self.close()

    def __repr__(self) -> str:
        try:
            return f"<Design {self.name}>"
        except ClosedError:
            return "<Design, closed>"

    def __eq__(self, other: object) -> bool:
        return self is other

    def __hash__(self) -> int:
        return id(self)

    # Building.

    def component(self, name: str, **pins: Union[str, Tuple[str, Width]]) -> Component:
        """Adds a component: `d.component("REG4", CLK="in", D=("in", 4), Q=("out", (3, 0)))`.

        The direction of each pin is "in", "out", "inout" or a longer form; a width is a number of bits or a pair
        of indices. `Component.pin` adds pins whose names are no identifiers of Python. Raises NameTakenError and
        InvalidValueError.
        """
        self._native.add_component(name)
        component = Component(self, name)
        for pin, form in pins.items():
            direction, width = (form, None) if isinstance(form, str) else form
            component.pin(pin, direction, width)
        return component

    @overload
    def port(self, name: str, direction: str, width: Union[int, Tuple[int, int]]) -> Bus: ...
    @overload
    def port(self, name: str, direction: str, width: None = None) -> Any: ...
    def port(self, name: str, direction: str, width: Width = None) -> Any:
        """Declares a port; a `Bus` if it has a width or its name a range.

        `direction` is "in", "out", "inout" or a longer form. `width` is a number of bits, 8 for (7:0), or a pair
        of indices, (0, 7) for (0:7). Raises InvalidValueError and NameTakenError.
        """
        self._native.add_port(ranged_name(name, width), direction)
        return self.nets[ranged_name(name, width)]

    @overload
    def net(self, name: str, width: Union[int, Tuple[int, int]]) -> Bus: ...
    @overload
    def net(self, name: str, width: None = None) -> Any: ...
    def net(self, name: str, width: Width = None) -> Any:
        """Declares a net; a `Bus` if it has a width or its name a range. Raises NameTakenError."""
        self._native.add_signal(ranged_name(name, width))
        return self.nets[ranged_name(name, width)]

    def instance(self, name: str, component: Union[Component, str], **nets: Connection) -> Instance:
        """Places a component and connects its pins, as `Pin.connect` does; others stay open.

        Raises NameTakenError, and NotFoundError for a component or a pin that is not there. If a connection
        fails, the instance and the connections before it stay.
        """
        self._native.add_instance(name, component if isinstance(component, str) else component.name)
        instance = Instance(self, name)
        instance.connect(**nets)
        return instance

    def connect(self, net: Connection, *pins: Pin) -> None:
        """Connects pins to a net, as `Pin.connect` does."""
        for pin in pins:
            pin.connect(net)

    def assign(self, first: Union[Net, str], second: Union[Net, str]) -> None:
        """Makes an assignment: the second net drives the first one."""
        self._native.add_alias(self._name_of(first), self._name_of(second))

    def tie(self, net: Union[Net, str], value: Union[str, int, Constant]) -> None:
        """Ties a net to a constant. The net is declared if there is none of the name; the value is not
        checked."""
        text = value.value if isinstance(value, Constant) else str(value)
        self._native.tie_signal(self._name_of(net), text)

    # Commands.

    def execute(self, line: str) -> None:
        """Executes a line of commands, as a command file has it. Raises CommandSyntaxError, or what the command
        is refused with."""
        self._native.execute(line)

    def read_commands(self, path: StrPath) -> None:
        """Executes the lines of a command file. An `Error` has the line's number and text; the lines before it
        stay done. Raises OSError if the file cannot be read."""
        self._native.read_commands(os.fspath(path))

    def commands(self) -> str:
        """The commands from which the design and its options come, one a line. Raises InexpressibleError."""
        return self._native.commands()

    def write_commands(self, path: StrPath) -> None:
        """Writes the commands to a file. Raises InexpressibleError and OSError."""
        self._native.write_commands(os.fspath(path))

    # Netlists.

    def _write(self, language: int, target: Target, append: bool, header: bool) -> None:
        if isinstance(target, (str, os.PathLike)):
            self._native.write(language, os.fspath(target), append, header)
            return
        data = self._written(language, header)
        if isinstance(target, (io.RawIOBase, io.BufferedIOBase)):
            target.write(data)
        else:
            target.write(data.decode(errors="surrogateescape"))  # type: ignore[arg-type]

    def _written(self, language: int, header: bool) -> bytes:
        """What the writer writes to a file, which breaks lines as no text in memory does."""
        with tempfile.TemporaryDirectory() as folder:
            path = os.path.join(folder, "netlist")
            self._native.write(language, path, False, header)
            with open(path, "rb") as file:
                return file.read()

    def write_verilog(self, target: Target, *, append: bool = False, header: bool = True) -> None:
        """Writes the Verilog netlist to a file, given by its path, or open for text or bytes.

        A file that exists is replaced when the netlist is complete, or appended to. Raises OSError; ProofError and
        LegalError if the options ask for what cannot be.
        """
        self._write(VERILOG, target, append, header)

    def write_vhdl(self, target: Target, *, append: bool = False, header: bool = True) -> None:
        """Writes the VHDL netlist, as `write_verilog` does."""
        self._write(VHDL, target, append, header)

    def to_verilog(self, *, header: bool = False) -> str:
        """The Verilog netlist as a text, without the header, which has the time, unless it is asked for."""
        return self._written(VERILOG, header).decode(errors="surrogateescape")

    def to_vhdl(self, *, header: bool = False) -> str:
        """The VHDL netlist as a text, without the header, which has the time, unless it is asked for."""
        return self._written(VHDL, header).decode(errors="surrogateescape")

    def read_verilog(self, path: StrPath, *, top: str = "", libraries: Iterable[StrPath] = (),
                     include_folders: Iterable[StrPath] = (), macros: Optional[Mapping[str, str]] = None,
                     literal_names: bool = False, infer: bool = False,
                     dont_cares: bool = False) -> Dict[str, str]:
        """Reads a structural Verilog netlist, which takes the place of the design.

        `top` is the module; by default the only one that no other instantiates. `libraries` declare the cells.
        With `infer`, cells that no file declares get their pins from the netlist. With `dont_cares`, bits x become
        don't cares, and the option of that name is set. Returns the names that had to be replaced. Raises
        NetlistError, and the design stays as it is.
        """
        defined = dict(macros or {})
        renamed = self._native.read_verilog(
            os.fspath(path), top, [os.fspath(file) for file in libraries],
            [os.fspath(folder) for folder in include_folders], list(defined), list(defined.values()),
            literal_names, infer, dont_cares)
        self._note_replacement()
        return dict(renamed)

    def read_vhdl(self, path: StrPath, *, top: str = "", libraries: Iterable[StrPath] = (),
                  literal_names: bool = False, dont_cares: bool = False) -> Dict[str, str]:
        """Reads a structural VHDL netlist, which takes the place of the design.

        `top` is the entity, or "ENTITY(ARCHITECTURE)". `libraries` declare the components. With `dont_cares`, bits
        'X' and '-' become don't cares, and the option of that name is set. Returns the names that had to be replaced.
        Raises NetlistError, and the design stays as it is.
        """
        renamed = self._native.read_vhdl(os.fspath(path), top, [os.fspath(file) for file in libraries],
                                         literal_names, dont_cares)
        self._note_replacement()
        return dict(renamed)

    def import_json(self, path: StrPath, *, top: str = "", cells: Iterable[StrPath] = (),
                    attributes: bool = False, comments: bool = False, x_as: str = "") -> None:
        """Imports a JSON netlist as Yosys writes it, by the tool; it takes the place of the design.

        `top` is the module, `cells` are files that declare cell types. `x_as` is what x and z become: "0", "1", or
        "-" for don't cares, which sets the option `dont_cares`. Raises NetlistError with the tool's message, and the
        design stays as it is; FileNotFoundError if the tool is not installed.
        """
        with tempfile.TemporaryDirectory() as folder:
            commands = os.path.join(folder, "design.cmd")
            arguments = ["import", os.fspath(path), "--from", "json", "-o", commands]
            arguments += ["--top", top] if top else []
            for file in cells:
                arguments += ["--cells", os.fspath(file)]
            arguments += ["--attributes"] if attributes else []
            arguments += ["--comments"] if comments else []
            arguments += ["--x-as", x_as] if x_as else []
            done = run_tool(*arguments)
            if done.returncode != 0:
                raise NetlistError(done.stderr.rstrip("\n"), file=os.fspath(path))
            self._native.clear()
            self._note_replacement()
            self._native.read_commands(commands)
            if x_as == "-":
                self.options.dont_cares = True

    def check(self, *targets: str) -> List[Finding]:
        """What standards and tools make of the netlists that would be written; nothing is changed.

        `targets` are names such as "vhdl-93" or "yosys", all of them by default. Raises ValueError for any other.
        """
        return [Finding(*found) for found in self._native.check(list(targets))]

    def find_illegal(self) -> List[Finding]:
        """What keeps a legal netlist from being written, however names and constants are mended."""
        return [Finding(*found) for found in self._native.find_illegal()]

    def verify_verilog(self, path: StrPath) -> List[Difference]:
        """Reads a Verilog netlist that was written of the design and compares: an empty list means that it says
        what the design does. The design is prepared as for a write. Raises OSError or Error if the file cannot be
        read."""
        return [Difference(*found) for found in self._native.verify(VERILOG, os.fspath(path))]

    def verify_vhdl(self, path: StrPath) -> List[Difference]:
        """Compares a VHDL netlist with the design, as `verify_verilog` does."""
        return [Difference(*found) for found in self._native.verify(VHDL, os.fspath(path))]

    # Many at once.

    def add_instances(self, names: Column, components: Column) -> int:
        """Adds many instances and returns how many.

        A column is one name for every row, an iterable or an array of NumPy of names, or a pair of names and the
        index of one for each row: `d.add_instances(names, (["INV", "AND2"], kinds))`. Raises NameTakenError,
        NotFoundError, IndexError for an index that is out of range, ValueError for columns that differ in length;
        what was added before stays.
        """
        return self._native.add_instances(_bulk.column(names), _bulk.column(components))

    def add_nets(self, names: Column) -> int:
        """Declares many nets and returns how many; a column is as for `add_instances`."""
        return self._native.add_signals(_bulk.column(names))

    def connect_many(self, nets: Column, instances: Column, pins: Column) -> int:
        """Connects a net to a pin of an instance for each row, and returns how many there are; columns are as for
        `add_instances`. Nets are declared on their first use. Raises NotFoundError, and what `add_instances`
        raises for columns."""
        return self._native.connect_many(_bulk.column(nets), _bulk.column(instances), _bulk.column(pins))

    def connections(self) -> Iterator[Tuple[str, str, str]]:
        """The names of net, instance and pin for each connected pin of an instance."""
        return self._native.walk_connections()

    def connection_arrays(self) -> Connections:
        """All connections in columns of indices into lists of names."""
        nets, instances, pins, net, instance, pin = self._native.connections()
        return Connections(nets, instances, pins, *map(_bulk.numbers, (net, instance, pin)))

    # Showing.

    def graph(self) -> Any:
        """The design as a `networkx.MultiDiGraph`, which needs networkx. Instances and nets are nodes, with the
        attributes `kind`, and `component` or `width` and `direction`; the pins are edges, from nets to instances
        for inputs."""
        return _show.graph(self)

    def to_pandas(self) -> Any:
        """The connections as a `pandas.DataFrame`, which needs pandas, with the columns net, instance, component,
        pin and direction."""
        return _show.to_pandas(self)

    def _repr_svg_(self) -> Optional[str]:
        """A picture for a notebook, of a small design, if Graphviz is installed."""
        return _show.draw(self)

    def _repr_html_(self) -> Optional[str]:
        """A table of counts for a notebook, where there is no picture."""
        return None if _show.can_draw(self) else _show.table(self)


class Engine:
    """Holds designs by name. Designs of one engine belong to one thread at a time.

    >>> with Engine() as engine:
    ...     top = engine.design("top")
    ...     [design.name for design in engine]
    ['top']
    """

    def __init__(self) -> None:
        self._native = NativeEngine()
        self._designs: List[Callable[[], Optional[Design]]] = []

    def design(self, name: str, source_file: str = "") -> Design:
        """Makes a design. Raises NameTakenError if there is one of that name."""
        return Design(name, source_file=source_file, engine=self)

    def remove(self, design: Design) -> None:
        """Destroys a design. Nothing happens if it is not one of this engine."""
        self._native.remove(design._native)
        self._designs = [known for known in self._designs if known() is not design]

    def __getitem__(self, name: str) -> Design:
        """The design of that name. Raises NotFoundError."""
        for design in self:
            if key_of(design.name) == key_of(name):
                return design
        raise NotFoundError(f'the engine has no design "{name}"')

    def __contains__(self, name: str) -> bool:
        return any(key_of(design.name) == key_of(name) for design in self)

    def __iter__(self) -> Iterator[Design]:
        return iter([design for design in (known() for known in self._designs) if design is not None])

    def __len__(self) -> int:
        return sum(1 for _ in self)

    def close(self) -> None:
        """Destroys all designs. An engine that is closed makes no more designs."""
        self._native.close()
        self._designs.clear()

    @property
    def is_closed(self) -> bool:
        """Whether the engine has been closed."""
        return self._native.is_closed()

    def __enter__(self) -> Engine:
        return self

    def __exit__(self, *exception: object) -> None:
        self.close()

    def __repr__(self) -> str:
        return "<Engine, closed>" if self.is_closed else f"<Engine with {len(self)} designs>"
