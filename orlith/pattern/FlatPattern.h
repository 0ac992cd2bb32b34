#pragma once

#include "lut/LUT3D.h"
#include "zefra/Iop.h"

namespace orlith {

/// A processed pattern as it was read: each patch has the colour of its centre. The operator, which
/// looks at centres only, finds in it what the image has, without the file being decoded again.
class FlatPattern final : public zefra::Iop {
public:
    /// @param node   of the image that was read
    /// @param box    of that image
    /// @param table  outlives this
    FlatPattern(zefra::Node& node, const zefra::Box& box, const Orlith::LUT::LUT3D& table);

    const char* className() const override { return "FlatPattern"; }
    const char* help() const override { return ""; }

protected:
    void _validate(bool forReal) override;
    void engine(int y, int x, int r, zefra::ChannelMask channels, zefra::Row& row) override;

private:
    const zefra::Box imageBox_;
    const Orlith::LUT::LUT3D& table_;
};

}  // namespace orlith
