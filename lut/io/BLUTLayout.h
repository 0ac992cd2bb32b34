#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <cstdio>

#include <stdio.h>  // getc_unlocked, a POSIX function

namespace Orlith::LUT {

// Binary LUT (.blut): a header of 45 bytes, then the samples. All numbers are big-endian.
//
//   offset  bytes  written          read
//    0       4     "HLUT"           has to be there
//    4       4     2                the last byte: 1 is a curve, anything else a lattice
//    8       4     5                ignored
//   12       4     64               ignored
//   16      24     0.0F 1.0F        ignored: the range of red, then of green, then of blue (as
//                                   meant: the domain, written as well)
//   40       3     0                ignored
//   43       1     points per axis  as a signed byte
//   44       1     'f'              'h': halves; anything else: floats
//   45             samples r g b, a lattice's red fastest, then green, then blue
//
// Nothing follows the samples.

constexpr std::size_t kBLUTHeaderBytes = 45;
using BLUTHeaderBytes = std::array<unsigned char, kBLUTHeaderBytes>;
constexpr char kBLUTMagic[] = {'H', 'L', 'U', 'T'};
constexpr std::size_t kBLUTKindOffset = 7;
constexpr std::size_t kBLUTRangeOffset = 16;
constexpr std::size_t kBLUTSizeOffset = 43;
constexpr std::size_t kBLUTTypeOffset = 44;

constexpr int kBLUTMostPoints = 127;  // a side, in a signed byte

constexpr unsigned char kBLUTCurve = 1;
constexpr unsigned char kBLUTFloats = 'f';
constexpr unsigned char kBLUTHalves = 'h';

/// Reads one number of a file that no other thread uses.
/// @return false, leaving bits alone, if the file ends before or within it
template <int kByteCount>
bool readBigEndian(std::FILE* file, std::uint32_t& bits) {
    std::uint32_t read = 0;
    for (int i = 0; i < kByteCount; ++i) {
        const int byte = getc_unlocked(file);
        if (byte == EOF) return false;
        read = read << 8 | static_cast<std::uint32_t>(byte);
    }
    bits = read;
    return true;
}

}  // namespace Orlith::LUT
