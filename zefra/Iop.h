#pragma once

#include <vector>

#include "zefra/Export.h"
#include "zefra/Image.h"
#include "zefra/Op.h"

namespace zefra {

class Row;

/// An operator that is an image: it knows its box once it is validated, and makes rows of it.
///
/// Order of calls  validate, request, then get through Row as often as needed.
class ZEFRA_EXPORT Iop : public Op {
public:
    explicit Iop(Node& node) : Op(node) {}

    Iop* asImage() override { return this; }

    /// Images that the operator needs as inputs.
    virtual int inputCount() const { return 0; }

    /// Connects an input; the image outlives this one or is disconnected by null.
    void setInput(int index, Iop* image);

    /// The image at an input; an image without pixels where none is connected.
    Iop& input(int index) const;
    bool isConnected(int index) const;

    /// Makes the box known.
    /// @param forReal  false: only what a panel needs; true: pixels are going to be asked for
    void validate(bool forReal) { _validate(forReal); }
    const Box& box() const { return box_; }

    /// Announces that an area of the image is going to be read.
    /// @param count  how often; 0 for once
    void request(int x, int y, int r, int t, ChannelMask channels, int count) {
        _request(x, y, r, t, channels, count);
    }

protected:
    virtual void _validate(bool forReal) = 0;
    virtual void _request(int x, int y, int r, int t, ChannelMask channels, int count);

    /// Fills pixels x to r - 1 of row y of the given channels; pixels outside the box are black.
    virtual void engine(int y, int x, int r, ChannelMask channels, Row& row) = 0;

    void setBox(const Box& box) { box_ = box; }

private:
    friend class Row;

    Box box_;
    std::vector<Iop*> inputs_;
};

/// An operator that works on the pixels of its one input and keeps their places.
class ZEFRA_EXPORT PixelIop : public Iop {
public:
    explicit PixelIop(Node& node) : Iop(node) {}

    int inputCount() const override { return 1; }

protected:
    /// Takes the input's box over.
    void _validate(bool forReal) override;
    void _request(int x, int y, int r, int t, ChannelMask channels, int count) override;
    void engine(int y, int x, int r, ChannelMask channels, Row& row) override;

    /// The channels of the input that are needed for those of the output.
    virtual ChannelMask inputChannels(ChannelMask channels) const { return channels; }

    /// Makes a row of the output from the same row of the input.
    virtual void pixelEngine(const Row& in, ChannelMask channels, Row& out) = 0;
};

}  // namespace zefra
