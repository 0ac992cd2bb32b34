#pragma once

#include <string_view>

#include "lut/io/Dialect3DL.h"

namespace Orlith::LUT {

/// The input values of the points along each side.
struct Grid3DL {
    int pointCount;
    float origin;
    float range;
    int inputBits;  ///< 0: the file holds floats
};

/// What the lines above the input grid of a .3dl file state.
class Header3DL {
public:
    /// Wishes for the output bit depth, beside any depth itself.
    static constexpr int kDetect = -2;
    static constexpr int kAsInput = -1;

    /// @param dialect           Auto: go by the file. Otherwise the header of the file's generator
    ///                          counts as comments
    /// @param wantedOutputBits  a depth, or one of the wishes above
    Header3DL(Dialect3DL dialect, int wantedOutputBits);

    /// Takes in the next line.
    /// @param line  trimmed, not empty
    /// @return false if it is none of the header's lines: this is the input grid
    /// @throws Exception "3DL file reader: invalid dimensions in Mesh line"
    bool take(std::string_view line);

    Dialect3DL dialect() const { return dialect_; }
    int inputBits() const { return inputBits_; }    ///< 0: not stated
    int outputBits() const { return outputBits_; }  ///< kAsInput: neither wanted nor stated

    /// Points along red, and mostly along every side; 0: not stated.
    int pointsPerSide() const { return dimensions_[0]; }

    /// The caller leaves the output bit depth to the file, and the file does not tell.
    bool lacksOutputBits() const { return wantedOutputBits_ == kDetect && !foundOutputBits_; }

    /// Compares the dimensions, where they are stated, with the points of the input grid.
    /// @throws Exception  they differ among themselves, or from the grid
    void expectSize(int pointsPerSide) const;

private:
    bool takeGeneratorLine(std::string_view line);
    void takeGenerator(std::string_view text);
    void takeDimensions(std::string_view text);
    void takeOutputBits(int bits);
    void takeComment(std::string_view line);
    bool takeMeshLine(std::string_view line);
    void takeMesh(std::string_view text);
    void setOutputBits(int bits);

    Dialect3DL dialect_;
    int wantedOutputBits_;
    int inputBits_ = 0;
    int outputBits_;
    bool foundOutputBits_ = false;
    int dimensions_[3] = {0, 0, 0};  // points along r, g, b; 0: not stated
    int generatorLines_ = 0;         // how many of them were met
    bool namesDialect_ = false;      // the first of them did
};

}  // namespace Orlith::LUT
