#include "generatelut/GenerateLUT.h"

#include <algorithm>
#include <cstdio>
#include <cstring>

#include "generatelut/HelpText.h"
#include "generatelut/Menus.h"
#include "generatelut/WriterOptions.h"
#include "lut/Exception.h"
#include "lut/io/Registry.h"
#include "zefra/Registration.h"
#include "zefra/Row.h"

namespace generatelut {
namespace {

constexpr char kClassName[] = "GenerateLUT";

zefra::Op* makeGenerateLUT(zefra::Node& node) {
    return new GenerateLUT(node);
}

const zefra::Description kDescription(kClassName, __DATE__ ", for " ZEFRA_HOST_VERSION,
                                      makeGenerateLUT);

/// The input image, row by row.
class InputFrame final : public Frame {
public:
    InputFrame(zefra::Iop& image, zefra::Node& node) : image_(image), node_(node) {}

    void withRow(int y, int width, const UseRow& use) override {
        zefra::Row row(0, width);
        row.get(image_, y, 0, width, zefra::kRGB);
        use(row.pixels(zefra::kRed), row.pixels(zefra::kGreen), row.pixels(zefra::kBlue));
    }

    void progressMessage(const char* text) override { node_.progressMessage(text); }
    void progressFraction(double fraction) override { node_.progressFraction(fraction); }
    bool aborted() override { return node_.aborted(); }

private:
    zefra::Iop& image_;
    zefra::Node& node_;
};

}  // namespace

const char* GenerateLUT::className() const {
    return kClassName;
}

const char* GenerateLUT::help() const {
    return kHelp;
}

void GenerateLUT::knobs(zefra::ControlPass& pass) {
    pass.fileName(&file_, "file", "output file");
    pass.tooltip(kFileTip);
    pass.obsolete("output_file", "knob file $value");

    zefra::Control* const fileType =
        pass.enumeration(&fileType_, kFileTypes, "file_type", "file type");
    pass.flags(0x88010000);
    pass.tooltip(kFileTypeTip);
    if (pass.buildsPanel()) {
        fileTypeControl_ = fileType;
        typeControlCount_ = pass.addControls(declareTypeControls, *this);
    } else {
        declareTypeControls(*this, pass);
    }

    pass.textLine(" ", "");
    pass.scriptButton("generate", "Generate and Write LUT File", kGenerateScript);
}

void GenerateLUT::declareTypeControls(zefra::Op& op, zefra::ControlPass& pass) {
    auto& self = static_cast<GenerateLUT&>(op);
    if (std::strcmp(menuEntry(kFileTypes, self.fileType_), ".3dl") == 0) {
        self.declare3DLControls(pass);
    } else {
        self.declarePreLUTControls(pass);
    }
}

void GenerateLUT::declarePreLUTControls(zefra::ControlPass& pass) {
    pass.textLine("@b;1D preLUT", "");
    pass.integer(&lut1d_, "lut1d", "1D preLUT size");
    pass.tooltip(kLut1dTip);
    pass.enumeration(&style1d_, kStyles, "style1d", "");
    pass.tooltip(kStyle1dTip);
    pass.obsolete("bitdepth_id", nullptr);
    pass.obsolete("scratch_compatible", nullptr);
}

void GenerateLUT::declare3DLControls(zefra::ControlPass& pass) {
    pass.obsolete("lut1d", nullptr);
    pass.obsolete("style1d", nullptr);
    pass.textLine("@b;3D LUT", "");
    pass.enumeration(&bitDepth_, kInputBitDepths, "bitdepth_id", "input bit depth (.3dl)");
    pass.tooltip(kBitDepthTip);
    pass.enumeration(&outputBitDepth_, kOutputBitDepths, "output_bitdepth_id",
                     "output bit depth (.3dl)");
    pass.tooltip(kOutputBitDepthTip);
    pass.boolean(&clampOutput_, "clamp_output", "clamp output");
    pass.flags(0x100);
    pass.tooltip(kClampOutputTip);
    pass.enumeration(&format3DL_, kFormats3DL, "format_3dl_id", "3dl file format");
    pass.tooltip(kFormat3dlTip);

    // Deliberate: 3 is beyond the menu. The writer refuses what it stands for, so that an old node
    // which was compatible with Scratch has to be looked at before it writes.
    char script[64];
    std::snprintf(script, sizeof script, "knob format_3dl_id [expr $value == \"false\" ? %d : %d]",
                  1, 3);
    pass.obsolete("scratch_compatible", script);
}

bool GenerateLUT::knob_changed(const zefra::Control& control) {
    if (control.name() == "file_type") {
        // Without a panel there are no controls to exchange.
        if (fileTypeControl_ != nullptr) {
            typeControlCount_ =
                node().replaceControls(*fileTypeControl_, typeControlCount_, declareTypeControls);
        }
        return true;
    }
    if (control.name() == "file") {
        followFileName();
        return true;
    }
    return false;
}

/// Chooses the file type from the extension of a new file name.
void GenerateLUT::followFileName() {
    std::string extension;
    Orlith::LUT::splitExtension(file_, nullptr, &extension);
    if (!extension.empty()) {
        int index = 0;
        while (kFileTypes[index][0] != '\0' && extension != kFileTypes[index])
            ++index;
        if (kFileTypes[index][0] == '\0') index = 0;
        if (fileTypeControl_ == nullptr) return;
        fileTypeControl_->setValue(index);
        node().runKnobChanged(*fileTypeControl_);
    } else if (fileType_ == 0) {
        error("%s",
              "Error writing LUT file. Select a file type or set a \".type\" extension on the file"
              " name so that Zefra can determine the type of file to write.");
    }
}

void GenerateLUT::_validate(bool forReal) {
    input(0).validate(forReal);
    const zefra::Box& box = input(0).box();
    size_ = PatternSize::ofImage(box.width(), box.height());
    PixelIop::_validate(forReal);
}

void GenerateLUT::pixelEngine(const zefra::Row& in, zefra::ChannelMask channels, zefra::Row& out) {
    const auto width = static_cast<std::size_t>(in.right() - in.left());
    const int start = in.left() - out.left();
    for (const zefra::Channel channel : {zefra::kRed, zefra::kGreen, zefra::kBlue}) {
        if ((channels & channel) == 0) continue;
        std::copy_n(in.pixels(channel), width, out.writable(channel) + start);
    }
}

void GenerateLUT::execute() {
    if (file_.empty()) return;
    const char* const typeExtension = menuEntry(kFileTypes, fileType_);
    const bool isTypeGiven = fileType_ != 0;

    validate(true);
    input(0).request(0, 0, size_.pixelWidth(), size_.pixelHeight(), zefra::kRGB, 0);

    boost::shared_ptr<Orlith::LUT::LUTFileWriter> writer;
    try {
        std::string name = file_;
        std::string extension;
        Orlith::LUT::splitExtension(name, nullptr, &extension);
        if (extension.empty() && isTypeGiven) name += typeExtension;
        writer = Orlith::LUT::createWriter(name, isTypeGiven, typeExtension);
        if (!isTypeGiven || std::strcmp(typeExtension, ".3dl") == 0) {
            setWriterOptions(*writer, {bitDepth_, outputBitDepth_, clampOutput_, format3DL_});
        }
    } catch (const Orlith::LUT::Exception&) {
        error(
            "%s",
            "Error writing LUT file. You must select the file type or set a \".type\" extension on"
            " the file name to indicate what type of file to write.");
        return;
    }

    InputFrame frame(input(0), node());
    const auto lut = analyseFrame(size_, {lut1d_, style1d_ == kLinearStyle}, frame);
    if (!lut) return;  // cancelled
    try {
        // Deliberate: the name as it was typed. An extension that was added above chose the writer
        // and is not part of the file's name.
        writer->write(file_, lut);
        if (!writer->wroteAll()) {
            error("%s", "Error writing LUT file: not all of the file could be written");
        }
    } catch (const Orlith::LUT::Exception& exception) {
        error("Error writing LUT file: %s", exception.message());
    }
}

}  // namespace generatelut
