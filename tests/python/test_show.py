"""A design shows itself."""

from __future__ import annotations

import shutil

import orn_hdl
import pytest
from support import half_adder


def test_a_table_of_counts(monkeypatch: pytest.MonkeyPatch) -> None:
    monkeypatch.setenv("PATH", "")
    d = half_adder()
    d.name = "<half>"
    table = d._repr_html_()
    assert table is not None and "&lt;half&gt;" in table and d._repr_svg_() is None
    assert "<td>instances</td><td style='text-align:right'>2</td>" in table


@pytest.mark.skipif(shutil.which("dot") is None, reason="Graphviz is not installed")
def test_a_picture() -> None:
    d = half_adder()
    picture = d._repr_svg_()
    assert picture is not None and "<svg" in picture and "AND2" in picture
    assert d._repr_html_() is None, "a notebook prefers HTML"
    d.add_instances([f"X{i}" for i in range(200)], "AND2")
    assert d._repr_svg_() is None and d._repr_html_() is not None


def test_a_design_that_no_command_expresses_has_no_picture() -> None:
    d = half_adder()
    d["AND2"].remove()
    assert d._repr_svg_() is None


def test_graph() -> None:
    networkx = pytest.importorskip("networkx")
    d = half_adder()
    d.port("UNUSED", "in", 3)
    graph = d.graph()
    assert set(graph.nodes) == {"A", "B", "C", "S", "U1", "U2", "UNUSED"}
    assert graph.nodes["U1"] == {"kind": "instance", "component": "AND2"}
    assert graph.nodes["A"] == {"kind": "net", "width": 1, "direction": "input"}
    assert graph.nodes["UNUSED"]["width"] == 3
    assert networkx.has_path(graph, "A", "S") and not networkx.has_path(graph, "C", "A")
    assert graph.get_edge_data("A", "U1")[0] == {"pin": "I0"}


def test_pandas() -> None:
    pytest.importorskip("pandas")
    d = half_adder()
    frame = d.to_pandas()
    assert list(frame.columns) == ["net", "instance", "component", "pin", "direction"]
    rows = [tuple(map(str, row)) for row in frame.itertuples(index=False)]
    assert rows[2] == ("C", "U1", "AND2", "O", "output") and len(rows) == 6
    assert [row[:2] + row[3:4] for row in rows] == list(d.connections())
    d["AND2"].remove()
    assert len(d.to_pandas()) == 6
    assert len(orn_hdl.Design().to_pandas()) == 0
