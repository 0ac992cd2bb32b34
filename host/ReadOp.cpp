#include <memory>
#include <string>

#include "host/BuiltInOps.h"
#include "host/Error.h"
#include "host/ImageFile.h"
#include "zefra/Iop.h"

namespace host {
namespace {

/// The image in a file. It is read once, and again when the file has changed.
class ReadOp final : public zefra::Iop {
public:
    explicit ReadOp(zefra::Node& node) : Iop(node) {}

    const char* className() const override { return "Read"; }
    const char* help() const override { return "Reads an image file: its red, green and blue."; }

    void knobs(zefra::ControlPass& pass) override {
        pass.fileName(&file_, "file", "file");
        pass.tooltip("The image file. Its rows are counted upward from its last line.");
        pass.integer(&choice_.part, "part", "part");
        pass.tooltip("Of a file of several images, which one, from 0; -1: the first in colour.");
        pass.text(&choice_.layer, "layer", "layer");
        pass.tooltip("Of a file with channels such as diffuse.R, which layer; empty: R, G and B.");
    }

protected:
    void _validate(bool) override {
        const bool isChosen =
            choice_.part == openChoice_.part && choice_.layer == openChoice_.layer;
        if (image_ && image_->path() == file_ && isChosen && image_->isCurrent()) return;
        image_.reset();
        setBox({});
        if (file_.empty()) throw Error("Read: no image file is set");
        image_ = std::make_unique<ImageFile>(file_, choice_);
        openChoice_ = choice_;
        setBox(image_->box());
        if (!image_->remark().empty()) node().warning((file_ + ": " + image_->remark()).c_str());
    }

    void engine(int y, int x, int r, zefra::ChannelMask channels, zefra::Row& row) override {
        if (!image_) throw Error("Read: no image file is open");
        image_->copyRow(y, x, r, channels, row);
    }

private:
    std::string file_;
    ImageChoice choice_;
    ImageChoice openChoice_;  // of the image that is open
    std::unique_ptr<ImageFile> image_;
};

}  // namespace

zefra::Op* makeRead(zefra::Node& node) {
    return new ReadOp(node);
}

}  // namespace host
