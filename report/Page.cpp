#include "report/Page.h"

#include <fmt/format.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <nlohmann/json.hpp>

#include "report/Base64.h"
#include "report/PageGrid.h"
#include "report/PageTemplate.h"

namespace report {
namespace {

namespace ol = Orlith::LUT;
using nlohmann::json;

// Light that reflects from a grey card: a place that people want to read off.
constexpr float kMidGrey = 0.18F;

/// JSON has no numbers for what is not finite.
json number(double value) {
    if (std::isnan(value)) return "nan";
    if (std::isinf(value)) return value > 0.0 ? "inf" : "-inf";
    return value;
}

json triple(const ol::RGB& colour) {
    json list = json::array();
    for (unsigned c = 0; c < 3; ++c)
        list.push_back(number(static_cast<double>(colour[c])));
    return list;
}

std::string floats(const std::vector<ol::RGB>& colours) {
    return colours.empty() ? "" : base64(colours.data(), colours.size() * sizeof(ol::RGB));
}

// Curves

/// The inputs of two lists in one, rising, and mid grey if they reach it; those that differ by
/// roundings are one.
std::vector<float> merged(std::vector<float> inputs, const std::vector<float>& others) {
    constexpr float kSame = 1e-6F;  // of the whole
    inputs.insert(inputs.end(), others.begin(), others.end());
    inputs.erase(std::remove_if(inputs.begin(), inputs.end(),
                                [](float input) { return !std::isfinite(input); }),
                 inputs.end());
    std::sort(inputs.begin(), inputs.end());
    if (inputs.empty()) return {};
    if (inputs.front() < kMidGrey && kMidGrey < inputs.back()) {
        inputs.insert(std::upper_bound(inputs.begin(), inputs.end(), kMidGrey), kMidGrey);
    }
    const float same = kSame * (inputs.back() - inputs.front());
    inputs.erase(
        std::unique(inputs.begin(), inputs.end(), [&](float a, float b) { return b - a <= same; }),
        inputs.end());
    return inputs;
}

std::vector<float> inputsOf(const Curve& curve) {
    std::vector<float> inputs;
    inputs.reserve(curve.inputs.size());
    for (const ol::RGB& colour : curve.inputs)
        inputs.push_back(colour[curve.channel]);
    return inputs;
}

/// One axis of all tables, at the inputs of all of them.
/// @param channel  the channel that rises; -1: all three
json jsonCurve(const std::vector<PageTable>& tables, const std::vector<const Curve*>& curves,
               const char* name, int channel) {
    const std::vector<float> inputs = merged(inputsOf(*curves.front()), inputsOf(*curves.back()));
    const ol::RGB base =
        curves.front()->inputs.empty() ? ol::RGB(0.0F, 0.0F, 0.0F) : curves.front()->inputs.front();
    std::vector<ol::RGB> colours;
    colours.reserve(inputs.size());
    for (const float input : inputs) {
        ol::RGB colour = base;
        for (unsigned c = 0; c < 3; ++c) {
            if (channel < 0 || static_cast<int>(c) == channel) colour[c] = input;
        }
        colours.push_back(colour);
    }
    json list = json::array();
    for (const PageTable& table : tables) {
        const Curve curve = curveThrough(colours, curves.front()->channel, table.look);
        list.push_back({{"outputs", floats(curve.outputs)}, {"slopes", floats(curve.slopes)}});
    }
    return {{"name", name},
            {"channel", channel},
            {"base", triple(base)},
            {"inputs", inputs.empty() ? "" : base64(inputs.data(), inputs.size() * sizeof(float))},
            {"tables", list}};
}

json jsonCurves(const std::vector<PageTable>& tables) {
    const auto curvesOf = [&](auto&& member) {
        std::vector<const Curve*> curves;
        curves.reserve(tables.size());
        for (const PageTable& table : tables)
            curves.push_back(&member(table.report));
        return curves;
    };
    json list = json::array();
    list.push_back(jsonCurve(tables,
                             curvesOf([](const Report& report) -> auto& { return report.neutral; }),
                             "Neutral axis", -1));
    // The channels of a curve do not depend on each other.
    const bool areCurves = std::all_of(tables.begin(), tables.end(),
                                       [](const PageTable& table) { return table.lut->is1D(); });
    if (areCurves) return list;
    constexpr const char* kNames[] = {"Red alone", "Green alone", "Blue alone"};
    for (unsigned c = 0; c < 3; ++c) {
        list.push_back(jsonCurve(
            tables, curvesOf([c](const Report& report) -> auto& { return report.channels[c]; }),
            kNames[c], static_cast<int>(c)));
    }
    return list;
}

// Faults and differences

json jsonFaults(const std::vector<Fault>& faults) {
    json list = json::array();
    for (const Fault& fault : faults) {
        list.push_back({{"kind", nameOf(fault.kind)},
                        {"text", textOf(fault)},
                        {"from", triple(fault.from)},
                        {"to", triple(fault.to)}});
    }
    return list;
}

json jsonDifference(const PageTable& a, const PageTable& b) {
    json list = json::array();
    for (const ol::Difference& each : compareLooks(*a.lut, a.look, *b.lut, b.look)) {
        list.push_back({{"largest", number(each.largest)},
                        {"mean", number(each.mean)},
                        {"rms", number(each.rootMeanSquare)},
                        {"at", triple(each.at)}});
    }
    return list;
}

/// What a page shows, for the script in it.
json pageData(const std::vector<PageTable>& tables, const PagePicture& picture,
              const std::string& made) {
    const PageGrid grid = gridOf(tables);
    json list = json::array();
    std::vector<std::vector<ol::RGB>> outputs;
    for (std::size_t i = 0; i < tables.size(); ++i) {
        outputs.push_back(grid.outputs(tables[i].look));
        const Extent extent = extentOf(outputs.back());
        list.push_back({{"name", tables[i].name},
                        {"letter", std::string(1, static_cast<char>('A' + i))},
                        {"facts", tables[i].facts},
                        {"faults", jsonFaults(tables[i].report.faults)},
                        {"extent", {{"min", extent.min}, {"max", extent.max}}},
                        {"lattice", codesOf(outputs.back(), extent)}});
    }
    json data = {{"made", made},
                 {"tables", list},
                 {"grid", grid.json()},
                 {"curves", jsonCurves(tables)},
                 {"picture",
                  {{"name", picture.name},
                   {"caption", picture.caption},
                   {"before", picture.before},
                   {"after", picture.after}}}};
    if (tables.size() == 2) {
        data["difference"] = jsonDifference(tables.front(), tables.back());
        data["differenceFull"] = largestDistance(outputs.front(), outputs.back());
    }
    return data;
}

// Markup

std::string replacedAll(std::string text, const std::string& from, const std::string& to) {
    for (std::size_t at = 0; (at = text.find(from, at)) != std::string::npos; at += to.size())
        text.replace(at, from.size(), to);
    return text;
}

/// JSON in which no text can end the element that it stands in.
std::string embedded(const json& data) {
    constexpr int kOneLine = -1;
    const std::string text = data.dump(kOneLine, ' ', false, json::error_handler_t::replace);
    return replacedAll(text, "<", "\\u003c");
}

std::string escaped(const std::string& text) {
    // By way of JSON, which replaces bytes that are no UTF-8.
    const std::string clean =
        json::parse(json(text).dump(-1, ' ', false, json::error_handler_t::replace));
    return replacedAll(replacedAll(replacedAll(clean, "&", "&amp;"), "<", "&lt;"), ">", "&gt;");
}

}  // namespace

std::string pageOf(const std::vector<PageTable>& tables, const PagePicture& picture,
                   const std::string& made) {
    std::string title = tables.front().name;
    if (tables.size() == 2) title += " and " + tables.back().name;
    // The template's own places, not those that a file name may contain.
    std::string page;
    std::string_view rest = pageTemplate();
    const std::pair<std::string_view, std::string> parts[] = {
        {"{{title}}", escaped(title)},
        {"{{title}}", escaped(title)},
        {"{{data}}", embedded(pageData(tables, picture, made))}};
    for (const auto& [mark, text] : parts) {
        const std::size_t at = rest.find(mark);
        page.append(rest.substr(0, at)).append(text);
        rest.remove_prefix(at + mark.size());
    }
    return page.append(rest);
}

}  // namespace report
