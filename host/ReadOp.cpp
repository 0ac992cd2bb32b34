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
    }

protected:
    void _validate(bool) override {
        if (image_ && image_->path() == file_ && image_->isCurrent()) return;
        image_.reset();
        setBox({});
        if (file_.empty()) throw Error("Read: no image file is set");
        image_ = std::make_unique<ImageFile>(file_);
        setBox(image_->box());
    }

    void engine(int y, int x, int r, zefra::ChannelMask channels, zefra::Row& row) override {
        if (!image_) throw Error("Read: no image file is open");
        image_->copyRow(y, x, r, channels, row);
    }

private:
    std::string file_;
    std::unique_ptr<ImageFile> image_;
};

}  // namespace

zefra::Op* makeRead(zefra::Node& node) {
    return new ReadOp(node);
}

}  // namespace host
