#pragma once

#include <string>

#include "generatelut/PatternAnalysis.h"
#include "zefra/Iop.h"

namespace generatelut {

/// The operator: turns a processed test pattern into a look-up table file. As an image it passes
/// its input through.
class GenerateLUT final : public zefra::PixelIop, public zefra::Executable {
public:
    explicit GenerateLUT(zefra::Node& node) : PixelIop(node) {}

    const char* className() const override;
    const char* help() const override;
    zefra::Executable* asExecutable() override { return this; }

    void knobs(zefra::ControlPass& pass) override;
    bool knob_changed(const zefra::Control& control) override;

    /// Writes the file that the controls describe. Failures are errors of the node; what building
    /// the table throws goes on to the host.
    void execute() override;

protected:
    void _validate(bool forReal) override;
    zefra::ChannelMask inputChannels(zefra::ChannelMask) const override { return zefra::kRGB; }
    void pixelEngine(const zefra::Row& in, zefra::ChannelMask channels, zefra::Row& out) override;

private:
    static void declareTypeControls(zefra::Op& op, zefra::ControlPass& pass);
    void declarePreLUTControls(zefra::ControlPass& pass);
    void declare3DLControls(zefra::ControlPass& pass);
    void followFileName();

    // Control values.
    std::string file_;
    int fileType_ = 0;
    int lut1d_ = 1024;
    int style1d_ = 1;
    int bitDepth_ = 2;
    int outputBitDepth_ = 0;
    bool clampOutput_ = true;
    int format3DL_ = 0;

    zefra::Control* fileTypeControl_ = nullptr;
    int typeControlCount_ = 0;  // type-specific controls on the panel now

    PatternSize size_;
};

}  // namespace generatelut
