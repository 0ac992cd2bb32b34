"""Tables in memory: arrays in and out, evaluation, patterns."""

import copy
import gc
import pickle
import sys
import threading

import numpy as np
import orlith
import pytest

SIDES = (2, 3, 4)


def places(sides=SIDES, dtype="float32"):
    """Samples that tell their place and channel, small enough to be exact."""
    index = np.indices(sides).astype(dtype)
    place = sum(axis * 10.0**i for i, axis in enumerate(index))
    return np.stack([place + 1000 * c for c in range(3)], axis=-1).astype(dtype)


def misaligned(array):
    raw = np.zeros(array.nbytes + 1, "uint8")
    copy = raw[1:].view(array.dtype).reshape(array.shape)
    copy[...] = array
    return copy


def spread(array):
    wide = np.full([3 * side for side in array.shape], np.nan, array.dtype)
    wide[tuple(slice(1, None, 3) for _ in array.shape)] = array
    return wide[tuple(slice(1, None, 3) for _ in array.shape)]


def read_only(array):
    array = array.copy()
    array.flags.writeable = False
    return array


LAYOUTS = {
    "as it is": lambda a: a,
    "column order": np.asfortranarray,
    "negative strides": lambda a: a[::-1, ..., ::-1].copy()[::-1, ..., ::-1],
    "with gaps": spread,
    "read-only": read_only,
    "misaligned": misaligned,
    "other byte order": lambda a: a.astype(a.dtype.newbyteorder()),
}


@pytest.mark.parametrize("dtype", ["float32", "float64"])
@pytest.mark.parametrize("layout", LAYOUTS.values(), ids=LAYOUTS.keys())
def test_takes_arrays_of_any_layout(layout, dtype):
    table = orlith.Table(layout(places(dtype=dtype)))
    assert (table.kind, table.size) == ("3D", SIDES)
    np.testing.assert_array_equal(table.samples, places())
    assert orlith.Table(layout(places((5,), dtype))).size == (5,)

    colours = np.random.default_rng(1).uniform(-0.2, 1.2, (4, 5, 3)).astype(dtype)
    result = table(layout(colours))
    assert (result.dtype, result.shape) == (dtype, (4, 5, 3))
    np.testing.assert_array_equal(result, [[table(colour) for colour in row] for row in colours])


def test_keeps_the_order_of_shapes():
    table = orlith.Table(places())
    for shape in [(3,), (0, 3), (1, 1, 1, 3), (2, 0, 3)]:
        assert table(np.zeros(shape, "float32")).shape == shape
    assert table([0.0, 0.0, 1.0]).tolist() == [300, 1300, 2300]


def test_halves_stay_halves():
    halves = np.random.default_rng(1).random((50, 3)).astype("float16")
    table = orlith.Table.from_function(np.sqrt, 9)
    result = table(halves)
    assert result.dtype == "float16"
    np.testing.assert_array_equal(result, table(halves.astype("float32")).astype("float16"))


@pytest.mark.parametrize(
    "duplicate",
    [copy.copy, copy.deepcopy]
    + [lambda t, n=n: pickle.loads(pickle.dumps(t, n)) for n in range(pickle.HIGHEST_PROTOCOL + 1)],
)
def test_can_be_copied_and_sent(duplicate, tmp_path):
    path = tmp_path / "shaped.csp"
    path.write_text("""CSPLUTV100
3D

3
-1 0 2
0 0.25 1
2
0 1
0 1
2
0.5 1.5
0 1

2 3 2
""" + "0.5 0.125 0.75\n1 2 3\n" * 6)
    colours = np.random.default_rng(1).uniform(-1, 2, (100, 3))
    for table in [orlith.Table(places(), (-1, 4)), orlith.Table(places((3,))), orlith.read(path)]:
        twin = duplicate(table)
        np.testing.assert_array_equal(twin(colours), table(colours))
        assert (twin.kind, twin.size, twin.remarks) == (table.kind, table.size, table.remarks)
        assert twin.samples.strides == table.samples.strides
        twin.samples[...] = 0
        assert not np.array_equal(twin(colours), table(colours))


