#include <fmt/format.h>

#include <cstdint>

#include "host/BuiltInOps.h"
#include "host/Error.h"
#include "zefra/Iop.h"
#include "zefra/PatternLayout.h"
#include "zefra/Row.h"

namespace host {
namespace {

using zefra::PatternLayout;

constexpr int kMinSize = 2;
constexpr int kMaxSize = 129;

/// The test pattern. Rows are made when they are asked for; padding patches are black.
class TestPatternOp final : public zefra::Iop {
public:
    explicit TestPatternOp(zefra::Node& node) : Iop(node) {}

    const char* className() const override { return "CMSTestPattern"; }
    const char* help() const override {
        return "Makes a test pattern: a cube of size x size x size colours as flat patches.";
    }

    void knobs(zefra::ControlPass& pass) override {
        pass.integer(&size_, "size", "cube size");
        pass.tooltip("Colours along each axis of the cube, from 2 to 129.");
    }

protected:
    void _validate(bool) override {
        setBox({});
        if (size_ < kMinSize || size_ > kMaxSize) {
            throw Error(fmt::format("CMSTestPattern: size {} is not within {} to {}", size_,
                                    kMinSize, kMaxSize));
        }
        setBox({0, 0, PatternLayout::columns(size_) * PatternLayout::kPatchPixels,
                PatternLayout::rows(size_) * PatternLayout::kPatchPixels});
    }

    void engine(int y, int x, int r, zefra::ChannelMask channels, zefra::Row& row) override {
        for (const zefra::Channel channel : {zefra::kRed, zefra::kGreen, zefra::kBlue}) {
            if ((channels & channel) == 0) continue;
            float* out = row.writable(channel);
            for (int column = x; column < r; ++column)
                out[column - row.left()] = value(column, y, channel);
        }
    }

private:
    /// The value of a pixel in one channel.
    float value(int x, int y, zefra::Channel channel) const {
        if (x < 0 || x >= box().r || y < 0 || y >= box().t) return 0.0F;
        const std::int64_t columns = box().r / PatternLayout::kPatchPixels;
        const std::int64_t index =
            y / PatternLayout::kPatchPixels * columns + x / PatternLayout::kPatchPixels;
        const std::int64_t size = size_;
        if (index >= size * size * size) return 0.0F;
        const std::int64_t point = channel == zefra::kRed     ? index % size
                                   : channel == zefra::kGreen ? index / size % size
                                                              : index / size / size;
        return static_cast<float>(point) / static_cast<float>(size - 1);
    }

    int size_ = 33;
};

}  // namespace

zefra::Op* makeTestPattern(zefra::Node& node) {
    return new TestPatternOp(node);
}

}  // namespace host
