#pragma once

#include <OpenImageIO/imageio.h>

#include <cstddef>
#include <string>
#include <vector>

namespace host::openimageio {

/// How samples are stored: a type of the library's, and how many of its bits count. Integers of 10
/// bits are 16-bit ones, scaled to their range, of which 10 count.
struct SampleType {
    OIIO::TypeDesc type;
    int bits;

    bool operator==(const SampleType& other) const {
        return type == other.type && bits == other.bits;
    }
};

/// @param name  one of kSampleTypes
SampleType namedSampleType(const std::string& name);

SampleType sampleTypeOf(const OIIO::ImageSpec& spec, int channel);

/// The one that does for all channels.
SampleType widestType(const OIIO::ImageSpec& spec);

/// As kSampleTypes have it, or in the same manner: "double", "uint14".
std::string nameOf(const SampleType& type);

/// Asks for a type, of all channels, in what is going to be written.
void setSampleType(OIIO::ImageSpec& spec, const SampleType& type);

/// Likewise, one for each channel.
void setSampleTypes(OIIO::ImageSpec& spec, const std::vector<SampleType>& types);

/// The largest code of an integer type that the library makes of a larger one, which loses what is
/// to be rounded; 0 for the others.
int codeMaxOf(const SampleType& type);

/// Rounds samples from 0 to 1 to the nearest multiples of 1 / codeMax.
void roundToCodes(float* samples, std::size_t count, int codeMax);

/// Whether every sample of one type is as good in another.
bool holdsAllOf(const SampleType& type, const SampleType& other);

/// The type that a file of that name can have which loses least, the smallest of those that lose
/// nothing. Found out by writing and reading a few pixels elsewhere: the library takes the nearest
/// that the format has, and does not say so.
/// @throws Error  there is none; the folder for temporary files and why nothing can be written
/// there
SampleType nearestHeld(const std::string& path, const SampleType& wanted);

/// Makes sure that a file of that name can have a type.
/// @throws Error  with the types that it can have; likewise
void expectFormatHolds(const std::string& path, const SampleType& wanted);

}  // namespace host::openimageio