def test_samples_are_the_memory_of_the_table():
    table = orlith.Table(places())
    samples = table.samples
    assert np.shares_memory(samples, table.samples) and not samples.flags.owndata
    assert samples.strides == (12, 24, 72, 4)
    colours = np.tile(np.float32([1, 1, 1]), (10000, 1))
    before = table(colours)
    samples[1, 2, 3] = [7, 8, 9]  # counts at once, however many colours were seen
    assert before[0].tolist() == [321, 1321, 2321]
    assert np.unique(table(colours), axis=0).tolist() == [[7, 8, 9]]
    del table
    gc.collect()
    assert samples[1, 2, 3].tolist() == [7, 8, 9]


def test_has_its_own_copy_of_what_it_was_made_of():
    given = places()
    table = orlith.Table(given)
    given[...] = 0
    np.testing.assert_array_equal(table.samples, places())


def test_evaluates_by_each_mode():
    def look(rgb):
        r, g, b = np.moveaxis(np.asarray(rgb, "float64"), -1, 0)
        return np.stack([r * g * b, 1 - r, r * g], axis=-1)

    table = orlith.Table.from_function(look, 2)
    colour = np.array([0.75, 0.5, 0.125])
    # Linear along each axis, which is what trilinear interpolation keeps.
    np.testing.assert_allclose(table(colour), look(colour), atol=1e-6)
    # r > g > b: from black by red and yellow to white.
    np.testing.assert_allclose(table(colour, "tetrahedral"), [0.125, 0.25, 0.5], atol=1e-6)
    step = table(colour, mode="step")
    assert np.isin(step, [0, 1]).all() and not np.array_equal(step, table(colour))

    outside = np.array([2.0, 1.0, 1.0])
    assert table(outside).tolist() == [1, 0, 1]
    assert table(outside, extrapolate=True).tolist() == [2, -1, 2]
    assert table([np.nan, 1.0, 1.0]).tolist() == [0, 1, 0]


def test_covers_its_domain():
    table = orlith.Table(places(), domain=(-1, 4))
    assert table.domain.tolist() == [[-1] * 3, [4] * 3]
    assert table([-1.0, 4.0, -1.0]).tolist() == [20, 1020, 2020]
    table = orlith.Table(places((3,)), domain=[(0, 0, 0), (1, 2, 4)])
    assert table.domain.tolist() == [[0] * 3, [1, 2, 4]]
    assert table([0.5, 1.0, 4.0]).tolist() == [1, 1001, 2002]
    assert orlith.Table(places()).domain.tolist() == [[0] * 3, [1] * 3]
    assert table.shaper is None and table.remarks == []


def test_bakes_functions():
    def darken(colours):
        assert colours.dtype == "float32" and colours.shape[-1] == 3
        colours *= 0.5  # its own to change
        return colours

    table = orlith.Table.from_function(darken, 3, domain=(0, 2))
    assert table.size == (3, 3, 3)
    assert table.samples[2, 1, 0].tolist() == [1, 0.5, 0]
    curve = orlith.Table.from_function(np.sqrt, 5, kind="1D")
    np.testing.assert_allclose(curve.samples[:, 1], np.sqrt(np.linspace(0, 1, 5)), rtol=1e-6)
    with pytest.raises(ZeroDivisionError):
        orlith.Table.from_function(lambda colours: 1 / 0)


