"""Tables from and to files."""

import os
import pathlib
import threading
import warnings

import numpy as np
import orlith
import pytest

DATA = pathlib.Path(__file__).parents[1] / "data"
SANITIZED = "ORLITH_SANITIZED" in os.environ

CUBE = "LUT_3D_SIZE 2\n" + "".join(
    f"{r} {g} {b}\n" for b in (0, 1) for g in (0, 1) for r in (0, 1)
)


@pytest.fixture(autouse=True)
def here(tmp_path, monkeypatch):
    """Each test in a folder of its own, in which nothing unfinished may be left."""
    monkeypatch.chdir(tmp_path)
    yield
    assert not list(tmp_path.glob(".orlith*"))


def look(size=5, domain=None):
    return orlith.Table.from_function(lambda c: c**0.5 * [1, 0.9, 0.8], size, domain)


def test_reads_what_a_file_holds():
    table = orlith.read(DATA / "csp" / "lattice.csp")
    assert (table.kind, table.size) == ("3D", (2, 3, 4))
    np.testing.assert_allclose(table.samples[1, 2, 3], [0.0321, 0.1321, 0.2321])
    red, green, blue = table.shaper
    assert red.tolist() == [[0, 0.25], [1, 0.75]]
    np.testing.assert_allclose(green, [[-0.5, 0.1], [0.25, 0.2], [1.5, 0.3]], atol=1e-7)
    assert blue.shape == (5, 2)
    assert table.domain.tolist() == [[0, -0.5, 0], [1, 1.5, np.float32(0.8)]]

    # Shapers that change nothing are none; a .csp file has to have some.
    assert orlith.read(DATA / "csp" / "curve.csp").shaper is None


def test_remarks_what_it_does_not_use():
    pathlib.Path("a.cube").write_text("CREATOR me\n" + CUBE)
    (line, text), = orlith.read("a.cube").remarks
    assert line == 1 and "CREATOR" in text
    pathlib.Path("a.cube").write_bytes(b"\xff 1\n" + CUBE.encode())
    pathlib.Path("range.cube").write_text("DOMAIN_MAX 2 2 2\n" + CUBE)
    assert orlith.read("range.cube").domain[1].tolist() == [2, 2, 2]
    by_book = orlith.read("range.cube", strict=True)
    assert by_book.domain[1].tolist() == [1, 1, 1] and by_book.remarks


@pytest.mark.parametrize(
    "name", ["a.cube", b"a.cube", pathlib.Path("a.cube"), os.fsdecode(b"\xe4.cube")]
)
def test_takes_paths_of_all_kinds(name):
    assert look().write(name).format == ".cube"
    assert orlith.read(name).size == (5, 5, 5)
    assert orlith.diff(name, orlith.read(name)).largest.tolist() == [0, 0, 0]


def test_names_the_format_by_hand():
    pathlib.Path("table").write_text(CUBE)
    assert orlith.read("table", format="cube").size == (2, 2, 2)
    assert look().write("other", format=".CSP").format == ".csp"


BAD_FILES = {
    "no file": ("none.cube", None, None, "No such file"),
    "a folder": (".", None, None, "folder|reader"),
    "no format": ("a.xyz", "", None, r"\.xyz"),
    "no number": ("a.cube", CUBE.replace("1 1 0", "1 1 0.5O"), 5, r'"0.5O" is no number'),
    "too short": ("a.cube", CUBE[:-6], None, "after 7 of 8"),
    "too large": ("a.cube", "LUT_3D_SIZE 99999\n", 1, "size"),
    "no text": ("a.cube", b"\xff\xfe\0 \xe4" * 9, None, ""),
}


@pytest.mark.parametrize("name, text, line, words", BAD_FILES.values(), ids=BAD_FILES.keys())
def test_says_where_a_file_is_wrong(name, text, line, words):
    if text is not None:
        pathlib.Path(name).write_bytes(text if isinstance(text, bytes) else text.encode())
    with pytest.raises(orlith.Error, match=words) as caught:
        orlith.read(name)
    error = caught.value
    assert error.file == name and error.reason in str(error)
    assert line is None or error.line == line
    assert str(error).startswith(name if error.line is None else f"{name}:{error.line}: ")


def test_a_table_is_whole_by_the_book_too():
    pathlib.Path("a.cube").write_text(CUBE[:-6])
    with pytest.raises(orlith.Error, match="7 samples, its table has 8"):
        orlith.read("a.cube", strict=True)
    pathlib.Path("a.cube").write_text(CUBE + "1 1 1\n")
    assert "9 samples" in orlith.read("a.cube", strict=True).remarks[-1][1]


