"""Many objects in one call."""

from __future__ import annotations

from typing import Any, Callable, List

import orn_hdl
import pytest
from support import half_adder

FORMS: List[Callable[[List[str]], Any]] = [
    list, tuple, iter, lambda names: (name for name in names),
    lambda names: (sorted(set(names)), [sorted(set(names)).index(name) for name in names]),
]
try:
    import numpy
    FORMS += [numpy.array, lambda names: numpy.array(names, dtype=object),
              lambda names: numpy.array([name.encode() for name in names]),
              lambda names: (numpy.unique(names), numpy.unique(names, return_inverse=True)[1])]
except ImportError:
    numpy = None  # type: ignore[assignment]


@pytest.mark.parametrize("form", FORMS)
def test_forms_of_columns(form: Callable[[List[str]], Any]) -> None:
    d = half_adder()
    names = [f"X{i}" for i in range(7)]
    kinds = ["AND2", "XOR2"] * 3 + ["AND2"]
    assert d.add_instances(form(names), form(kinds)) == 7
    assert [d[name].component.name for name in names] == kinds
    assert d.add_nets(form(["N1(3:0)", "N2"])) == 2 and d["N1"].width == 4
    assert d.connect_many(form(["A", "B", "N1(2)"]), form(["X0", "X0", "X1"]), form(["I0", "I1", "O"])) == 3
    assert list(d.connections())[6:] == [("A", "X0", "I0"), ("B", "X0", "I1"), ("N1(2)", "X1", "O")]
    assert d.connect_many("C", form(["X2", "X3"]), "I0") == 2
    assert [pin.owner.name for pin in d["C"].pins] == ["U1", "X2", "X3"]


def test_what_is_refused() -> None:
    d = half_adder()
    with pytest.raises(orn_hdl.NameTakenError):
        d.add_instances(["X0", "U1", "X1"], "AND2")
    assert "X0" in d and "X1" not in d, "what was added before stays"
    with pytest.raises(orn_hdl.NotFoundError):
        d.add_instances(["X2"], "OR2")
    with pytest.raises(orn_hdl.NotFoundError):
        d.connect_many("A", "U1", ["X"])
    for columns in ((["Y0", "Y1"], ["AND2"]), (["Y2"], ["AND2", "AND2"]), ("Y3", "AND2")):
        with pytest.raises(ValueError):
            d.add_instances(*columns)
    for index in (2, -1, 2 ** 40):
        with pytest.raises(IndexError):
            d.add_instances((["Z0", "Z1"], [index]), "AND2")
    for wrong in ([1], [None], 7, (["A"], ["B"]), (["A"], [0.5])):
        with pytest.raises(TypeError):
            d.add_instances(wrong, "AND2")
    assert [u.name for u in d.instances] == ["U1", "U2", "X0", "Y0", "Y2"]


def test_connections_in_columns() -> None:
    d = half_adder()
    connections = d.connection_arrays()
    assert connections.nets == ["A", "B", "C", "S"] and connections.instances == ["U1", "U2"]
    assert connections.pins == ["I0", "I1", "O"]
    assert list(connections.net) == [0, 1, 2, 0, 1, 3] and list(connections.instance) == [0] * 3 + [1] * 3
    assert list(connections.pin) == [0, 1, 2] * 2
    if numpy is not None:
        net, _, _ = connections.numpy()
        assert numpy.bincount(net).tolist() == [2, 2, 1, 1] and net.dtype == numpy.int32
    empty = orn_hdl.Design().connection_arrays()
    assert empty.nets == [] and len(empty.net) == 0 and list(orn_hdl.Design().connections()) == []