def test_pattern_is_laid_out_from_the_bottom_left():
    size, patch = 3, 7
    image = orlith.pattern(size)
    columns, rows = 6, 5  # 27 patches, the last three are padding
    assert image.shape == (rows * patch, columns * patch, 3)
    expected = np.zeros((rows, columns, 3), "float32")
    for index in range(size**3):
        colour = [index % 3, index // 3 % 3, index // 9]
        expected[rows - 1 - index // columns, index % columns] = np.float32(colour) / 2
    np.testing.assert_array_equal(image, expected.repeat(patch, 0).repeat(patch, 1))


def test_pattern_gives_the_look_that_it_went_through():
    image = orlith.pattern(4)
    padded = np.pad(image, [(6, 0), (0, 6), (0, 1)], constant_values=0.5)  # alpha, and crumbs
    padded[..., :3] = padded[..., :3] ** 2
    table = orlith.from_pattern(padded)
    assert table.size == (4, 4, 4)
    thirds = np.float32([0, 1, 2, 3]) / np.float32(3)
    axes = np.stack(np.meshgrid(thirds, thirds, thirds, indexing="ij"), axis=-1)
    np.testing.assert_array_equal(table.samples, axes**2)


TABLE = orlith.Table(places())
BAD = {
    "codes": (lambda: TABLE(np.zeros((2, 3), "uint8")), TypeError, "not uint8: divide"),
    "long numbers": (lambda: TABLE(np.zeros((2, 3), "longdouble")), TypeError, "not float128"),
    "state": (lambda: TABLE._restore((places((2,)),)), ValueError, "state"),
    "raw": (lambda: repr(orlith.Table.__new__(orlith.Table)), TypeError, "__init__"),
    "raw samples": (lambda: orlith.Table.__new__(orlith.Table).samples, TypeError, "__init__"),
    "complex": (lambda: TABLE(np.zeros((2, 3), complex)), TypeError, "not complex128"),
    "objects": (lambda: TABLE(np.full(3, None)), TypeError, "not object"),
    "words": (lambda: TABLE("red"), ValueError, "red"),
    "nothing": (lambda: TABLE(), TypeError, "argument"),
    "last axis": (lambda: TABLE(np.zeros((3, 4))), ValueError, r"\(3, 4\)"),
    "no axis": (lambda: TABLE(np.float32(1)), ValueError, r"shape \(\)"),
    "mode": (lambda: TABLE(np.zeros(3), mode="linear"), ValueError, 'not "linear"'),
    "no mode": (lambda: TABLE(places(), mode=None), TypeError, "^mode has to be a str, not NoneT"),
    "no flag": (lambda: TABLE(places(), extrapolate="no"), TypeError, "^extrapolate .* not str$"),
    "three axes": (lambda: orlith.Table(np.zeros((2, 2, 3))), ValueError, r"\(2, 2, 3\)"),
    "four channels": (lambda: orlith.Table(np.zeros((2, 2, 2, 4))), ValueError, "R, G, B, 3"),
    "one point": (lambda: orlith.Table(np.zeros((2, 1, 2, 3))), ValueError, "two points"),
    "integers": (lambda: orlith.Table(np.zeros((2, 3), int)), TypeError, "int64"),
    "flat domain": (lambda: orlith.Table(places(), (1, 1)), ValueError, "rise"),
    "endless domain": (lambda: orlith.Table(places(), (0, np.inf)), ValueError, "rise"),
    "no domain": (lambda: orlith.Table(places(), (1, 2, 3)), ValueError, "broadcast"),
    "baked shape": (
        lambda: orlith.Table.from_function(lambda c: c[..., :1], 2),
        ValueError,
        r"\(2, 2, 2, 3\) and gave \(2, 2, 2, 1\)",
    ),
    "baked kind": (lambda: orlith.Table.from_function(abs, 2, kind="2D"), ValueError, "2D"),
    "small pattern": (lambda: orlith.pattern(1), ValueError, "2 to 129"),
    "no pattern": (lambda: orlith.from_pattern(np.zeros((49, 70, 3))), ValueError, "70 x 49"),
    "no image": (lambda: orlith.from_pattern(np.zeros((49, 70))), ValueError, "height"),
    "own samples": (lambda: setattr(TABLE, "samples", places()), AttributeError, ""),
}


@pytest.mark.parametrize("call, error, words", BAD.values(), ids=BAD.keys())
def test_refuses(call, error, words):
    with pytest.raises(error, match=words):
        call()


def test_other_threads_run_while_it_evaluates():
    table = orlith.Table.from_function(np.sqrt, 33)
    colours = np.random.default_rng(1).random((3_000_000, 3), "float32")
    results = []
    worker = threading.Thread(target=lambda: results.append(table(colours, "cubic")))
    interval = sys.getswitchinterval()
    # No thread is made to give way: this one goes on only if the other lets it while it works.
    sys.setswitchinterval(1000)
    try:
        worker.start()
        was_working = not results
    finally:
        sys.setswitchinterval(interval)
    worker.join()
    assert was_working
    np.testing.assert_array_equal(results[0][:100], table(colours[:100], "cubic"))
