"""What the documentation says of the package: the reference is that of the docstrings, every public thing has
one, and their examples do what they show."""

from __future__ import annotations

import doctest
import importlib
import inspect
import pkgutil
import sys

import orn_hdl
from support import PROJECT

sys.path.insert(0, str(PROJECT / "share" / "generator"))
import python_reference as reference  # noqa: E402


def test_the_reference_is_current() -> None:
    page = PROJECT / "docs" / "python-reference.md"
    assert page.read_text(encoding="utf-8") == reference.page(), "run share/generator/python_reference.py"


def test_the_reference_has_everything() -> None:
    shown = [name for _, names in reference.SECTIONS for name in names]
    assert sorted(shown) == sorted(orn_hdl.__all__)


def test_docstrings() -> None:
    for name in orn_hdl.__all__:
        thing = getattr(orn_hdl, name)
        assert inspect.getdoc(thing), name
        if isinstance(thing, type):
            for member_name, member in vars(thing).items():
                if not member_name.startswith("_") and (inspect.isfunction(member) or isinstance(member, property)):
                    assert member.__doc__ or any(inspect.getdoc(getattr(base, member_name, None))
                                                 for base in thing.__mro__[1:]), f"{name}.{member_name}"


def test_examples_of_docstrings() -> None:
    tried = 0
    for module in pkgutil.iter_modules(orn_hdl.__path__, "orn_hdl."):
        if module.name not in ("orn_hdl._orn_hdl", "orn_hdl.__main__"):
            result = doctest.testmod(importlib.import_module(module.name))
            assert result.failed == 0
            tried += result.attempted
    assert tried > 5
