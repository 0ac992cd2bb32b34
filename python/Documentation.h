#pragma once

// What help() shows. The first line of a text is the signature that inspect shows, too.

namespace python {

inline constexpr char kTableText[] =
    R"(A look-up table: a curve (kind "1D") or a lattice (kind "3D") of colours.

Table(samples, domain=None) makes one from an array of floats, which is copied: (N, 3)
for a curve, (R, G, B, 3) for a lattice. domain is what the first and the last point stand for: two
numbers or two triples; None is 0 to 1.

Calling the table sends colours through it.)";

inline constexpr char kInitText[] =
    "__init__(self, samples, domain=None)\n--\n\n"
    "See the class. TypeError, ValueError: no such samples or domain.";

inline constexpr char kFromFunctionText[] =
    R"(from_function(f, size=33, domain=None, kind="3D")
--

Makes a table of what a function gives for the inputs of its points.

f       called once, with float32 colours: (size, size, size, 3), or (size, 3) for kind "1D";
        returns as many
size    points a side, 2 or more
domain  as of Table)";

inline constexpr char kCallText[] = R"(__call__(self, colours, mode="trilinear", extrapolate=False)
--

Sends colours through the table and returns new ones of the same shape.

colours      (..., 3), of any shape and strides: float16, float32 and float64 give their own type;
             computed in single precision
mode         "step", "staggered", "trilinear", "tetrahedral" or "cubic"; curves ignore it
extrapolate  beyond the domain: True goes on in straight lines, False stays at its edge

Other threads run meanwhile; they must not write to the table's samples.
TypeError, ValueError: another type, another last axis, no such mode.)";

inline constexpr char kWriteText[] =
    R"(write(self, path, *, format=None, size=None, bit_depth=10, output_bit_depth=None, clamp_output=True, format_3dl="flame", scale=None, offset=None)
--

Writes the table as other programs read it, reads it back, compares the looks, and only then puts
the file in place: it is whole, or what was there before stays. Returns a Written.

What the format cannot hold is resampled; a domain that has to shrink and numbers that are clipped
are a UserWarning each.

path              str, bytes or os.PathLike
format            where the name does not tell: "cube", "csp", "3dl", "cms", "cub", "blut", "vf"
size              points a side, 2 to 256; None: the table's own, or 33 where a curve becomes a lattice

For .3dl files, others ignore them:
bit_depth         4, 8, 10, 12 or 16 bits of the input grid
output_bit_depth  likewise of the codes; None: as bit_depth
clamp_output      limit the codes to their bits
format_3dl        "flame", "lustre" or "scratch"
scale, offset     of the codes; None: those of format_3dl

Error: the format has no such table, or the file cannot be written as it should be.)";

inline constexpr char kReadText[] =
    R"(read(path, *, strict=False, format=None, format_3dl="auto", output_bit_depth="detect", normalize_output=False)
--

Reads a table as the programs that wrote it mean it; what was forgiven or not used is in its remarks.

path              str, bytes or os.PathLike
strict            True: by the letter of the format, as the library reads for the operator
format            where the name does not tell: "cube", "itx", "csp", "3dl", "cms", "cub", "blut",
                  "vf", "vfz", "gz"

For .3dl files, others ignore them:
format_3dl        "auto", "flame", "lustre" or "scratch"
output_bit_depth  bits of the codes from 1 to 31, "detect", or "input": as those of the input grid
normalize_output  scale values down until the largest is 1

Error: no such file or format, or it is no such table.)";

inline constexpr char kConvertText[] = R"(convert(input, output, **options)
--

Reads one file and writes another with the same look: read(input).write(output, **options).)";

inline constexpr char kDiffText[] = R"(diff(a, b, mode="trilinear", extrapolate=False)
--

How far two looks are apart, at the points of the larger table and at 10,000 random colours of both
domains. a and b are tables or paths. Returns a Difference.)";

inline constexpr char kPatternText[] = R"(pattern(size=33)
--

The test pattern of size x size x size colours, 2 to 129, as an image: float32, (height, width, 3),
its top line first. Patches are 7 x 7 pixels. Write it as an image, send that through any program,
and give what comes out to from_pattern.)";

inline constexpr char kFromPatternText[] = R"(from_pattern(image)
--

The table that a processed pattern holds: the centre of each patch, as it is.

image  (height, width, 3) or more channels, of which the first three count; floats, its top
       line first

Whether the pattern is upright and its patches are flat is not looked at, as "orlith generate" does.
TypeError, ValueError: another type, a size that no pattern has.)";

}  // namespace python
