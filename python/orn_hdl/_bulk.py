"""Columns of names for the operations on many objects, and the connections of a design in columns."""

from __future__ import annotations

from array import array
from typing import Any, Iterable, List, NamedTuple, Sequence, Tuple, Union

# One name for every row, a name a row, or the names with the index of one for each row.
Column = Union[str, Iterable[str], Tuple[Sequence[str], Any]]


def _indices(values: Any) -> bytes:
    """Indices as 64-bit numbers. An array of NumPy is converted as a whole."""
    if hasattr(values, "astype"):
        if values.dtype.kind not in "iu":
            raise TypeError("indices are integers")
        return bytes(values.astype("=i8").tobytes())
    return array("q", values).tobytes()


def column(values: Column) -> Any:
    """A column as the extension takes it."""
    if isinstance(values, str):
        return values
    if hasattr(values, "dtype"):
        rows: Any = values
        names = rows.tolist()
        return [name.decode() for name in names] if rows.dtype.kind == "S" else names
    if not isinstance(values, tuple):
        return values
    if len(values) != 2 or isinstance(values[0], str) or isinstance(values[1], str):
        return list(values)
    names, indices = values
    return (list(column(names)), _indices(indices))


class Connections(NamedTuple):
    """All connections of a design in columns, one row for each connected pin of an instance. The names stand in
    lists; `net`, `instance` and `pin` hold, row by row, the indices into `nets`, `instances` and `pins`. They
    are arrays of the standard library, which NumPy takes without a copy: `numpy.asarray(c.net)`."""

    nets: List[str]
    instances: List[str]
    pins: List[str]
    net: array[int]
    instance: array[int]
    pin: array[int]

    def numpy(self) -> Tuple[Any, ...]:
        """The three columns of indices as arrays of NumPy, without a copy."""
        import numpy as np
        return tuple(np.frombuffer(part, dtype=np.int32) for part in (self.net, self.instance, self.pin))


def numbers(data: bytes) -> array[int]:
    """32-bit numbers as an array."""
    values = array("i")
    values.frombytes(data)
    return values
