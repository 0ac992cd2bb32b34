#pragma once

#include "lut/evaluation/Look.h"
#include "zefra/Iop.h"

namespace orlith {

/// An image whose colours go through a look.
class LookOp final : public zefra::PixelIop {
public:
    /// @param input  kept by reference
    LookOp(zefra::Node& node, zefra::Iop& input, Orlith::LUT::ColourWay look);

    const char* className() const override { return "Look"; }
    const char* help() const override { return "Sends the colours of an image through a look."; }

protected:
    zefra::ChannelMask inputChannels(zefra::ChannelMask) const override { return zefra::kRGB; }
    void pixelEngine(const zefra::Row& in, zefra::ChannelMask channels, zefra::Row& out) override;

private:
    Orlith::LUT::ColourWay look_;
    std::vector<float> colours_;  // of a row
};

}  // namespace orlith
