"""What help() shows, the stubs, and the page about the module."""

import ast
import inspect
import pathlib
import pydoc
import re
import subprocess
import sys

import orlith
import pytest

ROOT = pathlib.Path(__file__).parents[2]
PAGE = (ROOT / "docs" / "python.md").read_text(encoding="utf-8")
STUBS = pathlib.Path(orlith.__file__).with_suffix(".pyi")
CODE = re.findall(r"^```python\n(.*?)^```$", PAGE, re.DOTALL | re.MULTILINE)


def members(of):
    return {name for name in vars(of) if not name.startswith("_")}


def test_help_reads_well():
    text = pydoc.render_doc(orlith, renderer=pydoc.plaintext)
    for line in [
        "read(path, *, strict=False, format=None,",
        "from_function(f, size=33, domain=None, kind='3D')",
        "convert(input, output, **options)",
    ]:
        assert line in text
    assert "_orlith." not in text
    for name in orlith.__all__:
        thing = getattr(orlith, name)
        assert thing.__module__.startswith("orlith") and len(thing.__doc__) > 20
        for member in members(thing) if inspect.isclass(thing) else []:
            assert getattr(thing, member).__doc__ or name == "Error"


def test_stubs_are_those_of_the_module():
    stubs = ast.parse(STUBS.read_text())
    functions = [node for node in stubs.body if isinstance(node, ast.FunctionDef)]
    classes = [node for node in stubs.body if isinstance(node, ast.ClassDef)]
    assert {node.name for node in functions + classes} == set(orlith.__all__)
    for node in classes:
        declared = {
            each.name if isinstance(each, ast.FunctionDef) else each.target.id
            for each in node.body
        }
        assert {name for name in declared if name[0] != "_"} == members(getattr(orlith, node.name))
    for owner, node in [(orlith, node) for node in functions] + [
        (orlith.Table, each)
        for table in classes if table.name == "Table"
        for each in table.body if each.name in {"write", "from_function"}
    ]:
        shown = list(inspect.signature(getattr(owner, node.name)).parameters)
        arguments = node.args.args + node.args.kwonlyargs + [node.args.kwarg]
        assert [a.arg for a in arguments if a and a.arg != "self"] == [n for n in shown if n != "self"]


def test_page_passes_mypy(tmp_path):
    pytest.importorskip("mypy", reason="mypy is not installed: the stubs are not checked")
    wrong = {"call": "look(image, mode='linear')", "read": "orlith.read(3)"}
    texts = {"page": "\n".join(CODE)}
    texts.update({name: "\n".join(CODE) + line for name, line in wrong.items()})
    for name, text in texts.items():
        (tmp_path / f"{name}.py").write_text(text)
    files = [f"{name}.py" for name in texts]
    command = [sys.executable, "-m", "mypy", "--ignore-missing-imports", *files]
    done = subprocess.run(command, cwd=tmp_path, capture_output=True, text=True)
    errors = [line.partition(".py:")[0] for line in done.stdout.splitlines() if "error:" in line]
    assert sorted(errors) == list(wrong), done.stdout + done.stderr


def test_page_runs(tmp_path, monkeypatch, capsys):
    monkeypatch.chdir(tmp_path)
    names = {}
    skipped = False
    for block in CODE:
        if "matplotlib" in block:
            try:
                import matplotlib
            except ImportError:
                skipped = True
                continue
            matplotlib.use("Agg")
        exec(compile(block, "docs/python.md", "exec"), names)
        shown = re.match(r"```\n\n```text\n(.*?)```", PAGE.partition(block)[2], re.DOTALL)
        assert capsys.readouterr().out == (shown[1] if shown else "")
    assert (tmp_path / "film.cube").exists()
    if skipped:
        pytest.skip("matplotlib is not installed: the plot of the page was not drawn")
