import os
from collections.abc import Callable
from typing import Any, Literal, Optional, Union, overload

import numpy
from numpy.typing import ArrayLike, NDArray

__version__: str

_Path = Union[str, bytes, "os.PathLike[str]", "os.PathLike[bytes]"]
_Mode = Literal["step", "staggered", "trilinear", "tetrahedral", "cubic"]
_Dialect = Literal["flame", "lustre", "scratch"]
_Bits = Literal[4, 8, 10, 12, 16]
_Floats = NDArray[numpy.float32]

class Error(Exception):
    file: Optional[str]
    line: Optional[int]
    reason: Optional[str]

class Table:
    def __init__(self, samples: ArrayLike, domain: Optional[ArrayLike] = None) -> None: ...
    @staticmethod
    def from_function(
        f: Callable[[_Floats], ArrayLike],
        size: int = 33,
        domain: Optional[ArrayLike] = None,
        kind: Literal["1D", "3D"] = "3D",
    ) -> Table: ...
    @overload
    def __call__(
        self, colours: _Floats, mode: _Mode = "trilinear", extrapolate: bool = False
    ) -> _Floats: ...
    @overload
    def __call__(
        self, colours: NDArray[numpy.float16], mode: _Mode = "trilinear", extrapolate: bool = False
    ) -> NDArray[numpy.float16]: ...
    @overload
    def __call__(
        self, colours: ArrayLike, mode: _Mode = "trilinear", extrapolate: bool = False
    ) -> NDArray[numpy.float64]: ...
    def write(
        self,
        path: _Path,
        *,
        format: Optional[str] = None,
        size: Optional[int] = None,
        bit_depth: _Bits = 10,
        output_bit_depth: Optional[_Bits] = None,
        clamp_output: bool = True,
        format_3dl: _Dialect = "flame",
        scale: Optional[float] = None,
        offset: Optional[float] = None,
    ) -> Written: ...
    @property
    def kind(self) -> Literal["1D", "3D"]: ...
    @property
    def size(self) -> tuple[int, ...]: ...
    @property
    def domain(self) -> _Floats: ...
    @property
    def shaper(self) -> Optional[tuple[_Floats, _Floats, _Floats]]: ...
    @property
    def samples(self) -> _Floats: ...
    @property
    def remarks(self) -> list[tuple[Optional[int], str]]: ...

class Written:
    @property
    def format(self) -> str: ...
    @property
    def deviation(self) -> Optional[float]: ...
    @property
    def resampled(self) -> str: ...
    @property
    def losses(self) -> list[str]: ...

class Difference:
    @property
    def largest(self) -> NDArray[numpy.float64]: ...
    @property
    def at(self) -> _Floats: ...
    @property
    def mean(self) -> NDArray[numpy.float64]: ...
    @property
    def rms(self) -> NDArray[numpy.float64]: ...

def read(
    path: _Path,
    *,
    strict: bool = False,
    format: Optional[str] = None,
    format_3dl: Literal["auto", "flame", "lustre", "scratch"] = "auto",
    output_bit_depth: Union[int, Literal["detect", "input"]] = "detect",
    normalize_output: bool = False,
) -> Table: ...
def convert(input: _Path, output: _Path, **options: Any) -> Written: ...
def diff(
    a: Union[Table, _Path],
    b: Union[Table, _Path],
    mode: _Mode = "trilinear",
    extrapolate: bool = False,
) -> Difference: ...
def pattern(size: int = 33) -> _Floats: ...
def from_pattern(image: ArrayLike) -> Table: ...
