"""A design as a picture, a table, a graph or a data frame."""

from __future__ import annotations

import html
import os
import shutil
import tempfile
from typing import TYPE_CHECKING, Any, Dict, Optional, Tuple

from ._errors import Error
from ._tool import find_tool, run_tool

if TYPE_CHECKING:
    from ._design import Design

# Graphviz takes a second for so many.
MOST_DRAWN = 150


def can_draw(design: Design) -> bool:
    """Whether the design is small, and the tool and Graphviz are there to draw it."""
    return (len(design.instances) <= MOST_DRAWN and find_tool() is not None
            and shutil.which("dot") is not None)


def draw(design: Design) -> Optional[str]:
    """The picture as SVG; None if the design cannot be drawn."""
    if not can_draw(design):
        return None
    with tempfile.TemporaryDirectory() as folder:
        commands = os.path.join(folder, "design.cmd")
        picture = os.path.join(folder, "design.svg")
        try:
            design.write_commands(commands)
        except Error:
            return None
        if run_tool("draw", commands, "-o", picture).returncode != 0:
            return None
        with open(picture, encoding="utf-8") as file:
            return file.read()


def table(design: Design) -> str:
    """The counts as a table in HTML."""
    rows = "".join(f"<tr><td>{html.escape(name.replace('_', ' '))}</td>"
                   f"<td style='text-align:right'>{count:,}</td></tr>"
                   for name, count in design.counts()._asdict().items())
    return f"<table><caption>{html.escape(design.name)}</caption>{rows}</table>"


def graph(design: Design) -> Any:
    """The design as a graph of networkx."""
    import networkx as nx  # type: ignore[import]
    result = nx.MultiDiGraph(name=design.name)
    for instance in design.instances:
        component = instance.component
        result.add_node(instance.name, kind="instance",
                        component=None if component is None else component.name)
        for pin in instance.pins:
            net = pin.net
            if net is None:
                continue
            if net.name not in result:
                result.add_node(net.name, kind="net", width=net.width, direction=net.direction)
            if pin.direction != "output":
                result.add_edge(net.name, instance.name, pin=pin.name)
            if pin.direction != "input":
                result.add_edge(instance.name, net.name, pin=pin.name)
    for port in design.ports:
        if port.name not in result:
            result.add_node(port.name, kind="net", width=port.width, direction=port.direction)
    return result


def to_pandas(design: Design) -> Any:
    """The connections as a data frame."""
    import pandas as pd  # type: ignore[import]
    connections = design.connection_arrays()
    net, instance, pin = connections.numpy()
    components = [u.component for u in design.instances]
    names = ["" if component is None else component.name for component in components]
    distinct = {name: i for i, name in enumerate(dict.fromkeys(names))}
    of_instance = pd.Series([distinct[name] for name in names], dtype="int32").to_numpy()
    frame = pd.DataFrame({
        "net": pd.Categorical.from_codes(net, categories=connections.nets),
        "instance": pd.Categorical.from_codes(instance, categories=connections.instances),
        "component": pd.Categorical.from_codes(of_instance[instance], categories=list(distinct)),
        "pin": pd.Categorical.from_codes(pin, categories=connections.pins)})
    directions: Dict[Tuple[str, str], str] = {}
    for row in frame.drop_duplicates(["component", "pin"]).itertuples():
        directions[(row.component, row.pin)] = design.instances[row.instance][row.pin].direction
    frame["direction"] = pd.Categorical(
        [directions[key] for key in zip(frame["component"], frame["pin"])],
        categories=["input", "output", "bidirectional"])
    return frame
