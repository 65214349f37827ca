"""Prints the reference of the package, docs/python-reference.md, from its docstrings and annotations:
python3 share/generator/python_reference.py >docs/python-reference.md, with the package on PYTHONPATH."""

from __future__ import annotations

import inspect
import re
import textwrap
from typing import Any, Iterator, List, Tuple

import orn_hdl

SECTIONS = [
    ("Designs", ["Design", "Engine", "Options", "Objects", "Counts"]),
    ("What a design holds", ["Holder", "Component", "Instance", "Pin", "Net", "Bus", "Slice", "Bit", "Compound",
                             "Constant", "Attribute", "Attributes"]),
    ("Results", ["Finding", "Difference", "Connections"]),
    ("Functions", ["catalogue", "find_tool", "run_tool"]),
    ("Exceptions", [name for name in sorted(orn_hdl.__all__)
                    if isinstance(getattr(orn_hdl, name), type)
                    and issubclass(getattr(orn_hdl, name), Exception)]),
]
SHOWN_OPERATORS = ("__getitem__", "__iter__", "__len__")


def signature(function: Any, name: str) -> str:
    """The call as one writes it, without annotations of the module typing."""
    parameters = [parameter.replace(annotation=inspect.Parameter.empty)
                  for parameter in inspect.signature(function).parameters.values() if parameter.name != "self"]
    return f"{name}{inspect.Signature(parameters)}"


def text_of(thing: Any) -> str:
    """The docstring as a paragraph or several, examples as indented blocks."""
    paragraphs = inspect.cleandoc(thing.__doc__ or "").strip().split("\n\n")
    return "\n\n".join(textwrap.indent(text, "    ") if text.startswith(">>>") else text for text in paragraphs)


def items_of(kind: type) -> Iterator[Tuple[str, str]]:
    """The members that the class itself has, each with its head and text."""
    fields = getattr(kind, "_fields", ())
    for name, member in vars(kind).items():
        if name in fields or (name.startswith("_") and name not in SHOWN_OPERATORS):
            continue
        if isinstance(member, property):
            if member.__doc__:
                yield f"`{name}`" + ("" if member.fset is None else ", can be set"), text_of(member)
        elif inspect.isfunction(member):
            if member.__doc__:
                yield f"`{signature(member, name)}`", text_of(member)
        elif hasattr(member, "__set__") and not inspect.ismemberdescriptor(member) and member.__doc__:
            yield f"`{name}`, can be set", text_of(member)


def show_class(name: str, kind: type) -> List[str]:
    """The section of a class."""
    bases = [base.__name__ for base in kind.__bases__
             if not base.__name__.startswith("_") and base.__name__ not in ("object", "Generic", "tuple")]
    lines = [f"### {name}" + (f" ({', '.join(bases)})" if bases else ""), "", text_of(kind), ""]
    fields = getattr(kind, "_fields", ())
    if fields:
        lines += ["Fields: " + ", ".join(f"`{field}`" for field in fields) + ".", ""]
    for head, text in items_of(kind):
        first, _, rest = text.partition("\n\n")
        lines.append(f"- {head}: " + re.sub(r"\s+", " ", first))
        lines += ["", *(("  " + line).rstrip() for line in rest.splitlines()), ""] if rest else []
    return lines + [""]


def page() -> str:
    """The whole page."""
    lines = ["# The Python package, class by class", "",
             "[python.md](python.md) introduces the package. This page is made from its docstrings.", ""]
    for title, names in SECTIONS:
        lines += [f"## {title}", ""]
        for name in names:
            thing = getattr(orn_hdl, name)
            if isinstance(thing, type):
                lines += show_class(name, thing)
            else:
                lines += [f"### `{signature(thing, name)}`", "", text_of(thing), ""]
    return re.sub(r"\n{3,}", "\n\n", "\n".join(lines)).strip() + "\n"


if __name__ == "__main__":
    print(page(), end="")
