"""Look-up tables of colour: read, evaluate, make, compare and write them.

    >>> import orlith
    >>> look = orlith.read("look.cube")
    >>> look.kind, look.size
    ('3D', (33, 33, 33))
    >>> graded = look(image)                       # any array (..., 3) of floats
    >>> look.write("look.3dl", format_3dl="lustre", bit_depth=12)

Files are read as other programs mean them, and written with the same look, which is proven by
reading them back. A file that cannot be read or written is an orlith.Error with its file, line and
reason; wrong arguments are TypeError and ValueError, as in NumPy.
"""

from orlith._orlith import (
    Difference,
    Error,
    Table,
    Written,
    __version__,
    convert,
    diff,
    from_pattern,
    pattern,
    read,
)

__all__ = [
    "Difference",
    "Error",
    "Table",
    "Written",
    "convert",
    "diff",
    "from_pattern",
    "pattern",
    "read",
]


def _restored(kind, samples, state):
    """The table that Table.__reduce__ took apart."""
    table = kind(samples)
    table._restore(state)
    return table
