#include "zefra/Iop.h"

#include "zefra/Row.h"

namespace zefra {
namespace {

/// Services for an operator that stands for nothing and has nobody to talk to.
class NoNode final : public Node {
public:
    void error(const char*) override {}
    void warning(const char*) override {}
    void progressMessage(const char*) override {}
    void progressFraction(double) override {}
    bool aborted() const override { return false; }
    int replaceControls(const Control&, int, ControlPass::Declare) override { return 0; }
    void runKnobChanged(Control&) override {}
};

/// What an unconnected input shows: no pixels.
class EmptyImage final : public Iop {
public:
    explicit EmptyImage(Node& node) : Iop(node) {}

    const char* className() const override { return "EmptyImage"; }
    const char* help() const override { return ""; }

protected:
    void _validate(bool) override {}
    void engine(int, int, int, ChannelMask, Row&) override {}
};

}  // namespace

void Iop::setInput(int index, Iop* image) {
    const auto place = static_cast<std::size_t>(index);
    if (place >= inputs_.size()) inputs_.resize(place + 1);
    inputs_[place] = image;
}

bool Iop::isConnected(int index) const {
    const auto place = static_cast<std::size_t>(index);
    return place < inputs_.size() && inputs_[place] != nullptr;
}

Iop& Iop::input(int index) const {
    static NoNode node;
    static EmptyImage empty(node);
    return isConnected(index) ? *inputs_[static_cast<std::size_t>(index)] : empty;
}

void Iop::_request(int, int, int, int, ChannelMask, int) {}

void PixelIop::_validate(bool forReal) {
    input(0).validate(forReal);
    setBox(input(0).box());
}

void PixelIop::_request(int x, int y, int r, int t, ChannelMask channels, int count) {
    input(0).request(x, y, r, t, inputChannels(channels), count);
}

void PixelIop::engine(int y, int x, int r, ChannelMask channels, Row& row) {
    Row in(x, r);
    in.get(input(0), y, x, r, inputChannels(channels));
    pixelEngine(in, channels, row);
}

}  // namespace zefra