BAD_CALLS = {
    "number as path": (lambda: orlith.read(3), TypeError, "PathLike"),
    "zero in path": (lambda: orlith.read("a\0b"), ValueError, "null"),
    "dialect": (lambda: orlith.read("a.3dl", format_3dl="smoke"), ValueError, "smoke"),
    "bits read": (lambda: orlith.read("a.3dl", output_bit_depth=32), ValueError, "1 to 31"),
    "bits": (lambda: look().write("a.3dl", bit_depth=11), ValueError, "11"),
    "code bits": (lambda: look().write("a.3dl", output_bit_depth=-1), ValueError, "-1"),
    "size": (lambda: look().write("a.cube", size=257), ValueError, "256"),
    "scale": (lambda: look().write("a.3dl", scale=np.inf), ValueError, "finite"),
    "positional": (lambda: look().write("a.3dl", "3dl"), TypeError, "argument"),
    "option": (lambda: look().write("a.cube", dialect="flame"), TypeError, "argument"),
    "two tables": (lambda: orlith.diff(look(), 3), TypeError, "PathLike"),
}


@pytest.mark.parametrize("call, error, words", BAD_CALLS.values(), ids=BAD_CALLS.keys())
def test_refuses(call, error, words):
    with pytest.raises(error, match=words):
        call()


@pytest.mark.parametrize("extension", ["cube", "csp", "3dl", "cms", "cub", "blut", "vf"])
@pytest.mark.filterwarnings("error")
def test_writes_its_look_in_every_format(extension):
    table = look()
    written = table.write(f"look.{extension}")
    assert written.format == f".{extension}" and not written.resampled
    limit = 0.6 / 1023 if extension == "3dl" else 1e-5
    assert written.deviation < limit
    back = orlith.read(f"look.{extension}")
    assert orlith.diff(table, back).largest.max() < limit
    np.testing.assert_array_equal(table.samples, look().samples)


def test_says_what_a_format_does_not_hold():
    wide = look(domain=(0, 4))
    with pytest.warns(UserWarning) as warned:
        written = wide.write("wide.3dl")
    assert written.resampled == "its domain" and len(written.losses) == len(warned) >= 1
    assert "wide.3dl: its domain" in str(warned[0].message)
    with pytest.warns(UserWarning, match="bright.3dl: 3 numbers are clipped, the farthest 1.5"):
        bright = look()
        bright.samples[4, 4, 4] = 1.5
        bright.write("bright.3dl")
    assert look().write("small.cube", size=3).resampled == "another size"
    curve = orlith.Table.from_function(np.square, 9, kind="1D")
    assert curve.write("curve.vf").resampled == "a curve"
    assert orlith.read("curve.vf").size == (33, 33, 33)


def test_a_file_is_whole_or_what_was_there():
    target = pathlib.Path("a.3dl")
    target.write_text("what was there")
    target.chmod(0o640)
    with warnings.catch_warnings():
        warnings.simplefilter("error")
        with pytest.raises(UserWarning):
            look(domain=(0, 4)).write(target)
    broken = look()
    broken.samples[0, 0, 0] = np.nan
    with pytest.raises(orlith.Error, match="not finite"):
        broken.write("a.cube")
    with pytest.raises(orlith.Error, match="at most 65"):
        look().write(target, size=66)
    assert target.read_text() == "what was there" and os.listdir() == ["a.3dl"]

    os.symlink("a.3dl", "link.3dl")
    look().write("link.3dl", format_3dl="lustre", bit_depth=12)
    assert target.read_text().startswith("#") and target.stat().st_mode & 0o777 == 0o640
    assert os.path.islink("link.3dl")
    for path, words in [("none/a.cube", "No such file"), (".", "directory|writer"), ("", "")]:
        with pytest.raises(orlith.Error, match=words):
            look().write(path, format="cube")
    assert look().write("/dev/null", format="cube").deviation is None


def test_converts_files():
    look().write("a.cube")
    written = orlith.convert("a.cube", "a.3dl", bit_depth=12, format_3dl="scratch")
    assert written.deviation < 0.6 / 4095 / 0.97
    assert orlith.diff("a.cube", "a.3dl").largest.max() < 1e-3


def test_tells_differences():
    table, other = look(), look()
    other.samples[2, 2, 2, 1] += 0.25
    difference = orlith.diff(table, other)
    np.testing.assert_allclose(difference.largest, [0, 0.25, 0], atol=1e-6)
    assert difference.at[1].tolist() == [0.5, 0.5, 0.5]
    assert 0 < difference.mean[1] < difference.rms[1] < 0.25


def test_other_threads_run_while_it_reads():
    os.mkfifo("pipe")  # who reads it waits for the thread that writes it
    writer = threading.Thread(target=lambda: pathlib.Path("pipe").write_text(CUBE))
    writer.start()
    assert orlith.read("pipe", format="cube").size == (2, 2, 2)
    writer.join()


@pytest.mark.skipif(SANITIZED, reason="the sanitizer keeps freed memory for a while")
def test_memory_stays():
    look(9).write("a.csp")

    def work(count):
        for _ in range(count):
            samples = orlith.read("a.csp").samples
            with pytest.raises(orlith.Error):
                orlith.read("none.csp")
        assert samples.shape == (9, 9, 9, 3)
        return int(pathlib.Path("/proc/self/statm").read_text().split()[1])

    pages = work(500)
    assert work(10_000) - pages < 500  # a leak of one table each would be 20,000
