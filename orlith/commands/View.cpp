#include <fmt/chrono.h>
#include <fmt/format.h>
#include <CLI/CLI.hpp>

#include <cerrno>
#include <ctime>
#include <filesystem>
#include <fstream>
#include <string>
#include <system_error>
#include <vector>

#include "orlith/Command.h"
#include "orlith/FactsInWords.h"
#include "orlith/ImageOptions.h"
#include "orlith/Messages.h"
#include "orlith/Options.h"
#include "orlith/OutputFile.h"
#include "orlith/ShownPicture.h"
#include "orlith/table/ColourOptions.h"
#include "orlith/table/TableFile.h"
#include "report/Page.h"
#include "report/TestChart.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;
namespace fs = std::filesystem;

struct ViewOptions {
    std::string a;
    std::string b;  ///< empty: only one table
    std::string output;
    std::string image;
    host::ImageChoice imageChoice;
    ReadOptions reading;
    ColourOptions colours;
};

/// The page of looks/film.cube is film.html in the current folder.
std::string pageName(const ViewOptions& options) {
    if (!options.output.empty()) return options.output;
    return options.a == "-" ? "table.html" : fs::path(options.a).stem().string() + ".html";
}

report::PageTable pageTable(const std::string& path, const ViewOptions& options) {
    const Table table = readWholeTable(path, readingAmong(path, options.reading));
    const ol::LUT& lut = *table.lut;
    if (lut.width() < 2 || (!lut.is1D() && (lut.height() < 2 || lut.depth() < 2))) {
        throw Failure(fmt::format("{}: {} have no curves", table.name, sizeText(lut)));
    }
    report::PageTable shown;
    shown.name = table.name == path ? fs::path(path).filename().string() : table.name;
    shown.lut = table.lut;
    shown.look = wayThrough(table.lut, options.colours, options.reading.isStrict);
    shown.report = report::reportOn(lut, shown.look);
    shown.facts = factsInWords(table, &shown.report);
    for (const ol::Remark& remark : table.remarks) {
        const std::string line = remark.line == 0 ? "" : fmt::format("line {}: ", remark.line);
        shown.facts.emplace_back("remark", line + remark.text);
    }
    return shown;
}

// The picture

report::Picture through(const report::PageTable& table, const report::Picture& picture) {
    report::Picture after = picture;
    table.look(after.pixels.data(), after.pixels.size() / 3);
    return after;
}

/// The chart covers a table's domain.
report::Picture scaledTo(const ol::Range& domain, report::Picture picture) {
    for (std::size_t i = 0; i < picture.pixels.size(); ++i) {
        const auto c = static_cast<unsigned>(i % 3);
        picture.pixels[i] = domain.min[c] + picture.pixels[i] * (domain.max[c] - domain.min[c]);
    }
    return picture;
}

report::PagePicture pagePicture(const std::vector<report::PageTable>& tables,
                                const ViewOptions& options, const std::string& folder) {
    constexpr int kChartWidth = 960;
    constexpr int kChartHeight = 540;
    report::PagePicture shown;
    report::Picture input;
    if (options.image.empty()) {
        const report::Picture chart = report::testChart(kChartWidth, kChartHeight);
        shown.name = "Test chart";
        shown.caption =
            "A test chart over the table's domain: hues from white to black, greys, primaries, and "
            "colours of skin, plants, sky and fabrics. Values are shown as they are, cut to 0 to "
            "1.";
        shown.before = dataAddress(chart, folder);
        input = scaledTo(tables.front().report.domain, chart);
    } else {
        input = readForPage(options.image, options.imageChoice);
        shown.name = fs::path(options.image).filename().string();
        shown.caption = "Values are shown as they are, cut to 0 to 1.";
        shown.before = dataAddress(input, folder);
    }
    for (const report::PageTable& table : tables)
        shown.after.push_back(dataAddress(through(table, input), folder));
    return shown;
}

void writePage(const std::string& page, const OutputFile& output) {
    errno = 0;
    std::ofstream file(output.stagedPath(), std::ios::binary);
    file << page << std::flush;
    if (!file) {
        throw Failure(
            fmt::format("{}: cannot be written{}", output.name(), writeFailureReason(errno)));
    }
}

int runView(const ViewOptions& options) {
    if (options.a == "-" && options.b == "-") {
        throw UsageError("only one of the tables can come from standard input");
    }
    for (const std::string& shown : {options.a, options.b, options.image})
        expectOtherFile(pageName(options), shown);
    std::vector<report::PageTable> tables = {pageTable(options.a, options)};
    if (!options.b.empty()) tables.push_back(pageTable(options.b, options));

    OutputFile output(pageName(options));
    const std::string folder = fs::path(output.stagedPath()).parent_path().string();
    const report::PagePicture picture = pagePicture(tables, options, folder);
    const std::string made = fmt::format("Made on {:%Y-%m-%d} by orlith {}",
                                         fmt::localtime(std::time(nullptr)), ORLITH_VERSION);
    const std::string page = pageOf(tables, picture, made);
    writePage(page, output);
    output.deliver();
    output.print(fmt::format("wrote {}, {:.1f} MB\n", printable(output.name()),
                             static_cast<double>(page.size()) / 1e6));
    return kDone;
}

}  // namespace

void addView(CLI::App& program, int& status) {
    CLI::App* const command = addCommand(
        program, "view", "Show a table, or two and their difference, as a page for a browser");
    const auto options = std::make_shared<ViewOptions>();
    command->add_option("LUT", options->a, "Table to show")->required();
    command->add_option("LUT_B", options->b, "Table to compare it with");
    command
        ->add_option("--output", options->output,
                     "Page to write; the table's name with .html in the current folder")
        ->type_name("PAGE.html");
    command->add_option("--image", options->image, "Picture to show before and after")
        ->type_name("IMAGE");
    addImageChoice(*command, options->imageChoice);
    addFromOption(*command, options->reading);
    addReadOptions(*command, options->reading);
    addColourOptions(*command, options->colours);
    command->callback([options, &status] { status = runView(*options); });
}

}  // namespace orlith
