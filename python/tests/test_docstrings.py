"""Every public member has a docstring with an example that runs."""

import doctest
import enum
import inspect

import pytest
import vorn
import vorn.frame
import vorn.geometry

MODULES = [vorn, vorn.geometry, vorn.frame]

#: What fields and values of a class say stands in the docstring of the class.
FIELDS = (enum.Enum, type(vorn.FitResult.number), type(vorn.geometry.ElemType.ARC))


def is_ours(cls, name):
    """Not inherited from the standard library, nor made by pybind11 for every enumeration."""
    owner = next(c for c in cls.__mro__ if name in vars(c))
    return owner.__module__.startswith("vorn") and not (
        hasattr(cls, "__members__") and name in ("name", "value"))


def attributes(cls):
    """The public methods and properties of a class, from wherever it inherits them in vorn."""
    for name in dir(cls):
        member = inspect.getattr_static(cls, name)
        if name.startswith("_") or isinstance(member, FIELDS):
            continue
        if isinstance(member, (classmethod, staticmethod)):
            member = member.__func__
        is_method = inspect.isroutine(member) or isinstance(member, property)
        if is_method and is_ours(cls, name):
            yield name, member


def public_members():
    """Names and values of all that a user may call or look at."""
    found = {}
    for module in MODULES:
        for name in module.__all__:
            member = getattr(module, name)
            if not (inspect.isroutine(member) or inspect.isclass(member)):
                continue
            found[f"{module.__name__}.{name}"] = member
            if inspect.isclass(member):
                found.update((f"{module.__name__}.{name}.{attribute}", value)
                             for attribute, value in attributes(member))
    return found


MEMBERS = public_members()


def names_for(name):
    """What an example may use without an import: what its own module has."""
    module = max((m for m in MODULES if name.startswith(m.__name__ + ".")),
                 key=lambda m: len(m.__name__))
    return {**vars(module), "vorn": vorn}


def test_the_list_is_whole():
    assert {"vorn.fit", "vorn.Contour", "vorn.Contour.area", "vorn.Contour.from_wkt",
            "vorn.Contour.to_svg", "vorn.Contour.append_arc", "vorn.Contour.verdict",
            "vorn.Arc.length", "vorn.geometry.Matrix.mxv", "vorn.geometry.Elem.segment",
            "vorn.geometry.Elem.radius", "vorn.frame.fit", "vorn.FileError"} <= set(MEMBERS)
    assert "vorn.Contour.index" not in MEMBERS, "that is of the standard library"
    assert len(MEMBERS) > 110


@pytest.mark.parametrize("name", MEMBERS)
def test_its_example_has_its_own_section_behind_others(name):
    """Else the reference would show it as one more parameter or error."""
    text = inspect.getdoc(MEMBERS[name])
    if "\n------" in text:
        before, _ = text.split(">>>", 1)
        assert before.endswith("Examples\n--------\n")


@pytest.mark.parametrize("name", MEMBERS)
def test_it_has_an_example_that_runs(name):
    text = inspect.getdoc(MEMBERS[name])
    assert text, "there is no docstring"
    example = doctest.DocTestParser().get_doctest(text, names_for(name), name, None, 0)
    assert example.examples, "the docstring has no example"
    runner = doctest.DocTestRunner()
    runner.run(example)
    assert runner.failures == 0
